#include "ForcingsTestSupport.h"
#include "fem/SimulationPeriodKiv.h"
#include "forcings/MTWaveFieldFile.h"

using namespace testsupport;
using namespace forcingstest;
using paramfile::ParamType;

TEST(MTWaveFieldKiv, NewSectionWritesConstantsFileItemsAndSoftStartInOrder) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* s =
        Find(*saved, {"MUD_TRANSPORT_MODULE", "FORCINGS", "WAVES", "WAVE_FIELD"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s),
              (std::vector<std::string>{
                  "format", "wave_height", "wave_period", "wave_direction", "file_name",
                  "item_number_for_wave_height", "item_number_for_wave_period",
                  "item_number_for_wave_direction", "item_name_for_wave_height",
                  "item_name_for_wave_period", "item_name_for_wave_direction",
                  "type_of_soft_start", "soft_time_interval"}));
    EXPECT_EQ(Int(*s, "format"), 0);
    EXPECT_EQ(Double(*s, "wave_height"), 1.0);
    EXPECT_EQ(Double(*s, "wave_period"), 3.0);
    EXPECT_EQ(Double(*s, "wave_direction"), 180.0);
    EXPECT_EQ(s->FindKeyword("file_name")->ParamAt(0).Type(), ParamType::FileName);
    EXPECT_EQ(String(*s, "file_name"), "");
    EXPECT_EQ(Int(*s, "item_number_for_wave_height"), 1);
    EXPECT_EQ(Int(*s, "item_number_for_wave_period"), 2);
    EXPECT_EQ(Int(*s, "item_number_for_wave_direction"), 3);
    EXPECT_EQ(s->FindKeyword("item_name_for_wave_height")->ParamAt(0).Type(), ParamType::String);
    EXPECT_EQ(Int(*s, "type_of_soft_start"), 2);
    EXPECT_EQ(Double(*s, "soft_time_interval"), 0.0);
    EXPECT_EQ(s->FindKeyword("soft_time_interval")->ParamAt(0).Type(), ParamType::Double);
}

TEST(MTWaveFieldKiv, ReadsTheFileAndItsItemsAndKeepsWhatIsMissing) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    FORCINGS {
        WAVES {
            WAVE_FIELD {
                format = 2
                wave_height = 0.5
                file_name = 'data\waves.qrd2'
                item_number_for_wave_height = 4
                item_number_for_wave_direction = 6
                item_name_for_wave_height = "Hm0"
                item_name_for_wave_direction = "MWD"
                soft_time_interval = 3600.0
            }
        }
    }
}
)");
    CMTWaveFieldKiv* f = Field(*doc);
    EXPECT_EQ(f->GetFormat(), 2);
    EXPECT_EQ(f->WaveHeight(), 0.5);
    EXPECT_EQ(f->WavePeriod(), 3.0);
    EXPECT_EQ(f->File()->FileName(), "data\\waves.qrd2");
    EXPECT_EQ(f->File()->ItemNumber(), (std::vector<int>{4, 2, 6}));
    EXPECT_EQ(f->File()->ItemName(1), "Hm0");
    EXPECT_EQ(f->File()->ItemName(2), "");
    EXPECT_EQ(f->File()->ItemName(3), "MWD");
    EXPECT_EQ(f->SoftStartType(), 2);
    EXPECT_EQ(f->SoftStartInterval(), 3600.0);
    // A stored format 2 is written back as it was.
    const std::string text = doc->ToText();
    EXPECT_NE(text.find("format = 2"), std::string::npos);
    EXPECT_EQ(Load(text)->ToText(), text);
}

TEST(MTWaveFieldFile, ItemNamesExistForTheThreeItemsOnly) {
    CSetupDocument doc;
    CMTWaveFieldFile* file = Field(doc)->File();
    for (int i : {1, 2, 3})
        file->ItemName(i, "name " + std::to_string(i));
    for (int i : {-1, 0, 4, 100}) {
        file->ItemName(i, "ignored");
        EXPECT_EQ(file->ItemName(i), "") << i;
    }
    EXPECT_EQ(file->ItemName(3), "name 3");
    EXPECT_EQ(file->GetNoItems(), 3);
}

TEST(MTWaveFieldFile, EndingsAreComparedWithoutCaseAndShortNamesNeverMatch) {
    EXPECT_TRUE(EndsWithNoCase("DATA.QRD0", "qrd0"));
    EXPECT_TRUE(EndsWithNoCase("a.Kx2", "kx2"));
    EXPECT_FALSE(EndsWithNoCase("x0", "kx0"));
    EXPECT_FALSE(EndsWithNoCase("", "qrd0"));
    EXPECT_FALSE(EndsWithNoCase("qrd", "qrd0"));
    EXPECT_TRUE(EndsWithNoCase("qrd0", "qrd0"));
}

