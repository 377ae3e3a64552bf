#include "ForcingsTestSupport.h"
#include "bed/BedUiTestSupport.h"
#include "forcings/ForcingsWaveDBAxisKiv.h"
#include "forcings/ForcingsWaveDBDlg.h"
#include "forcings/ForcingsWaveDBFile.h"
#include "forcings/ForcingsWaveDBGrid.h"
#include "forcings/ForcingsWavesDlg.h"
#include "forcings/MTWaveFieldDlg.h"
#include "forcings/MTWaveFieldFile.h"
#include "widgets/ZoDataViewerDlg.h"
#include "widgets/ZoFileSelectorDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QStackedWidget>

#include <functional>

using namespace forcingstest;
using namespace uitest;

namespace {

QStringList Texts(QComboBox* box) {
    QStringList out;
    for (int i = 0; i < box->count(); ++i)
        out << box->itemText(i);
    return out;
}

// Runs the file selector with steps instead of a user while it lives.
class SelectorStub {
public:
    explicit SelectorStub(std::function<void(CZoFileSelectorDlg&)> steps)
        : m_previous(ZoSetFileSelectorHook([this, steps](CZoFileSelectorDlg& d) {
              ++calls;
              defaultExt = d.DefaultExt();
              filter = d.Filter();
              d.Prepare();
              steps(d);
              d.accept();
              return d.result();
          })) {}
    ~SelectorStub() { ZoSetFileSelectorHook(m_previous); }
    int calls = 0;
    CString defaultExt;
    CString filter;

private:
    ZoFileSelectorHook m_previous;
};

CForcingsWavesDlg* Form(const std::unique_ptr<CZoSEDlgBase>& dlg) {
    auto* form = dynamic_cast<CForcingsWavesDlg*>(dlg.get());
    EXPECT_NE(form, nullptr);
    return form;
}

}  // namespace

TEST(ForcingsWavesDlg, TypeListOffersOnlyWhatIsAvailable) {
    struct Case {
        bool wind;
        int spectralWaveMode;
        QStringList entries;
    };
    const Case cases[] = {
        {false, 0, {"No waves", "Wave field"}},
        {true, 0, {"No waves", "Wave field", "Wave database"}},
        {false, 1, {"No waves", "Wave field", "Wave field from SW simulation"}},
        {true, 1, {"No waves", "Wave field", "Wave database", "Wave field from SW simulation"}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.entries.join(", ").toStdString());
        CSetupDocument doc;
        SetWind(doc, c.wind, 1);
        doc.GetModuleSelection()->SpectralWaveMode(c.spectralWaveMode);
        CRecordingHost host;
        auto dlg = OpenDialog(Waves(doc), host);
        QComboBox* type = Form(dlg)->TypeBox();
        EXPECT_EQ(Texts(type), c.entries);
        for (int i = 0; i < type->count(); ++i)
            EXPECT_EQ(type->itemData(i).toInt(), Waves(doc)->AvailableWaveTypes()[static_cast<size_t>(i)]);
    }
}

TEST(ForcingsWavesDlg, EachTypeShowsItsSubFormAndTheSettings) {
    CSetupDocument doc;
    SetWind(doc, true, 2);
    doc.GetModuleSelection()->SpectralWaveMode(1);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CForcingsWavesDlg* form = Form(dlg);
    struct Case {
        int type;
        QWidget* subForm;  // null: none shown
    };
    const Case cases[] = {{0, nullptr},
                          {1, form->WaveFieldForm()},
                          {2, form->WaveDatabaseForm()},
                          {3, nullptr}};
    for (const Case& c : cases) {
        SCOPED_TRACE(c.type);
        Waves(doc)->WaveType(c.type);
        form->SetData();
        EXPECT_EQ(form->TypeBox()->currentData().toInt(), c.type);
        EXPECT_EQ(form->SubForms()->isVisible(), c.subForm != nullptr);
        if (c.subForm) {
            EXPECT_EQ(form->SubForms()->currentWidget(), c.subForm);
        }
        const bool settings = c.type != 0;
        EXPECT_EQ(form->LiquefactionBox()->isVisible(), settings);
        EXPECT_EQ(form->LiquefactionFactorEdit()->isVisible(), settings);
        EXPECT_EQ(form->MinimumDepthEdit()->isVisible(), settings);
        EXPECT_EQ(Child<QWidget>(dlg.get(), "minimumWaterDepthLabel")->isVisible(), settings);
        for (int i = 0; i < 4; ++i)
            EXPECT_EQ(form->ShearStressButton(i)->isVisible(), settings);
        EXPECT_FALSE(form->ShearStressButton(1)->isEnabled());
        EXPECT_TRUE(form->ShearStressButton(0)->isEnabled());
    }
    EXPECT_TRUE(host.hints.empty());
}

