// Setups with outputs for the output tests: a domain with or without a mesh, in two or three
// dimensions, and outputs written as text.
#pragma once

#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "outputs/MTOutputKiv.h"

#include <memory>
#include <string>

namespace outputtest {

// A domain box of 1000..3000 x 5000..9000, bed -20..0, ten layers.
inline std::string DomainText(bool mesh, bool threeD, int steps = 100) {
    std::string s;
    s += "DOMAIN {\n";
    if (mesh)
        s += "    mesh_file = 'box.2dm'\n    x_min = 1000.0\n    x_max = 3000.0\n"
             "    y_min = 5000.0\n    y_max = 9000.0\n    z_min = -20.0\n    z_max = 0.0\n";
    s += std::string("    three_dimensional = ") + (threeD ? "1" : "0") + "\n";
    s += "    number_of_sigma_layers = 10\n}\n";
    s += "SIMULATION_PERIOD {\n    start_time = \"2021-06-01 00:00:00\"\n"
         "    number_of_time_steps = " + std::to_string(steps) + "\n    time_step_interval = 60.0\n}\n";
    return s;
}

// A setup of the domain and a module whose OUTPUTS section holds body.
inline std::string SetupText(bool mesh, bool threeD, const std::string& outputs,
                             int fractions = 2, int layers = 1) {
    return DomainText(mesh, threeD) + "MUD_TRANSPORT_MODULE {\n    MODEL_DEFINITION {\n" +
           "        number_of_fractions = " + std::to_string(fractions) + "\n" +
           "        number_of_layers = " + std::to_string(layers) + "\n    }\n" +
           "    OUTPUTS {\n" + outputs + "    }\n}\n";
}

inline CMTOutputKiv* Outputs(CSetupDocument& doc) {
    auto* list = dynamic_cast<CMTOutputKiv*>(GetImportant<CZoSEKivBase>(doc.Module(), "MTOutputs"));
    EXPECT_NE(list, nullptr);
    return list;
}

inline CMTOutputItemMainKiv* Output(CSetupDocument& doc, int n) {
    CMTOutputItemMainKiv* o = Outputs(doc)->GetItem(n);
    EXPECT_NE(o, nullptr);
    return o;
}

// A new document with a domain as given and n outputs appended.
inline std::unique_ptr<CSetupDocument> WithOutputs(bool mesh, bool threeD, int n,
                                                  int fractions = 2, int layers = 1) {
    auto doc = testsupport::Load(SetupText(mesh, threeD, "", fractions, layers));
    for (int i = 0; i < n; ++i)
        Outputs(*doc)->Append();
    return doc;
}

}  // namespace outputtest
