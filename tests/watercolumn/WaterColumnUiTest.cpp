#include "WaterColumnUiTestSupport.h"
#include "watercolumn/MTDensityFeedbackKiv.h"
#include "watercolumn/MTDepositionKiv.h"
#include "watercolumn/MTSandFractionGrid.h"
#include "watercolumn/MTSandFractionListKiv.h"
#include "watercolumn/MTSettlingGrid.h"
#include "watercolumn/MTSettlingKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QRadioButton>

using namespace uitest;
using namespace wcui;
using wctest::Node;

namespace {

CMTSettlingKiv* Settling(CSetupDocument& doc) {
    return Node<CMTSettlingKiv>(doc, {"WATER_COLUMN", "SETTLING_VELOCITY"});
}
CMTSandFractionListKiv* Sand(CSetupDocument& doc) {
    return Node<CMTSandFractionListKiv>(doc, {"WATER_COLUMN", "SAND_FRACTIONS"});
}
CMTDepositionKiv* Deposition(CSetupDocument& doc) {
    return Node<CMTDepositionKiv>(doc, {"WATER_COLUMN", "DEPOSITION"});
}
CMTDensityFeedbackKiv* Feedback(CSetupDocument& doc) {
    return Node<CMTDensityFeedbackKiv>(doc, {"WATER_COLUMN", "DENSITY_AND_VISCOSITY"});
}

bool Enabled(QWidget* dlg, const char* name) {
    return Child<QWidget>(dlg, name)->isEnabled();
}
bool Checked(QWidget* dlg, const char* name) {
    return Child<QAbstractButton>(dlg, name)->isChecked();
}
void Click(QWidget* dlg, const char* name) {
    ClickButton(Child<QAbstractButton>(dlg, name));
}

// Three fractions of which the second is sand.
void MakeSecondFractionSand(CSetupDocument& doc) {
    CMTSandFractionListKiv* sand = Sand(doc);
    sand->IncludeSandFractions(true);
    sand->GetItem(1)->IncludeSand(false);
    sand->GetItem(3)->IncludeSand(false);
}

} // namespace

// --- every section opens its own dialog, with its help topic ---------------------------

TEST_F(DialogTest, EveryWaterColumnNodeOpensItsDialogWithItsHelpTopic) {
    auto doc = wctest::NewSetup(2);
    const struct {
        std::initializer_list<std::string_view> path;
        unsigned long helpId;
    } cases[] = {
        {{"WATER_COLUMN", "SAND_FRACTIONS"}, 5034},
        {{"WATER_COLUMN", "SETTLING_VELOCITY"}, 5036},
        {{"WATER_COLUMN", "SETTLING_VELOCITY", "FRACTION_2"}, 5035},
        {{"WATER_COLUMN", "DEPOSITION"}, 5051},
        {{"WATER_COLUMN", "DEPOSITION", "FRACTION_2"}, 5020},
        {{"WATER_COLUMN", "DENSITY_AND_VISCOSITY"}, 5019},
        {{"DISPERSION", "HORIZONTAL_DISPERSION"}, 5024},
        {{"DISPERSION", "VERTICAL_DISPERSION", "SSC_FRACTION_2"}, 5023},
    };
    for (const auto& c : cases) {
        CZoSEKivBase* node = Node<CZoSEKivBase>(*doc, c.path);
        ASSERT_NE(node, nullptr);
        SCOPED_TRACE(NodePath(node));
        host.Clear();
        auto dlg = OpenDialog(node, host);
        ASSERT_NE(dlg, nullptr);
        QTest::keyClick(dlg.get(), Qt::Key_F1);
        EXPECT_EQ(host.helpIds, std::vector<unsigned long>{c.helpId});
        EXPECT_TRUE(host.hints.empty()) << "opening a dialog changed nothing";
    }
}

// --- sand fractions --------------------------------------------------------------------