TEST(ForcingsWavesDlg, StoredTypeThatIsNotOfferedMatchesNoEntry) {
    CSetupDocument doc;  // no wind: no database
    Waves(doc)->WaveType(2);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    EXPECT_EQ(Form(dlg)->TypeBox()->currentIndex(), -1);
    EXPECT_EQ(Waves(doc)->WaveType(), 2);  // the form itself changes nothing
}

TEST(ForcingsWavesDlg, EveryControlStoresItsValueAndSendsOneHint) {
    CSetupDocument doc;
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CForcingsWavesDlg* form = Form(dlg);
    CForcingsWavesKiv* w = Waves(doc);

    Choose(form->TypeBox(), "Wave field");
    EXPECT_EQ(w->WaveType(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(form->WaveFieldForm()->isVisible());

    EXPECT_FALSE(form->LiquefactionFactorEdit()->isEnabled());
    bedtest::ClickButton(form->LiquefactionBox());
    EXPECT_TRUE(w->IncludeLiquefaction());
    EXPECT_TRUE(form->LiquefactionFactorEdit()->isEnabled());
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1}));

    Enter(form->LiquefactionFactorEdit(), "0.75");
    EXPECT_EQ(w->LiquefactionFactor(), 0.75);
    Enter(form->MinimumDepthEdit(), "0.2");
    EXPECT_EQ(w->MinimumWaterDepth(), 0.2);
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1, 1}));

    EXPECT_TRUE(form->ShearStressButton(3)->isChecked());
    bedtest::ClickButton(form->ShearStressButton(0));
    EXPECT_EQ(w->ShearStressFormulation(), 0);
    bedtest::ClickButton(form->ShearStressButton(2));
    EXPECT_EQ(w->ShearStressFormulation(), 2);
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1, 1, 1, 1}));

    Choose(form->TypeBox(), "No waves");
    EXPECT_EQ(w->WaveType(), 0);
    EXPECT_FALSE(form->LiquefactionBox()->isVisible());
    EXPECT_TRUE(w->IncludeLiquefaction());  // kept while hidden
}

TEST(MTWaveFieldDlg, FormatSwitchesBetweenConstantsAndFile) {
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CMTWaveFieldDlg* f = Form(dlg)->WaveFieldForm();
    EXPECT_EQ(Texts(f->FormatBox()), (QStringList{"Constant", "Varying in time, constant in domain",
                                                  "Varying in time and domain"}));
    EXPECT_EQ(f->HeightEdit()->text(), "1");
    EXPECT_EQ(f->PeriodEdit()->text(), "3");
    EXPECT_EQ(f->DirectionEdit()->text(), "180");
    EXPECT_EQ(f->ItemEdit(1)->text(), "Item:   ");
    auto fileControls = [&] {
        return std::vector<QWidget*>{f->FileNameEdit(), f->SelectButton(), f->ItemEdit(1),
                                     f->ItemEdit(2), f->ItemEdit(3), f->SoftStartEdit()};
    };
    for (QWidget* w : fileControls())
        EXPECT_FALSE(w->isEnabled());
    EXPECT_TRUE(f->HeightEdit()->isEnabled());
    EXPECT_FALSE(f->ViewButton()->isEnabled());

    struct Case {
        const char* entry;
        int format;
    };
    // One step of the arrow keys each.
    for (const Case& c : {Case{"Varying in time, constant in domain", 1},
                          Case{"Varying in time and domain", 3},
                          Case{"Varying in time, constant in domain", 1}, Case{"Constant", 0}}) {
        SCOPED_TRACE(c.entry);
        host.Clear();
        Choose(f->FormatBox(), c.entry);
        EXPECT_EQ(Field(doc)->GetFormat(), c.format);
        EXPECT_EQ(host.hints, (std::vector<int>{1}));
        for (QWidget* w : fileControls())
            EXPECT_EQ(w->isEnabled(), c.format != 0);
        for (QWidget* w : {f->HeightEdit(), f->PeriodEdit(), f->DirectionEdit()})
            EXPECT_EQ(w->isEnabled(), c.format == 0);
    }
}

