// Dredgers: keywords in their order and types, the weights read only whole, bounded counts,
// the even split on writing, and validation of masses, type, weights and the time series.
#include "DredgingTestSupport.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/DomainKiv.h"

#include <algorithm>
#include <cmath>
#include <limits>

using namespace testsupport;
using namespace dredgingtest;
using paramfile::ParamType;

namespace {

std::vector<std::string> WarningTexts(const CSetupDocument::OpenResult& r) {
    std::vector<std::string> out;
    for (const paramfile::Diagnostic& d : r.warnings)
        out.push_back(d.message);
    return out;
}

const paramfile::Section* SavedDredger(const paramfile::Document& saved, const char* name) {
    return Find(saved, {"MUD_TRANSPORT_MODULE", "DREDGING", name});
}

// Validates the setup and gives the messages about dredging.
std::vector<std::string> DredgingMessages(CSetupDocument& doc) {
    doc.ValidateAll();
    std::vector<std::string> out;
    for (const std::string& m : Messages(doc))
        if (m.starts_with("MUD_TRANSPORT_MODULE/DREDGING"))
            out.push_back(m);
    return out;
}

}  // namespace

TEST(MTDredgingKiv, NewSetupWritesAnEmptyListBetweenForcingsAndDispersion) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* root = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    ASSERT_NE(root, nullptr);
    const std::vector<std::string> entries = Entries(*root);
    const auto at = [&](const char* name) {
        return std::find(entries.begin(), entries.end(), name) - entries.begin();
    };
    ASSERT_LT(at("[DREDGING]"), static_cast<long>(entries.size()));
    EXPECT_EQ(at("[DREDGING]"), at("[FORCINGS]") + 1);
    EXPECT_EQ(at("[DISPERSION]"), at("[DREDGING]") + 1);

    const paramfile::Section* dredging = root->FindSection("DREDGING");
    EXPECT_EQ(Entries(*dredging), (std::vector<std::string>{"ZoSEKivListItemCount",
                                                            "number_of_dredgers", "update_bed"}));
    EXPECT_EQ(Int(*dredging, "number_of_dredgers"), 0);
    EXPECT_TRUE(Bool(*dredging, "update_bed"));
    EXPECT_EQ(Dredging(doc)->GetTitle(), "Dredging");
    EXPECT_TRUE(Dredging(doc)->IsDlgUsedInSetup());
    EXPECT_STREQ(Dredging(doc)->GetDlgRuntimeClass(kDlgRuntimeClassRequest), "CMTDredgingDlg");
}