TEST_F(DialogTest, SandGridIsGreyedUntilSandFractionsAreIncluded) {
    auto doc = wctest::NewSetup(3);
    CMTSandFractionListKiv* sand = Sand(*doc);
    auto dlg = OpenDialog(sand, host);
    auto* grid = Child<CMTSandFractionGrid>(dlg.get(), "sandFractionGrid");
    auto* include = Child<QCheckBox>(dlg.get(), "includeSandFractions");
    ASSERT_TRUE(grid && include);
    EXPECT_EQ(Headings(grid),
              (std::vector<std::string>{"Fraction", "Include", "Mean Settling Velocity [m/s]"}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"1", "2", "3"}));
    EXPECT_FALSE(include->isChecked());
    for (int row = 0; row <= 3; ++row)
        for (int col = 0; col <= 2; ++col)
            EXPECT_TRUE(grid->CellStyle(row, col).readOnly) << row << "," << col;

    // A greyed check box cannot be changed.
    ClickCell(grid, 2, CMTSandFractionGrid::kInclude);
    EXPECT_TRUE(sand->GetItem(2)->IncludeSand());
    EXPECT_TRUE(host.hints.empty());

    ClickButton(include);
    EXPECT_TRUE(sand->IncludeSandFractions());
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_FALSE(grid->CellStyle(0, 1).readOnly);
    EXPECT_FALSE(grid->CellStyle(2, CMTSandFractionGrid::kInclude).readOnly);
    EXPECT_FALSE(grid->CellStyle(2, CMTSandFractionGrid::kVelocity).readOnly);

    // Unmarking a fraction greys its velocity only.
    host.Clear();
    ClickCell(grid, 2, CMTSandFractionGrid::kInclude);
    EXPECT_FALSE(sand->GetItem(2)->IncludeSand());
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_TRUE(grid->CellStyle(2, CMTSandFractionGrid::kVelocity).readOnly);
    EXPECT_FALSE(grid->CellStyle(2, CMTSandFractionGrid::kInclude).readOnly);
    EXPECT_FALSE(grid->CellStyle(1, CMTSandFractionGrid::kVelocity).readOnly);

    // Unticking the switch keeps the marks and greys everything again.
    ClickButton(include);
    EXPECT_FALSE(sand->IncludeSandFractions());
    EXPECT_FALSE(sand->GetItem(2)->IncludeSand());
    EXPECT_TRUE(grid->CellStyle(1, CMTSandFractionGrid::kInclude).readOnly);
}

