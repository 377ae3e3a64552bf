// Helpers for the initial-condition, boundary-condition and source tests.
#pragma once

#include "TestSupport.h"
#include "support/SyncedFollower.h"
#include "conditions/InitialConditionsKiv.h"
#include "conditions/MTBoundaryConditionsKiv.h"
#include "conditions/MTSourceKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "hydro/HDSourcesKiv.h"

#include <memory>
#include <string>
#include <vector>

namespace condtest {

// A new setup of the given shape; boundaries and sources are named "B1".., "S1"...
inline std::unique_ptr<CSetupDocument> NewSetup(int fractions, int layers, int boundaries = 0,
                                                int sources = 0) {
    auto doc = std::make_unique<CSetupDocument>();
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    model->NumberOfFractions(fractions);
    model->NumberOfLayers(layers);
    doc->GetBoundaryNames()->SetItemCount(boundaries, 1);
    for (int i = 1; i <= boundaries; ++i)
        doc->GetBoundaryNames()->GetItem(i)->Identifier("B" + std::to_string(i));
    doc->GetSources()->SetItemCount(sources, 1);
    for (int i = 1; i <= sources; ++i)
        doc->GetSources()->GetItem(i)->Name("S" + std::to_string(i));
    return doc;
}

inline std::vector<std::string> WarningTexts(const CSetupDocument::OpenResult& r) {
    std::vector<std::string> out;
    for (const paramfile::Diagnostic& d : r.warnings)
        out.push_back(d.message);
    return out;
}

// Host sections with named boundaries and sources, then the module's text.
inline std::string HostText(int boundaries, int sources) {
    std::string text = "DOMAIN {\n BOUNDARY_NAMES {\n  ZoSEKivListItemCount = " +
                       std::to_string(boundaries) + "\n";
    for (int i = 1; i <= boundaries; ++i)
        text += "  BOUNDARY_" + std::to_string(i) + " {\n   name = \"B" + std::to_string(i) +
                "\"\n   code = " + std::to_string(i + 1) + "\n  }\n";
    text += " }\n}\nHYDRODYNAMIC_SOURCES {\n ZoSEKivListItemCount = " + std::to_string(sources) +
            "\n";
    for (int i = 1; i <= sources; ++i)
        text += " SOURCE_" + std::to_string(i) + " {\n  name = \"S" + std::to_string(i) +
                "\"\n }\n";
    return text + "}\n";
}

inline std::string ModuleText(int fractions, int layers, const std::string& body) {
    return "MUD_TRANSPORT_MODULE {\n MODEL_DEFINITION {\n  number_of_fractions = " +
           std::to_string(fractions) + "\n  number_of_layers = " + std::to_string(layers) +
           "\n }\n" + body + "}\n";
}

}  // namespace condtest