TEST(MTDredgingKiv, ANewDredgerIsWrittenWithEveryKeywordInOrder) {
    auto opened = CSetupDocument::FromText(DredgingSetup(3, "number_of_dredgers = 1\nDREDGER_1 {\n}"),
                                           "test.setup");
    ASSERT_TRUE(opened.document);
    CMTDredgingItemsKiv* d = Dredging(*opened.document)->GetItem(1);
    ASSERT_NE(d, nullptr);
    EXPECT_EQ(d->GetTitle(), "Dredger 1");
    EXPECT_STREQ(d->GetDlgRuntimeClass(kDlgRuntimeClassRequest), "CMTDredgingItemsDlg");

    auto saved = Saved(*opened.document);
    const paramfile::Section* s = SavedDredger(*saved, "DREDGER_1");
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s),
              (std::vector<std::string>{"include", "name", "type", "update_dredger",
                                        "initial_dredger_mass", "maximum_dredger_mass",
                                        "update_distribution", "weights_fraction",
                                        "coordinate_type", "file_name", "item_numbers",
                                        "item_name_x", "item_name_y", "item_rate_of_dredged_mass",
                                        "item_name_spill"}));
    EXPECT_EQ(Int(*s, "include"), 1);
    EXPECT_EQ(String(*s, "name"), "Dredger 1");
    EXPECT_EQ(Int(*s, "type"), 1);
    EXPECT_TRUE(Bool(*s, "update_dredger"));
    EXPECT_EQ(s->FindKeyword("initial_dredger_mass")->ParamAt(0).Type(), ParamType::Double);
    EXPECT_EQ(Double(*s, "initial_dredger_mass"), 0.0);
    EXPECT_EQ(Double(*s, "maximum_dredger_mass"), 1e7);
    EXPECT_TRUE(Bool(*s, "update_distribution"));
    const paramfile::Keyword* weights = s->FindKeyword("weights_fraction");
    ASSERT_EQ(weights->ParamCount(), 3);
    double sum = 0;
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(weights->ParamAt(i).Type(), ParamType::Double);
        EXPECT_EQ(Double(*s, "weights_fraction", i), 100.0 / 3);
        sum += Double(*s, "weights_fraction", i);
    }
    EXPECT_LE(std::fabs(sum - 100.0), CMTDredgingItemsKiv::kWeightTolerance);
    EXPECT_EQ(String(*s, "coordinate_type"), "UTM-32");
    EXPECT_EQ(s->FindKeyword("file_name")->ParamAt(0).Type(), ParamType::FileName);
    const paramfile::Keyword* items = s->FindKeyword("item_numbers");
    ASSERT_EQ(items->ParamCount(), 4);
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(Int(*s, "item_numbers", i), i + 1);
    EXPECT_EQ(String(*s, "item_name_spill"), "");
    // The item count agrees with the number read.
    EXPECT_EQ(Int(*Find(*saved, {"MUD_TRANSPORT_MODULE", "DREDGING"}), "ZoSEKivListItemCount"), 1);
    // The weights were not in the file: an even split, and a word about it.
    EXPECT_EQ(WarningTexts(opened), (std::vector<std::string>{
                                        "'weights_fraction' is missing; the dredged mass is "
                                        "split evenly over 3 fractions"}));
}

TEST(MTDredgingKiv, EveryValueReadIsWrittenBackUnchanged) {
    const std::string text = DredgingSetup(2, R"(
        ZoSEKivListItemCount = 2
        number_of_dredgers = 2
        update_bed = false
        DREDGER_1 {
            include = 0
            name = "Hopper \"Anna\""
            type = 4
            update_dredger = false
            initial_dredger_mass = 2500.5
            maximum_dredger_mass = 12000.0
            update_distribution = false
            weights_fraction = 70.0, 30
            coordinate_type = "LONG/LAT"
            file_name = 'data\anna.qrd0'
            item_numbers = 4, 3, 2, 1
            item_name_x = "lon"
            item_name_y = "lat"
            item_rate_of_dredged_mass = "rate"
            item_name_spill = "spill"
        }
        DREDGER_2 {
            name = "Second"
            weights_fraction = 50.0, 50.0
        })");
    auto opened = CSetupDocument::FromText(text, "test.setup");
    ASSERT_TRUE(opened.document);
    EXPECT_TRUE(opened.warnings.empty()) << WarningTexts(opened).front();
    CMTDredgingKiv* list = Dredging(*opened.document);
    EXPECT_FALSE(list->UpdateBed());
    CMTDredgingItemsKiv* d = list->GetItem(1);
    EXPECT_EQ(d->Include(), 0);
    EXPECT_FALSE(d->IsDlgUsedInSetup());
    EXPECT_EQ(d->Type(), 4);
    EXPECT_EQ(d->WeightsFraction(), (std::vector<double>{70.0, 30.0}));
    EXPECT_EQ(d->DataFile()->ItemNumber(), (std::vector<int>{4, 3, 2, 1}));
    EXPECT_EQ(d->DataFile()->ItemName(3), "rate");
    EXPECT_EQ(d->DataFile()->ItemName(5), "");
    EXPECT_EQ(list->GetItem(2)->GetTitle(), "Second");

    // Saved and read again, the text is the same.
    const std::string once = opened.document->ToText();
    auto again = CSetupDocument::FromText(once, "again.setup");
    EXPECT_EQ(again.document->ToText(), once);
    auto saved = Saved(*opened.document);
    const paramfile::Section* s = SavedDredger(*saved, "DREDGER_1");
    EXPECT_EQ(String(*s, "name"), "Hopper \"Anna\"");
    EXPECT_EQ(String(*s, "file_name"), "data\\anna.qrd0");
    EXPECT_EQ(s->FindKeyword("weights_fraction")->ParamAt(1).Type(), ParamType::Double);
    EXPECT_EQ(Double(*s, "maximum_dredger_mass"), 12000.0);
}