TEST_F(DialogTest, SandVelocityIsShownAndTakenInTheUsersUnit) {
    UseUnit(100128, "mm/s");
    auto doc = wctest::NewSetup(2);
    CMTSandFractionListKiv* sand = Sand(*doc);
    sand->IncludeSandFractions(true);
    auto dlg = OpenDialog(sand, host);
    auto* grid = Child<CMTSandFractionGrid>(dlg.get(), "sandFractionGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(CellText(grid, 1, CMTSandFractionGrid::kVelocity), "1");
    EXPECT_EQ(grid->CellStyle(1, CMTSandFractionGrid::kVelocity).EffectiveToolTip().toStdString(),
              "Settling velocity [mm/s]");

    EnterInCell(grid, 2, CMTSandFractionGrid::kVelocity, "2.5");
    EXPECT_DOUBLE_EQ(sand->GetItem(2)->StoredMeanSettlingVelocity(), 0.0025);
    EXPECT_DOUBLE_EQ(sand->GetItem(1)->StoredMeanSettlingVelocity(), 0.001);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_EQ(CellText(grid, 2, CMTSandFractionGrid::kVelocity), "2.5");
}

// --- settling --------------------------------------------------------------------------

TEST_F(DialogTest, SettlingFlocculationChoiceSwapsGridsAndDisablesItsFields) {
    auto doc = wctest::NewSetup(2);
    CMTSettlingKiv* settling = Settling(*doc);
    auto dlg = OpenDialog(settling, host);
    QWidget* d = dlg.get();
    auto* group = Child<QGroupBox>(d, "settlingGridGroup");
    auto* constantGrid = Child<CMTSettlingGrid>(d, "constantVelocityGrid");
    auto* coefficientGrid = Child<CMTSettlingGrid>(d, "coefficientGrid");
    ASSERT_TRUE(group && constantGrid && coefficientGrid);

    // Defaults: flocculation on, hindered settling off.
    EXPECT_TRUE(Checked(d, "includeFlocculation"));
    EXPECT_FALSE(Checked(d, "includeHinderedSettling"));
    EXPECT_EQ(group->title().toStdString(), "Settling Velocity Coefficient");
    EXPECT_TRUE(coefficientGrid->isVisibleTo(d));
    EXPECT_FALSE(constantGrid->isVisibleTo(d));
    for (const char* on : {"includeHinderedSettling", "flocculationConcentration",
                           "hinderedSettlingConcentration", "sedimentDensity"})
        EXPECT_TRUE(Enabled(d, on)) << on;
    for (const char* off : {"winterwerp", "richardsonZaki", "gellingPoint"})
        EXPECT_FALSE(Enabled(d, off)) << off;

    Click(d, "constantSettlingVelocity");
    EXPECT_EQ(settling->Flocculation(), 0);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_EQ(group->title().toStdString(), "Constant Velocity Settling");
    EXPECT_TRUE(constantGrid->isVisibleTo(d));
    EXPECT_FALSE(coefficientGrid->isVisibleTo(d));
    for (const char* off :
         {"includeHinderedSettling", "winterwerp", "richardsonZaki", "gellingPoint",
          "sedimentDensity", "flocculationConcentration", "hinderedSettlingConcentration"})
        EXPECT_FALSE(Enabled(d, off)) << off;
    // The items follow at once: the constant velocity is the value in use.
    EXPECT_FALSE(settling->GetItem(2)->ConstantSettlingVelocity()->IsDisabled());
    EXPECT_TRUE(settling->GetItem(2)->SettlingVelocityCoefficient()->IsDisabled());

    Click(d, "includeFlocculation");
    EXPECT_EQ(settling->Flocculation(), 1);
    EXPECT_TRUE(Enabled(d, "includeHinderedSettling"));
    EXPECT_FALSE(Enabled(d, "gellingPoint"));
    EXPECT_TRUE(settling->GetItem(2)->ConstantSettlingVelocity()->IsDisabled());
    EXPECT_FALSE(settling->GetItem(2)->SettlingVelocityCoefficient()->IsDisabled());
}

TEST_F(DialogTest, SettlingHinderedChoiceIsStoredAsNoneWinterwerpOrRichardsonZaki) {
    auto doc = wctest::NewSetup(1);
    CMTSettlingKiv* settling = Settling(*doc);
    auto dlg = OpenDialog(settling, host);
    QWidget* d = dlg.get();
    EXPECT_TRUE(Checked(d, "winterwerp")); // shown for 0 as well

    Click(d, "includeHinderedSettling");
    EXPECT_EQ(settling->HinderedSettling(), 1);
    EXPECT_TRUE(Enabled(d, "richardsonZaki"));
    EXPECT_TRUE(Enabled(d, "gellingPoint"));
    Click(d, "richardsonZaki");
    EXPECT_EQ(settling->HinderedSettling(), 2);
    Click(d, "winterwerp");
    EXPECT_EQ(settling->HinderedSettling(), 1);
    Click(d, "richardsonZaki");
    Click(d, "includeHinderedSettling");
    EXPECT_EQ(settling->HinderedSettling(), 0);
    EXPECT_TRUE(Checked(d, "winterwerp"));
    EXPECT_FALSE(Enabled(d, "winterwerp"));
    EXPECT_EQ(host.hints, std::vector<int>(5, kHintValueChanged));

    // Values no choice stands for show none and survive clicks on the other choices.
    settling->HinderedSettling(3);
    settling->Flocculation(4);
    dlg->SetData();
    EXPECT_TRUE(Checked(d, "includeHinderedSettling"));
    EXPECT_FALSE(Checked(d, "winterwerp") || Checked(d, "richardsonZaki"));
    EXPECT_FALSE(Checked(d, "includeFlocculation") || Checked(d, "constantSettlingVelocity"));
    EXPECT_TRUE(Enabled(d, "gellingPoint")); // flocculation above 0 counts as on
    Click(d, "includeFlocculation");
    EXPECT_EQ(settling->Flocculation(), 1);
    EXPECT_EQ(settling->HinderedSettling(), 3);

    // Below 0 the box shows unchecked: ticking it includes hindered settling.
    settling->HinderedSettling(-1);
    dlg->SetData();
    EXPECT_FALSE(Checked(d, "includeHinderedSettling"));
    Click(d, "includeHinderedSettling");
    EXPECT_EQ(settling->HinderedSettling(), 1);
    EXPECT_TRUE(Checked(d, "includeHinderedSettling"));
    EXPECT_TRUE(Checked(d, "winterwerp"));
}

TEST_F(DialogTest, SettlingConcentrationsAreEnteredInTheUsersUnit) {
    UseUnit(100403, "g/m^3");
    UseUnit(100017, "g/cm^3");
    auto doc = wctest::NewSetup(1);
    CMTSettlingKiv* settling = Settling(*doc);
    auto dlg = OpenDialog(settling, host);
    auto* cfloc = Child<QLineEdit>(dlg.get(), "flocculationConcentration");
    auto* density = Child<QLineEdit>(dlg.get(), "sedimentDensity");
    ASSERT_TRUE(cfloc && density);
    EXPECT_EQ(cfloc->text().toStdString(), "10");
    EXPECT_EQ(density->text().toStdString(), "2.65");

    Enter(cfloc, "20");
    EXPECT_DOUBLE_EQ(settling->Cfloc(), 0.02);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    Enter(density, "2.6");
    EXPECT_DOUBLE_EQ(settling->RhoSediment(), 2600.0);
    EXPECT_DOUBLE_EQ(settling->Cfloc(), 0.02);
    EXPECT_EQ(host.hints.size(), 2u);
}

TEST_F(DialogTest, SettlingGridsSkipSandFractionsAndLinkToTheirItems) {
    auto doc = wctest::NewSetup(3);
    MakeSecondFractionSand(*doc);
    CMTSettlingKiv* settling = Settling(*doc);
    // Only the third item's coefficient comes from a file: each grid shows its own value.
    settling->GetItem(3)->SettlingVelocityCoefficient()->Format(1);
    auto dlg = OpenDialog(settling, host);
    auto* constantGrid = Child<CMTSettlingGrid>(dlg.get(), "constantVelocityGrid");
    auto* coefficientGrid = Child<CMTSettlingGrid>(dlg.get(), "coefficientGrid");
    ASSERT_TRUE(constantGrid && coefficientGrid);

    for (CMTSettlingGrid* grid : {constantGrid, coefficientGrid}) {
        EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Fraction", "Format", "Edit"}));
        EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"Fraction 1", "Fraction 3"}));
        EXPECT_EQ(Column(grid, CMTSettlingGrid::kEdit),
                  (std::vector<std::string>{"Go to...", "Go to..."}));
        EXPECT_TRUE(grid->CellStyle(2, CMTSettlingGrid::kFormat).readOnly);
    }
    EXPECT_EQ(CellText(coefficientGrid, 2, CMTSettlingGrid::kFormat),
              settling->GetItem(3)->SettlingVelocityCoefficient()->FormatText());
    EXPECT_EQ(CellText(constantGrid, 2, CMTSettlingGrid::kFormat),
              settling->GetItem(3)->ConstantSettlingVelocity()->FormatText());
    EXPECT_NE(CellText(coefficientGrid, 2, CMTSettlingGrid::kFormat),
              CellText(constantGrid, 2, CMTSettlingGrid::kFormat));

    ClickCell(coefficientGrid, 2, CMTSettlingGrid::kEdit);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{settling->GetItem(3)});

    // The rows follow the sand marks when the dialog is refreshed.
    Sand(*doc)->GetItem(2)->IncludeSand(false);
    dlg->SetData();
    EXPECT_EQ(Column(coefficientGrid, 0),
              (std::vector<std::string>{"Fraction 1", "Fraction 2", "Fraction 3"}));
    host.Clear();
    ClickCell(coefficientGrid, 2, CMTSettlingGrid::kEdit);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{settling->GetItem(2)});
}