TEST(MTWaveFieldDlg, StoredFormatTwoShowsAsTimeAndDomainAndIsKept) {
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    Field(doc)->SetFormat(2);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CMTWaveFieldDlg* f = Form(dlg)->WaveFieldForm();
    EXPECT_EQ(f->FormatBox()->currentIndex(), 2);
    EXPECT_EQ(Field(doc)->GetFormat(), 2);
    Choose(f->FormatBox(), "Constant");
    Choose(f->FormatBox(), "Varying in time and domain");
    EXPECT_EQ(Field(doc)->GetFormat(), 3);
}

TEST(MTWaveFieldDlg, ConstantsAndSoftStartMarkTheSetupAsChanged) {
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CMTWaveFieldDlg* f = Form(dlg)->WaveFieldForm();
    Enter(f->HeightEdit(), "1.5");
    Enter(f->PeriodEdit(), "6");
    Enter(f->DirectionEdit(), "270");
    EXPECT_EQ(Field(doc)->WaveHeight(), 1.5);
    EXPECT_EQ(Field(doc)->WavePeriod(), 6.0);
    EXPECT_EQ(Field(doc)->WaveDirection(), 270.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1}));
    Choose(f->FormatBox(), "Varying in time, constant in domain");
    host.Clear();
    Enter(f->SoftStartEdit(), "1800");
    EXPECT_EQ(Field(doc)->SoftStartInterval(), 1800.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST(MTWaveFieldDlg, FileIsTypedOrSelectedWithItsItemsAndViewedWhenItWillDo) {
    DataFolder folder(TestName());
    const std::string series = folder.Write(
        "mouth.qrd0", "qrd0 1\nstart 2000-01-01 00:00:00\nstep 3600\nsteps 2\nitems 4\n"
                      "item \"wind\" 100274\nitem \"Hs\" 100097\nitem \"Tp\" 100085\n"
                      "item \"MWD\" 100095\nvalues\n1 2 3 4\n1 2 3 4\n");
    CSetupDocument doc;
    Waves(doc)->WaveType(1);
    Field(doc)->SetFormat(1);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CMTWaveFieldDlg* f = Form(dlg)->WaveFieldForm();

    Enter(f->FileNameEdit(), QString::fromStdString("  " + series + " "));
    EXPECT_EQ(Field(doc)->File()->FileName(), series);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_FALSE(f->ViewButton()->isEnabled());  // items 1, 2, 3 are not the wave quantities

    host.Clear();
    SelectorStub stub([](CZoFileSelectorDlg& d) {
        EXPECT_EQ(d.RequestCount(), 3);
        EXPECT_TRUE(d.AssignItem(0, 2));
        EXPECT_TRUE(d.AssignItem(1, 3));
        EXPECT_TRUE(d.AssignItem(2, 4));
    });
    QTest::mouseClick(f->SelectButton(), Qt::LeftButton);
    EXPECT_EQ(stub.calls, 1);
    EXPECT_EQ(stub.defaultExt, "qrd0");
    EXPECT_EQ(Field(doc)->File()->ItemNumber(), (std::vector<int>{2, 3, 4}));
    EXPECT_EQ(Field(doc)->File()->ItemName(1), "Hs");
    EXPECT_EQ(f->ItemEdit(1)->text(), "Item:   Hs");
    EXPECT_EQ(f->ItemEdit(2)->text(), "Item:   Tp");
    EXPECT_EQ(f->ItemEdit(3)->text(), "Item:   MWD");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    ASSERT_TRUE(f->ViewButton()->isEnabled());

    QTest::mouseClick(f->ViewButton(), Qt::LeftButton);
    CZoDataViewerDlg* viewer = nullptr;
    for (QWidget* w : QApplication::topLevelWidgets())
        if (auto* v = qobject_cast<CZoDataViewerDlg*>(w); v && v->isVisible())
            viewer = v;
    ASSERT_NE(viewer, nullptr);
    EXPECT_EQ(viewer->Items(), (std::vector<int>{2, 3, 4}));
    viewer->close();

    // The same file does not do for a field over the domain.
    Choose(f->FormatBox(), "Varying in time and domain");
    EXPECT_FALSE(f->ViewButton()->isEnabled());
}

TEST(MTWaveFieldDlg, SelectorExtensionAndFilterFollowTheFormat) {
    struct Case {
        int index;
        const char* file;
        const char* ext;
        const char* filterStart;
    };
    const Case cases[] = {
        {0, "", "", ""},
        {1, "", "qrd0", "Time series files (*.qrd0) |*.qrd0|Unstructured"},
        {2, "waves.QRD2", "qrd2", "2D grid files (*.qrd2) |*.qrd2|Unstructured"},
        {2, "waves.qrdu", "qrdu", "Unstructured data files (*.qrdu)|*.qrdu|2D grid"},
        {2, "x", "qrdu", "Unstructured data files (*.qrdu)|*.qrdu|2D grid"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.file);
        const CMTWaveFieldDlg::FileChoice choice = CMTWaveFieldDlg::FileChoiceFor(c.index, c.file);
        EXPECT_EQ(choice.defaultExt, c.ext);
        EXPECT_TRUE(choice.filter.starts_with(c.filterStart)) << choice.filter;
        EXPECT_EQ(choice.filter.empty(), c.index == 0);
    }
}

TEST(ForcingsWaveDBDlg, AxesResizeTheGridAndSendTheirHints) {
    CSetupDocument doc;
    SetWind(doc, true, 1);
    Waves(doc)->WaveType(2);
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CForcingsWaveDBDlg* db = Form(dlg)->WaveDatabaseForm();
    CForcingsWaveDBGrid* grid = db->Grid();
    ASSERT_TRUE(db->isVisible());
    EXPECT_EQ(db->StartEdit(0)->text(), "5");
    EXPECT_EQ(db->IncrementEdit(1)->text(), "90");
    EXPECT_EQ(db->CountEdit(2)->text(), "1");
    EXPECT_EQ(bedtest::RowTexts(grid, 0),
              (std::vector<std::string>{"No.", "Wind speed", "Wind direct.", "Water level",
                                        "File name", ""}));
    EXPECT_EQ(bedtest::RowTexts(grid, 1),
              (std::vector<std::string>{"1", "5", "90", "0", "", "  ...  "}));
    EXPECT_TRUE(grid->CellStyle(1, 1).readOnly);
    EXPECT_EQ(grid->CellStyle(1, 2).align, ZoCellAlign::Left);
    EXPECT_EQ(grid->CellStyle(1, 5).kind, ZoCellKind::PushButton);

    Enter(db->CountEdit(0), "3");
    Enter(db->CountEdit(1), "4");
    Enter(db->CountEdit(2), "2");
    EXPECT_EQ(Database(doc)->GetItemCount(), 24);
    EXPECT_EQ(grid->GetRowCount(), 24);
    EXPECT_EQ(bedtest::RowTexts(grid, 8),
              (std::vector<std::string>{"8", "5", "360", "1", "", "  ...  "}));
    EXPECT_EQ(bedtest::RowTexts(grid, 24),
              (std::vector<std::string>{"24", "15", "360", "1", "", "  ...  "}));
    EXPECT_EQ(host.hints, (std::vector<int>{2, 2, 2}));

    // A zero increment leaves one direction; the count says so at once.
    host.Clear();
    Enter(db->IncrementEdit(1), "0");
    EXPECT_EQ(Database(doc)->WindDirection()->Count(), 1);
    EXPECT_EQ(db->CountEdit(1)->text(), "1");
    EXPECT_EQ(grid->GetRowCount(), 6);
    Enter(db->StartEdit(2), "-1.5");
    EXPECT_EQ(bedtest::RowTexts(grid, 2)[3], "-0.5");
    EXPECT_EQ(host.hints, (std::vector<int>{4, 1}));

    // A negative count is refused where it is typed.
    {
        MessageRecorder messages;
        host.Clear();
        Enter(db->CountEdit(2), "-1");
        EXPECT_EQ(messages.Messages().size(), 1u);
        EXPECT_EQ(Database(doc)->WaterLevel()->Count(), 2);
        EXPECT_TRUE(host.hints.empty());
    }

    // A zero wind-speed increment is out of range: no rows, the items stay.
    Enter(db->IncrementEdit(0), "0");
    EXPECT_EQ(grid->GetRowCount(), 0);
    EXPECT_EQ(Database(doc)->GetItemCount(), 2);
    Enter(db->IncrementEdit(0), "2.5");
    EXPECT_EQ(grid->GetRowCount(), 2);
    EXPECT_EQ(Database(doc)->GetItemCount(), 2);
    EXPECT_EQ(Database(doc)->WindSpeed()->Count(), 1);  // collapsed by the zero increment
}

TEST(ForcingsWaveDBGrid, FileNamesAreTypedTrimmedOrSelected) {
    DataFolder folder(TestName());
    const std::string grid2d = folder.Write("calm.qrd2", WaveHeader("qrd2", "grid 1 1\n"));
    CSetupDocument doc;
    SetWind(doc, true, 1);
    Waves(doc)->WaveType(2);
    Database(doc)->WindSpeed()->Count(2);
    Database(doc)->ResizeToAxes();
    CRecordingHost host;
    auto dlg = OpenDialog(Waves(doc), host);
    CForcingsWaveDBGrid* grid = Form(dlg)->WaveDatabaseForm()->Grid();
    ASSERT_EQ(grid->GetRowCount(), 2);

    bedtest::ClickCell(grid, 2, CForcingsWaveDBGrid::kFileColumn);
    auto* editor = grid->viewport()->findChild<QLineEdit*>();
    ASSERT_NE(editor, nullptr);
    Enter(editor, "  storm.qrdu  ");
    QCoreApplication::processEvents();
    EXPECT_EQ(Database(doc)->GetItem(2)->File()->FileName(), "storm.qrdu");
    EXPECT_EQ(bedtest::RowTexts(grid, 2)[4], "storm.qrdu");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    host.Clear();
    SelectorStub stub([&](CZoFileSelectorDlg& d) {
        EXPECT_EQ(d.RequestCount(), 3);
        d.ChooseFile(grid2d);
    });
    bedtest::ClickCell(grid, 1, CForcingsWaveDBGrid::kSelectColumn);
    EXPECT_EQ(stub.calls, 1);
    EXPECT_EQ(stub.defaultExt, "kx2");
    EXPECT_EQ(stub.filter, "Wave database file (*.qrd2;*.kx2;*.qrdu)|*.qrd2; *.kx2; *.qrdu||");
    EXPECT_EQ(Database(doc)->GetItem(1)->File()->FileName(), grid2d);
    EXPECT_EQ(bedtest::RowTexts(grid, 1)[4], grid2d);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(Database(doc)->GetItem(1)->File()->CheckFile(), true);
}
