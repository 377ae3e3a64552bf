// Look-ups shared by the bed tests.
#pragma once

#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"

#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace bedtest {

// A child or list item by its (expanded) section name.
inline CZoSEKivBase* ChildNamed(CZoSEKivBase* node, std::string_view name) {
    POSITION pos = 0;
    for (CZoSEKivBase* c = node->GetFirstChild(pos); c; c = node->GetNextChild(pos))
        if (c->GetSectionName() == name)
            return c;
    return nullptr;
}

// A node below MUD_TRANSPORT_MODULE by section names; fails the test when it is missing or
// of another class.
template <class T>
T* Node(CSetupDocument& doc, std::initializer_list<std::string_view> path) {
    CZoSEKivBase* n = doc.Module();
    for (std::string_view name : path) {
        n = n ? ChildNamed(n, name) : nullptr;
    }
    T* typed = dynamic_cast<T*>(n);
    EXPECT_NE(typed, nullptr);
    return typed;
}

inline std::unique_ptr<CSetupDocument> NewSetup(int layers) {
    auto doc = std::make_unique<CSetupDocument>();
    ModelDefinition(doc->Module())->NumberOfLayers(layers);
    return doc;
}

inline void SetLayers(CSetupDocument& doc, int layers) {
    ModelDefinition(doc.Module())->NumberOfLayers(layers);
}

inline paramfile::ParamType TypeOf(const paramfile::Section& s, std::string_view kw) {
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_TRUE(k && k->ParamCount() == 1) << kw;
    return k && k->ParamCount() > 0 ? k->ParamAt(0).Type() : paramfile::ParamType::String;
}

// The keywords of a data-input value, in its own order.
inline const std::vector<std::string> kDataInputEntries = {"format", "constant_value", "file_name",
                                                           "item_numbers", "item_name"};

// Checks a data-input value holding its default constant.
inline void ExpectConstant(const paramfile::Section* s, double constant) {
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(testsupport::Entries(*s), kDataInputEntries);
    EXPECT_EQ(testsupport::Int(*s, "format"), 0);
    EXPECT_EQ(TypeOf(*s, "constant_value"), paramfile::ParamType::Double);
    EXPECT_EQ(testsupport::Double(*s, "constant_value"), constant);
}

// The messages of the last validation that concern nodes below prefix.
inline std::vector<std::string> MessagesUnder(const CSetupDocument& doc, std::string_view prefix) {
    std::vector<std::string> out;
    for (const std::string& m : testsupport::Messages(doc))
        if (std::string_view(m).starts_with(prefix))
            out.push_back(m);
    return out;
}

}  // namespace bedtest