TEST_F(DialogTest, SettlingItemShowsTheValueTheFlocculationChoiceNeeds) {
    auto doc = wctest::NewSetup(1);
    CMTSettlingKiv* settling = Settling(*doc);
    CMTSettlingItemKiv* item = settling->GetItem(1);
    // Validated without flocculation, then flocculation turned on elsewhere.
    settling->Flocculation(0);
    item->ValidateData();
    settling->Flocculation(1);

    auto dlg = OpenDialog(item, host);
    auto* forms = Child<CSubFormCollection>(dlg.get(), "settlingValues");
    ASSERT_NE(forms, nullptr);
    ASSERT_EQ(forms->Count(), 2);
    EXPECT_EQ(forms->ShownSubForm(), 1);
    auto* coefficient = Child<CFemInDataDlg>(dlg.get(), "settlingVelocityCoefficient");
    ASSERT_NE(coefficient, nullptr);
    EXPECT_EQ(coefficient->Data(), item->SettlingVelocityCoefficient());
    EXPECT_TRUE(coefficient->FormatBox()->isEnabled());
    EXPECT_TRUE(coefficient->ConstantEdit()->isEnabled());

    Enter(coefficient->ConstantEdit(), "0.002");
    EXPECT_DOUBLE_EQ(item->SettlingVelocityCoefficient()->Constant(), 0.002);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});

    settling->Flocculation(0);
    dlg->SetData();
    EXPECT_EQ(forms->ShownSubForm(), 0);
    EXPECT_TRUE(
        Child<CFemInDataDlg>(dlg.get(), "constantSettlingVelocity")->ConstantEdit()->isEnabled());
}

