// Helpers shared by the model tests: documents from text, saved text, section look-ups.
#pragma once

#include "host/SetupDocument.h"
#include "paramfile/ParamFile.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace testsupport {

// Loads a setup from text; fails the test on a syntax error.
inline std::unique_ptr<CSetupDocument> Load(const std::string& text) {
    CSetupDocument::OpenResult r = CSetupDocument::FromText(text, "test.setup");
    EXPECT_FALSE(r.error.has_value()) << (r.error ? r.error->ToString() : "");
    return std::move(r.document);
}

// The saved form of a document, parsed back.
inline std::unique_ptr<paramfile::Document> Saved(CSetupDocument& doc) {
    paramfile::ParseResult r = paramfile::ParseText(doc.ToText(), "saved.setup");
    EXPECT_FALSE(r.error.has_value()) << (r.error ? r.error->ToString() : "");
    return std::move(r.document);
}

// Follows section names from the top ("MUD_TRANSPORT_MODULE", "WATER_COLUMN", ...).
inline const paramfile::Section* Find(const paramfile::Document& doc,
                                      std::initializer_list<std::string_view> path) {
    const paramfile::Section* s = &doc.Root();
    for (std::string_view name : path) {
        s = s->FindSection(name);
        if (!s)
            return nullptr;
    }
    return s;
}

// Keyword names of a section in file order; subsections as "[NAME]".
inline std::vector<std::string> Entries(const paramfile::Section& s) {
    std::vector<std::string> out;
    for (int i = 0; i < s.EntryCount(); ++i)
        out.push_back(s.EntryIsSection(i) ? "[" + std::string(s.SectionAt(i).Name()) + "]"
                                          : std::string(s.KeywordAt(i).Name()));
    return out;
}

// The one value of a keyword, as text of its type, for compact expectations.
inline int Int(const paramfile::Section& s, std::string_view kw, int param = 0) {
    int v = -999999;
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_NE(k, nullptr) << kw;
    if (k && param < k->ParamCount()) {
        EXPECT_TRUE(k->ParamAt(param).AsInt(v)) << kw;
    }
    return v;
}
inline double Double(const paramfile::Section& s, std::string_view kw, int param = 0) {
    double v = -999999;
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_NE(k, nullptr) << kw;
    if (k && param < k->ParamCount()) {
        EXPECT_TRUE(k->ParamAt(param).AsDouble(v)) << kw;
    }
    return v;
}
inline bool Bool(const paramfile::Section& s, std::string_view kw) {
    bool v = false;
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_NE(k, nullptr) << kw;
    if (k && k->ParamCount() > 0) {
        EXPECT_TRUE(k->ParamAt(0).AsBool(v)) << kw;
    }
    return v;
}
inline std::string String(const paramfile::Section& s, std::string_view kw) {
    std::string v;
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_NE(k, nullptr) << kw;
    if (k && k->ParamCount() > 0) {
        EXPECT_TRUE(k->ParamAt(0).AsString(v)) << kw;
    }
    return v;
}

// The messages of the last validation, as "PATH: message".
inline std::vector<std::string> Messages(const CSetupDocument& doc) {
    std::vector<std::string> out;
    for (const auto& e : doc.Errors())
        out.push_back(NodePath(e.node) + ": " + e.message);
    return out;
}

}  // namespace testsupport