TEST(MTDredgingKiv, WeightsAreReadOnlyWholeAndWhatIsKeptIsReported) {
    struct Case {
        const char* keyword;  // the weights_fraction line, or empty for none
        std::vector<double> weights;
        const char* warning;  // part of the one warning expected; empty for none
    };
    const double third = 100.0 / 3;
    const Case cases[] = {
        {"weights_fraction = 20.0, 30.0, 50", {20, 30, 50}, ""},
        {"", {third, third, third}, "'weights_fraction' is missing; the dredged mass is split evenly over 3 fractions"},
        {"weights_fraction =", {third, third, third}, "holds 0 values for 3 fractions; the weights are kept"},
        {"weights_fraction = 50.0, 50.0", {third, third, third}, "holds 2 values for 3 fractions"},
        {"weights_fraction = 50.0, \"x\", 50.0", {third, third, third}, "value 2 is not a number; the weights are kept"},
        {"weights_fraction = 50.0, true, 50.0", {third, third, third}, "value 2 is not a number"},
        {"weights_fraction = 10.0, 20.0, 70.0, 5.0", {10, 20, 70}, "'weights_fraction' in MUD_TRANSPORT_MODULE/DREDGING/DREDGER_1 holds 4 values where 3 are read: value 4 is not read, dropped on saving"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.keyword);
        auto opened = CSetupDocument::FromText(
            DredgingSetup(3, std::string("number_of_dredgers = 1\nDREDGER_1 {\n") + c.keyword + "\n}"),
            "test.setup");
        ASSERT_TRUE(opened.document);
        EXPECT_EQ(Dredging(*opened.document)->GetItem(1)->WeightsFraction(), c.weights);
        const std::vector<std::string> w = WarningTexts(opened);
        if (*c.warning) {
            ASSERT_EQ(w.size(), 1u);
            EXPECT_NE(w[0].find(c.warning), std::string::npos) << w[0];
        } else {
            EXPECT_TRUE(w.empty());
        }
    }
}

TEST(MTDredgingKiv, TheNumberOfDredgersIsBoundedAndAMissingOneKeepsTheCount) {
    struct Case {
        const char* body;
        int count;
        const char* warning;  // empty: none
    };
    const Case cases[] = {
        {"number_of_dredgers = 2", 2, ""},
        {"ZoSEKivListItemCount = 3", 3, ""},
        {"ZoSEKivListItemCount = 2\nnumber_of_dredgers = 3", 3,
         "number_of_dredgers = 3, but ZoSEKivListItemCount = 2; 3 dredgers are read"},
        {"ZoSEKivListItemCount = 2\nnumber_of_dredgers = -1", 2,
         "number_of_dredgers = -1 is not between 0 and 100000; kept 2"},
        {"number_of_dredgers = 2000000000", 0, "is not between 0 and 100000; kept 0"},
        {"ZoSEKivListItemCount = 1\nnumber_of_dredgers = \"many\"", 1, "expects an integer"},
        {"update_bed = false", 0, ""},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.body);
        auto opened = CSetupDocument::FromText(DredgingSetup(1, c.body), "test.setup");
        ASSERT_TRUE(opened.document);
        EXPECT_EQ(Dredging(*opened.document)->GetItemCount(), c.count);
        std::vector<std::string> w = WarningTexts(opened);
        // Dredgers without a section of their own report their missing weights, and the
        // sections the count promises are reported missing.
        std::erase_if(w, [](const std::string& m) {
            return m.find("weights_fraction") != std::string::npos || m.find(" missing (") != std::string::npos;
        });
        if (*c.warning) {
            ASSERT_EQ(w.size(), 1u);
            EXPECT_NE(w[0].find(c.warning), std::string::npos) << w[0];
        } else {
            EXPECT_TRUE(w.empty()) << w.front();
        }
    }
}