// --- deposition ------------------------------------------------------------------------

TEST_F(DialogTest, DepositionProfileChoiceEnablesTheCentroidHeight) {
    auto doc = wctest::NewSetup(1);
    CMTDepositionKiv* deposition = Deposition(*doc);
    auto dlg = OpenDialog(deposition, host);
    QWidget* d = dlg.get();
    EXPECT_TRUE(Checked(d, "teeterProfile"));
    EXPECT_FALSE(Enabled(d, "centroidHeight"));

    Click(d, "rouseProfile");
    EXPECT_EQ(deposition->ConcentrationProfile(), 0);
    EXPECT_TRUE(Enabled(d, "centroidHeight"));
    // A plain number, whatever the user's units.
    UseUnit(100403, "g/m^3");
    Enter(Child<QLineEdit>(d, "centroidHeight"), "0.45");
    EXPECT_DOUBLE_EQ(deposition->CentroidHeight(), 0.45);
    Click(d, "teeterProfile");
    EXPECT_EQ(deposition->ConcentrationProfile(), 1);
    EXPECT_FALSE(Enabled(d, "centroidHeight"));
    EXPECT_DOUBLE_EQ(deposition->CentroidHeight(), 0.45);
    EXPECT_EQ(host.hints, std::vector<int>(3, kHintValueChanged));

    // A profile no choice stands for shows none, and stays until one is chosen.
    deposition->ConcentrationProfile(7);
    dlg->SetData();
    EXPECT_FALSE(Checked(d, "rouseProfile") || Checked(d, "teeterProfile"));
    EXPECT_FALSE(Enabled(d, "centroidHeight"));
    EXPECT_EQ(deposition->ConcentrationProfile(), 7);
    Click(d, "rouseProfile");
    EXPECT_EQ(deposition->ConcentrationProfile(), 0);
}

