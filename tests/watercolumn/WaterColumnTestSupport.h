// Helpers for the water-column and dispersion tests.
#pragma once

#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"

#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace wctest {

// A node of the module by section names below MUD_TRANSPORT_MODULE, as its class.
template <class T>
T* Node(CSetupDocument& doc, std::initializer_list<std::string_view> path) {
    CZoSEKivBase* node = doc.Module();
    for (std::string_view name : path) {
        CZoSEKivBase* next = nullptr;
        POSITION pos = 0;
        for (CZoSEKivBase* c = node->GetFirstChild(pos); c && !next; c = node->GetNextChild(pos))
            if (c->GetSectionName() == name)
                next = c;
        EXPECT_NE(next, nullptr) << name;
        if (!next)
            return nullptr;
        node = next;
    }
    T* typed = dynamic_cast<T*>(node);
    EXPECT_NE(typed, nullptr);
    return typed;
}

inline std::unique_ptr<CSetupDocument> NewSetup(int fractions) {
    auto doc = std::make_unique<CSetupDocument>();
    ModelDefinition(doc->Module())->NumberOfFractions(fractions);
    return doc;
}

// The module's text with a MODEL_DEFINITION of n fractions ahead of body.
inline std::string Module(int fractions, const std::string& body) {
    return "MUD_TRANSPORT_MODULE {\n MODEL_DEFINITION {\n  number_of_fractions = " +
           std::to_string(fractions) + "\n }\n" + body + "}\n";
}

inline paramfile::ParamType TypeOf(const paramfile::Section& s, std::string_view kw) {
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_TRUE(k && k->ParamCount() == 1) << kw;
    return k && k->ParamCount() > 0 ? k->ParamAt(0).Type() : paramfile::ParamType::String;
}

inline std::vector<std::string> WarningTexts(const CSetupDocument::OpenResult& r) {
    std::vector<std::string> out;
    for (const paramfile::Diagnostic& d : r.warnings)
        out.push_back(d.message);
    return out;
}

}  // namespace wctest
