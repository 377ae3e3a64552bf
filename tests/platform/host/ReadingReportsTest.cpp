// What reading a setup passes over is reported at its place, and what saving would drop is
// known before the save.
#include "TestSupport.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace testsupport;

namespace {

// Text with '@' where the one expected warning points; the marker is removed.
struct Marked {
    std::string text;
    paramfile::Position at;
};

Marked Mark(const std::string& withMarker) {
    Marked m;
    int line = 1;
    int column = 1;
    for (char c : withMarker) {
        if (c == '@') {
            m.at = {line, column};
            continue;
        }
        m.text += c;
        if (c == '\n') {
            ++line;
            column = 1;
        } else {
            ++column;
        }
    }
    return m;
}

const std::string kModel =
    "    mode = 2\n"
    "    MODEL_DEFINITION {\n"
    "        number_of_fractions = 1\n"
    "        number_of_layers = 1\n"
    "    }\n";

std::string Module(const std::string& inside) {
    return "MUD_TRANSPORT_MODULE {\n" + kModel + inside + "}\n";
}

struct Case {
    const char* name;
    std::string text;       // with '@' at the warning's place; none expected without it
    const char* warning;    // part of the message
    const char* validation; // part of a validation message, or null
    bool dropped;           // saving drops what was reported
};

TEST(ReadingReports, EachCaseAtItsPlace) {
    const Case cases[] = {
        {"clean module", Module(""), nullptr, nullptr, false},
        {"misspelt keyword",
         "MUD_TRANSPORT_MODULE {\n" + kModel.substr(0, kModel.size() - 6) +
             "        @rho_sedimnet = 2650.0\n    }\n}\n",
         "unknown keyword 'rho_sedimnet' in MUD_TRANSPORT_MODULE/MODEL_DEFINITION: not read, "
         "dropped on saving",
         nullptr, true},
        {"section of a later version", Module("    @PARTICLE_TRACKING {\n        a = 1\n    }\n"),
         "unknown section 'PARTICLE_TRACKING' in MUD_TRANSPORT_MODULE", nullptr, true},
        {"subsystem not built", Module("    FORCINGS {\n        @TIDES {\n        }\n    }\n"),
         "unknown section 'TIDES' in MUD_TRANSPORT_MODULE/FORCINGS", nullptr, true},
        {"repeated keyword", Module("    @mode = 2\n"),
         "keyword 'mode' repeated in MUD_TRANSPORT_MODULE: only the first is read", nullptr,
         true},
        {"unknown keyword in a host section",
         "DOMAIN {\n    @mesh_fiel = 'a.2dm'\n}\n" + Module(""),
         "unknown keyword 'mesh_fiel' in DOMAIN", nullptr, true},
        {"list longer than the layers",
         Module("    BED {\n        BED_DENSITY {\n            @ZoSEKivListItemCount = 2\n"
                "            LAYER_1 {\n            }\n            LAYER_2 {\n            }\n"
                "        }\n    }\n"),
         "ZoSEKivListItemCount = 2, but the setup has 1 layer",
         "2 items, but the setup has 1 layer", false},
        {"transitions of too few layers",
         Module("    BED {\n        TRANSITION {\n            @ZoSEKivListItemCount = 1\n"
                "            LAYER_1 {\n            }\n        }\n    }\n"),
         "ZoSEKivListItemCount = 1, but the setup has 1 layer (0 transitions)",
         "1 item, but the setup has 1 layer (0 transitions)", false},
        {"item beyond the count",
         Module("    BED {\n        BED_DENSITY {\n            ZoSEKivListItemCount = 1\n"
                "            LAYER_1 {\n            }\n            @LAYER_2 {\n            }\n"
                "        }\n    }\n"),
         "unknown section 'LAYER_2' in MUD_TRANSPORT_MODULE/BED/BED_DENSITY", nullptr, true},
        {"float keyword beyond the float range",
         Module("    BED {\n        EROSION {\n"
                "            @max_concentration_due_to_erosion = 1e42\n        }\n    }\n"),
         "'max_concentration_due_to_erosion' value 1e+42 is out of range for a float; kept 50",
         nullptr, false},
        {"format the value may not take",
         Module("    BED {\n        BED_DENSITY {\n            ZoSEKivListItemCount = 1\n"
                "            LAYER_1 {\n                @format = 8\n            }\n"
                "        }\n    }\n"),
         "format = 8 is not a format of this value (Constant, Varying in domain); kept as read",
         "Format 8 is not one of the formats", false},
        {"engine constant", Module("    EQUATION {\n        @formulation = 3\n    }\n"),
         "formulation = 3 is a constant of the engine; saved as 4", nullptr, false},
        {"second module", Module("") + "@MUD_TRANSPORT_MODULE {\n}\n",
         "section 'MUD_TRANSPORT_MODULE' repeated at the top level (first at line 1): only "
         "the first is read, this one is kept as it is",
         nullptr, false},
        {"empty file", "@", "no section 'MUD_TRANSPORT_MODULE' in the file", nullptr, false},
        {"module missing", "OTHER {\n}\n@",
         "no section 'MUD_TRANSPORT_MODULE' in the file: the module takes its defaults", nullptr,
         false},
        {"string not UTF-8", "OTHER {\n    s = \"caf@\xE9\"\n}\n" + Module(""),
         "string of 's' is not valid UTF-8 (byte 0xE9); kept byte for byte", nullptr, false},
        {"file name not UTF-8", "OTHER {\n    f = 'dir/@\xC0\xAF.qrd0'\n}\n" + Module(""),
         "file name of 'f' is not valid UTF-8 (byte 0xC0)", nullptr, false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        const Marked m = Mark(c.text);
        CSetupDocument::OpenResult r = CSetupDocument::FromText(m.text, "case.setup");
        ASSERT_FALSE(r.error) << r.error->ToString();
        if (!c.warning) {
            EXPECT_TRUE(r.warnings.empty()) << r.warnings.front().ToString();
        } else {
            ASSERT_EQ(r.warnings.size(), 1u) << r.warnings.front().ToString();
            const paramfile::Diagnostic& w = r.warnings.front();
            EXPECT_EQ(w.pos.line, m.at.line) << w.ToString();
            EXPECT_EQ(w.pos.column, m.at.column) << w.ToString();
            EXPECT_NE(w.message.find(c.warning), std::string::npos) << w.ToString();
        }
        EXPECT_EQ(!r.document->DroppedOnSave().empty(), c.dropped);
        r.document->ValidateAll();
        bool found = false;
        for (const auto& e : r.document->Errors())
            found = found || (c.validation && e.message.find(c.validation) != std::string::npos);
        EXPECT_EQ(found, c.validation != nullptr);
    }
}

TEST(ReadingReports, ValuesStayAsTheyWereOrAsRead) {
    // Beyond the float range the value keeps its default; nan and inf stay as read.
    for (const char* value : {"1e42", "-1e39", "inf", "nan"}) {
        SCOPED_TRACE(value);
        auto doc = Load(Module(std::string("    BED {\n        EROSION {\n"
                                           "            max_concentration_due_to_erosion = ") +
                               value + "\n        }\n    }\n"));
        const std::string out = doc->ToText();
        const std::string want = value[0] == '1' || value[0] == '-' ? "50.0" : value;
        EXPECT_NE(out.find("max_concentration_due_to_erosion = " + want + "\n"),
                  std::string::npos);
    }
}

TEST(ReadingReports, DroppedContentIsForgottenOnceSaved) {
    auto r = CSetupDocument::FromText(Module("    PARTICLE_TRACKING {\n    }\n"), "case.setup");
    ASSERT_EQ(r.document->DroppedOnSave().size(), 1u);
    const std::string path = ::testing::TempDir() + "dropped.setup";
    std::string error;
    ASSERT_TRUE(r.document->SaveAs(path, &error)) << error;
    EXPECT_TRUE(r.document->DroppedOnSave().empty());
    auto again = CSetupDocument::Open(path);
    EXPECT_TRUE(again.warnings.empty());
}

TEST(ReadingReports, CommentsSurviveInForeignAndModuleSections) {
    const std::string text = "# the setup of the estuary\n"
                             "OTHER {\n"
                             "    # kept with a\n"
                             "    a = 1 # and on its line\n"
                             "    INNER { # the inner one\n"
                             "        b = 2\n"
                             "        # at the end of INNER\n"
                             "    }\n"
                             "}\n"
                             "MUD_TRANSPORT_MODULE {\n"
                             "    mode = 2\n"
                             "    # before the model definition\n"
                             "    MODEL_DEFINITION {\n"
                             "        number_of_fractions = 1 # one is enough here\n"
                             "        # last in the definition\n"
                             "    }\n"
                             "    # gone with what it stood before\n"
                             "    PARTICLE_TRACKING {\n"
                             "    }\n"
                             "}\n"
                             "# end of the file\n";
    auto doc = Load(text);
    const std::string out = doc->ToText();
    for (const char* kept :
         {"# the setup of the estuary\nOTHER {\n    # kept with a\n    a = 1 # and on its line\n"
          "    INNER { # the inner one\n        b = 2\n        # at the end of INNER\n    }\n}\n",
          "    # before the model definition\n    MODEL_DEFINITION {\n",
          "        number_of_fractions = 1 # one is enough here\n",
          "        # last in the definition\n    }\n", "}\n# end of the file\n"})
        EXPECT_NE(out.find(kept), std::string::npos) << kept << "\n---\n" << out;
    EXPECT_EQ(out.find("gone with"), std::string::npos);
    // What was saved saves again the same.
    EXPECT_EQ(Load(out)->ToText(), out);
}

}  // namespace