TEST_F(DialogTest, DepositionGridShowsEveryFractionSandIncluded) {
    auto doc = wctest::NewSetup(3);
    MakeSecondFractionSand(*doc);
    CMTDepositionKiv* deposition = Deposition(*doc);
    auto dlg = OpenDialog(deposition, host);
    auto* grid = dlg->findChild<CZoGridWnd*>("depositionGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Fraction", "Format", "Edit"}));
    EXPECT_EQ(Column(grid, 0),
              (std::vector<std::string>{"Fraction 1", "Fraction 2", "Fraction 3"}));
    EXPECT_TRUE(grid->CellStyle(1, 1).readOnly);
    EXPECT_EQ(CellText(grid, 1, 1), deposition->GetItem(1)->CriticalShearStress()->FormatText());
    bool titled = false;
    for (QGroupBox* box : dlg->findChildren<QGroupBox*>())
        titled = titled || box->title() == "Critical  Shear Stress for Deposition";
    EXPECT_TRUE(titled);

    ClickCell(grid, 2, 2);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{deposition->GetItem(2)});

    // The item dialog edits the critical shear stress in the user's unit.
    UseUnit(100152, "dyn/cm^2");
    auto item = OpenDialog(deposition->GetItem(2), host);
    auto* form = Child<CFemInDataDlg>(item.get(), "criticalShearStress");
    ASSERT_NE(form, nullptr);
    Enter(form->ConstantEdit(), "1.5");
    EXPECT_DOUBLE_EQ(deposition->GetItem(2)->CriticalShearStress()->Constant(), 0.15);
}

// --- density feedback ------------------------------------------------------------------

TEST_F(DialogTest, DensityFeedbackSwitchEnablesItsFieldsAndKeepsTheirValues) {
    UseUnit(100017, "g/cm^3");
    UseUnit(100403, "g/l");
    auto doc = wctest::NewSetup(1);
    CMTDensityFeedbackKiv* feedback = Feedback(*doc);
    auto dlg = OpenDialog(feedback, host);
    QWidget* d = dlg.get();
    const char* fields[] = {"sedimentDensity", "viscosityBase", "viscosityConcentration"};
    EXPECT_FALSE(Checked(d, "densityFeedback"));
    for (const char* f : fields)
        EXPECT_FALSE(Enabled(d, f)) << f;
    for (QLabel* label : d->findChildren<QLabel*>())
        EXPECT_FALSE(label->isEnabled()) << label->text().toStdString();

    Click(d, "densityFeedback");
    EXPECT_TRUE(feedback->IncludeDensityFeedback());
    for (const char* f : fields)
        EXPECT_TRUE(Enabled(d, f)) << f;
    for (QLabel* label : d->findChildren<QLabel*>())
        EXPECT_TRUE(label->isEnabled()) << label->text().toStdString();

    auto* density = Child<QLineEdit>(d, "sedimentDensity");
    EXPECT_EQ(density->text().toStdString(), "2.65");
    Enter(density, "2.5");
    EXPECT_DOUBLE_EQ(feedback->DensityOfSediment(), 2500.0);
    Enter(Child<QLineEdit>(d, "viscosityConcentration"), "3");
    EXPECT_DOUBLE_EQ(feedback->ConcentrationInViscosityFormula(), 3.0);
    Enter(Child<QLineEdit>(d, "viscosityBase"), "1.25");
    EXPECT_DOUBLE_EQ(feedback->BaseInViscosityFormula(), 1.25);
    EXPECT_EQ(host.hints, std::vector<int>(4, kHintValueChanged));

    Click(d, "densityFeedback");
    EXPECT_FALSE(feedback->IncludeDensityFeedback());
    EXPECT_FALSE(Enabled(d, "sedimentDensity"));
    EXPECT_DOUBLE_EQ(feedback->DensityOfSediment(), 2500.0);
}