TEST(MTWaveFieldFile, CheckTakesTheFormatsFilesAndEndings) {
    DataFolder folder(TestName());
    const std::string series = folder.Write("DATA.QRD0", WaveHeader("qrd0", ""));
    const std::string oldSeries = folder.Write("old.kx0", WaveHeader("kx0", ""));
    const std::string grid = folder.Write("field.qrd2", WaveHeader("qrd2", "grid 2 2\n"));
    const std::string mesh = folder.Write("field.qrdu", WaveHeader("qrdu", "nodes 4\n"));
    const std::string oldGrid = folder.Write("old.kx2", WaveHeader("kx2", "grid 2 2\n"));
    const std::string wrongUnits =
        folder.Write("wrong.qrd0", WaveHeader("qrd0", "", {100084, 100407, 100085}));
    // A time series under a name that is not one: the reader refuses the disagreement.
    const std::string misnamed = folder.Write("series.dat", WaveHeader("qrd0", ""));
    struct Case {
        int waveType;
        int format;
        std::string file;
        bool valid;
    };
    const Case cases[] = {
        {1, 1, series, true},
        {1, 3, series, false},         // a time series is no field over the domain
        {1, 1, oldSeries, true},
        {1, 1, grid, false},
        {1, 3, grid, true},
        {1, 3, mesh, true},
        {1, 3, oldGrid, true},
        {1, 1, mesh, false},
        {1, 1, wrongUnits, false},
        {1, 1, misnamed, false},
        {1, 1, folder.Path("none.qrd0"), false},
        {1, 1, "", false},
        {1, 1, "x", false},            // shorter than any ending
        {1, 3, "kx", false},
        {1, 0, "", true},              // constants: no file
        {1, 2, "", true},              // stored 2: not looked at
        {1, 2, folder.Path("none.qrd2"), true},
        {1, 7, "", true},
        {0, 1, "", true},              // no waves, the database or a spectral field: never tested
        {2, 1, folder.Path("none.qrd0"), true},
        {3, 3, "", true},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.waveType << " " << c.format << " " << c.file);
        CSetupDocument doc;
        Waves(doc)->WaveType(c.waveType);
        Field(doc)->SetFormat(c.format);
        Field(doc)->File()->FileName(c.file);
        EXPECT_EQ(Field(doc)->File()->CheckFile(), c.valid);
        SetWind(doc, true, 1);
        doc.ValidateAll();
        std::vector<std::string> messages;
        for (const std::string& m : Messages(doc))
            if (m.find("/WAVE_FIELD") != std::string::npos)
                messages.push_back(m);
        if (c.valid) {
            EXPECT_TRUE(messages.empty());
        } else {
            EXPECT_EQ(messages,
                      (std::vector<std::string>{"MUD_TRANSPORT_MODULE/FORCINGS/WAVES/WAVE_FIELD/"
                                                "Wave field data file: File is not valid"}));
        }
    }
}

TEST(MTWaveFieldFile, ChosenItemsMustBeTheWaveQuantities) {
    DataFolder folder(TestName());
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    Field(doc)->SetFormat(1);
    // Direction, height, period: the items must be chosen in the order of the requests.
    Field(doc)->File()->FileName(
        folder.Write("w.qrd0", WaveHeader("qrd0", "", {100095, 100097, 100085})));
    EXPECT_FALSE(Field(doc)->File()->CheckFile());
    Field(doc)->File()->ItemNumber(std::vector<int>{2, 3, 1});
    EXPECT_TRUE(Field(doc)->File()->CheckFile());
    // Item numbers beyond the file's items fail instead of reaching past them.
    Field(doc)->File()->ItemNumber(std::vector<int>{2, 3, 9});
    EXPECT_FALSE(Field(doc)->File()->CheckFile());
}

TEST(MTWaveFieldFile, SelectorAsksForThreeItemsOnlyForDataFileFormats) {
    CSetupDocument doc;
    doc.GetPeriod()->TimeStepCount(24);
    doc.GetPeriod()->TimeStepInterval(3600);
    for (int format : {0, 1, 2, 3}) {
        SCOPED_TRACE(format);
        Field(doc)->SetFormat(format);
        CZoFileSelector s = Field(doc)->File()->MakeFileSelector();
        EXPECT_TRUE(s.HasTimeValidation());
        const bool file = format == 1 || format == 3;
        ASSERT_EQ(s.RequestCount(), file ? 3 : 0);
        if (!file)
            continue;
        EXPECT_EQ(s.Request(0).Description(), "Wave height");
        EXPECT_EQ(s.Request(0).OvuTypes(), (std::vector<long>{100084, 100097}));
        EXPECT_EQ(s.Request(1).Description(), "Wave period");
        EXPECT_EQ(s.Request(1).OvuTypes(), (std::vector<long>{100085}));
        EXPECT_EQ(s.Request(2).Description(), "Wave direction");
        EXPECT_EQ(s.Request(2).OvuTypes(), (std::vector<long>{100095, 100407}));
    }
}

TEST(MTWaveFieldFile, FileMustCoverThePeriod) {
    DataFolder folder(TestName());
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    Field(doc)->SetFormat(1);
    Field(doc)->File()->FileName(folder.Write("w.qrd0", WaveHeader("qrd0", "")));  // 1 hour
    doc.GetPeriod()->TimeStepInterval(60);
    doc.GetPeriod()->TimeStepCount(60);
    EXPECT_TRUE(Field(doc)->File()->CheckFile());
    doc.GetPeriod()->TimeStepCount(61);
    EXPECT_FALSE(Field(doc)->File()->CheckFile());
}