TEST(MTDredgingKiv, ReadingReportsTypesAndItemListsItCannotUse) {
    auto opened = CSetupDocument::FromText(DredgingSetup(1, R"(
        number_of_dredgers = 1
        DREDGER_1 {
            type = 7
            weights_fraction = 100.0
            item_numbers = 5, 6
        })"),
                                           "test.setup");
    CMTDredgingItemsKiv* d = Dredging(*opened.document)->GetItem(1);
    EXPECT_EQ(d->Type(), 7);  // kept as read, refused by validation
    EXPECT_EQ(d->DataFile()->ItemNumber(), (std::vector<int>{5, 6, 3, 4}));
    const std::vector<std::string> w = WarningTexts(opened);
    ASSERT_EQ(w.size(), 2u);
    EXPECT_NE(w[0].find("type = 7 is not a known type of spilling"), std::string::npos) << w[0];
    EXPECT_NE(w[1].find("'item_numbers' holds 2 values"), std::string::npos) << w[1];
}

TEST(MTDredgingKiv, WritingSplitsEvenlyWhenTheFractionsChanged) {
    CSetupDocument doc;
    ModelDefinition(doc.Module())->NumberOfFractions(2);
    CMTDredgingItemsKiv* d = Dredging(doc)->Append();
    d->WeightsFraction({80.0, 20.0});
    ModelDefinition(doc.Module())->NumberOfFractions(4);
    // Until the next write the old weights stay.
    EXPECT_EQ(d->WeightsFraction(), (std::vector<double>{80.0, 20.0}));
    // Validation judges what will be written.
    d->WeightsFraction({80.0, 10.0});
    EXPECT_TRUE(DredgingMessages(doc).size() == 1u);  // only the missing file
    auto saved = Saved(doc);
    const paramfile::Keyword* w = SavedDredger(*saved, "DREDGER_1")->FindKeyword("weights_fraction");
    ASSERT_EQ(w->ParamCount(), 4);
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(Double(*SavedDredger(*saved, "DREDGER_1"), "weights_fraction", i), 25.0);
    EXPECT_EQ(d->WeightsFraction(), (std::vector<double>(4, 25.0)));
}

TEST(MTDredgingKiv, ValidationOfMassesTypeAndWeights) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    struct Case {
        const char* what;
        double initial, maximum;
        int type;
        std::vector<double> weights;
        const char* message;  // empty: the dredger's own values pass
    };
    const Case cases[] = {
        {"defaults", 0, 1e7, 1, {50, 50}, ""},
        {"both masses 0", 0, 0, 1, {50, 50}, "Values out of range"},
        {"any positive maximum", 0, 1e-9, 4, {50, 50}, ""},
        {"negative initial", -1, 10, 1, {50, 50}, "Values out of range"},
        {"maximum not a number", 0, nan, 1, {50, 50}, "Values out of range"},
        {"type 0", 0, 10, 0, {50, 50}, "Values out of range"},
        {"type 5", 0, 10, 5, {50, 50}, "Values out of range"},
        {"masses before weights", -1, 10, 1, {10, 10}, "Values out of range"},
        {"within the tolerance below", 0, 10, 1, {50, 49.99995}, ""},
        {"within the tolerance above", 0, 10, 1, {50, 50.00005}, ""},
        {"beyond below", 0, 10, 1, {50, 49.999}, "Sum of weights should be 100"},
        {"beyond above", 0, 10, 1, {50, 50.001}, "Sum of weights should be 100"},
        {"a negative share", 0, 10, 1, {150, -50}, "Values out of range"},
        {"a weight not a number", 0, 10, 1, {50, nan}, "Values out of range"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        CSetupDocument doc;
        ModelDefinition(doc.Module())->NumberOfFractions(2);
        CMTDredgingItemsKiv* d = Dredging(doc)->Append();
        d->InitialDredgerMass(c.initial);
        d->MaximumDredgerMass(c.maximum);
        d->Type(c.type);
        d->WeightsFraction(c.weights);
        doc.ClearErrors();
        EXPECT_EQ(d->ValidateData(), *c.message ? 0 : 1);
        const std::vector<std::string> m = Messages(doc);
        if (*c.message) {
            ASSERT_EQ(m.size(), 1u);
            EXPECT_EQ(m[0], std::string("MUD_TRANSPORT_MODULE/DREDGING/DREDGER_1: ") + c.message);
        } else {
            EXPECT_TRUE(m.empty());
        }
    }
}

TEST(MTDredgingKiv, TheTimeSeriesMustHoldTheFourItemsAndEndInQrd0OrKx0) {
    TempDir dir;
    const std::string projected = Series();
    struct Case {
        const char* what;
        std::string file;     // name written in the folder
        std::string content;  // empty: nothing written
        const char* projection;
        std::vector<int> items;
        bool valid;
    };
    const Case cases[] = {
        {"a time series", "track.qrd0", projected, "UTM-32", {1, 2, 3, 4}, true},
        {"the older extension", "track.kx0", projected, "UTM-32", {1, 2, 3, 4}, true},
        {"extension in capitals", "TRACK.QRD0", projected, "UTM-32", {1, 2, 3, 4}, true},
        {"an extension of another kind", "track.qrd1", Series(100183, 100195, 100013, "qrd1"), "UTM-32", {1, 2, 3, 4}, false},
        {"a series under another name", "track.dat", projected, "UTM-32", {1, 2, 3, 4}, false},
        {"a name shorter than the extension", "kx", projected, "UTM-32", {1, 2, 3, 4}, false},
        {"a name that is only the extension", "kx0", projected, "UTM-32", {1, 2, 3, 4}, true},
        {"no such file", "none.qrd0", "", "UTM-32", {1, 2, 3, 4}, false},
        {"projected x and y for a geographical dredger", "track.qrd0", projected, "LONG/LAT", {1, 2, 3, 4}, false},
        {"geographical x and y", "lonlat.qrd0", Series(100157), "LONG/LAT", {1, 2, 3, 4}, true},
        {"geographical x and y for a projected dredger", "lonlat.qrd0", Series(100157), "UTM-31", {1, 2, 3, 4}, false},
        {"mass flux and spill rate", "flux.qrd0", Series(100183, 100504, 100505), "UTM-32", {1, 2, 3, 4}, true},
        {"a spill that is a mass rate", "rates.qrd0", Series(100183, 100195, 100195), "UTM-32", {1, 2, 3, 4}, false},
        {"items swapped", "track.qrd0", projected, "UTM-32", {1, 2, 4, 3}, false},
        {"an item the file lacks", "track.qrd0", projected, "UTM-32", {1, 2, 3, 5}, false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        const std::string path = c.content.empty() ? dir.Path(c.file) : dir.Write(c.file, c.content);
        CSetupDocument doc;
        CMTDredgingItemsKiv* d = Dredging(doc)->Append();
        d->CoordinateType(c.projection);
        d->DataFile()->FileName(path);
        d->DataFile()->ItemNumber(c.items);
        const std::vector<std::string> m = DredgingMessages(doc);
        if (c.valid) {
            CString error;
            EXPECT_TRUE(d->DataFile()->IsFileValid(&error)) << error;
            EXPECT_TRUE(m.empty()) << m.front();
        } else {
            EXPECT_EQ(m, (std::vector<std::string>{
                             "MUD_TRANSPORT_MODULE/DREDGING/DREDGER_1/MT Dredging file: File is not valid"}));
        }
    }
    EXPECT_FALSE(IsDredgingFileName(""));
    EXPECT_FALSE(IsDredgingFileName("x0"));
}

TEST(MTDredgingKiv, DefaultsFollowTheDomainAndTheList) {
    CSetupDocument doc;
    CDomainKiv* domain = Domain(doc.Module());
    domain->Projection("LONG/LAT");
    // No mesh: the host's default projection.
    EXPECT_EQ(Dredging(doc)->Append()->CoordinateType(), "UTM-32");
    domain->MeshFile("estuary.2dm");
    CMTDredgingItemsKiv* second = Dredging(doc)->Append();
    EXPECT_EQ(second->CoordinateType(), "LONG/LAT");
    EXPECT_EQ(second->GetTitle(), "Dredger 2");
    // Inserted before the first, numbered after the count.
    Dredging(doc)->Insert(1, 1);
    EXPECT_EQ(Dredging(doc)->GetItem(1)->GetTitle(), "Dredger 3");
    EXPECT_EQ(Dredging(doc)->GetItem(1)->GetSectionName(), "DREDGER_1");
    EXPECT_EQ(NodePath(second), "MUD_TRANSPORT_MODULE/DREDGING/DREDGER_3");
}

TEST(MTDredgingKiv, TheSharedDredgerKeyNeverOutlivesTheDredgerItNames) {
    CSetupDocument doc;
    CMTDredgingKiv* list = Dredging(doc);
    ASSERT_NE(list, nullptr);
    list->SetItemCount(2, 1);
    EXPECT_EQ(doc.GetImportantNode("MTDredging"), list->GetItem(2));
    list->Delete(1, 1);  // not the one the key names
    EXPECT_EQ(doc.GetImportantNode("MTDredging"), list->GetItem(1));
    list->Delete(1, 1);
    EXPECT_EQ(doc.GetImportantNode("MTDredging"), nullptr);
}

TEST(MTDredgingKiv, TheTrackIsReadFromItemsXAndYAndAgainWhenTheFileChanges) {
    TempDir dir;
    const std::string path = dir.Write(
        "track.qrd0", "qrd0 1\nstart 2024-01-01 00:00\nstep 3600\nsteps 3\nitems 4\n"
                      "item y 100183\nitem x 100183\nitem r 100195\nitem s 100013\nvalues\n"
                      "10 1 0 0\nnan 2 0 0\n30 3 0 0\n");
    CSetupDocument doc;
    CMTDredgingItemsKiv* d = Dredging(doc)->Append();
    d->DataFile()->FileName(path);
    d->DataFile()->ItemNumber(std::vector<int>{2, 1, 3, 4});
    std::vector<double> x, y;
    ASSERT_TRUE(d->DataFile()->ReadTrack(x, y));
    // The step whose y is not a number is left out.
    EXPECT_EQ(x, (std::vector<double>{1, 3}));
    EXPECT_EQ(y, (std::vector<double>{10, 30}));

    dir.Write("track.qrd0", "qrd0 1\nstart 2024-01-01 00:00\nstep 3600\nsteps 1\nitems 4\n"
                            "item y 100183\nitem x 100183\nitem r 100195\nitem s 100013\nvalues\n"
                            "5 6 0 0\n");
    ASSERT_TRUE(d->DataFile()->ReadTrack(x, y));
    EXPECT_EQ(x, (std::vector<double>{6}));

    CString error;
    d->DataFile()->FileName(dir.Path("none.qrd0"));
    EXPECT_FALSE(d->DataFile()->ReadTrack(x, y, &error));
    EXPECT_NE(error.find("does not exist"), CString::npos) << error;
    EXPECT_TRUE(x.empty());
}
