#include "BedUiTestSupport.h"
#include "bed/MTErosionGrid.h"
#include "bed/MTErosionItemDlg.h"
#include "bed/MTErosionListDlg.h"
#include "bed/MTErosionListKiv.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QGroupBox>
#include <QLabel>
#include <QRadioButton>

using namespace bedtest;
using namespace uitest;

namespace {

CMTErosionListKiv* Erosion(CSetupDocument& doc) {
    return Node<CMTErosionListKiv>(doc, {"BED", "EROSION"});
}

} // namespace

TEST(MTErosionListDlg, GridShowsEachLayerAndFollowsTheLayerCount) {
    auto doc = NewSetup(2);
    CRecordingHost host;
    auto dlg = OpenDialog(Erosion(*doc), host);
    auto* grid = Child<CMTErosionGrid>(dlg.get(), "grid");
    ASSERT_NE(grid, nullptr);

    EXPECT_EQ(RowTexts(grid, 0), (std::vector<std::string>{"Layer", "Mud type", ""}));
    EXPECT_EQ(RowTexts(grid, 1), (std::vector<std::string>{"Layer 1", "Soft mud", "Go to..."}));
    EXPECT_EQ(RowTexts(grid, 2), (std::vector<std::string>{"Layer 2", "Hard mud", "Go to..."}));
    EXPECT_EQ(grid->CellStyle(1, 2).kind, ZoCellKind::PushButton);
    // Only the mud type is greyed as read-only; titles and links are not.
    EXPECT_TRUE(grid->CellStyle(1, 1).readOnly);
    EXPECT_FALSE(grid->CellStyle(1, 0).readOnly);
    EXPECT_FALSE(grid->CellStyle(1, 2).readOnly);

    // The model definition changes the count while the dialog is shown; the editor then
    // refreshes the dialog.
    SetLayers(*doc, 4);
    dlg->SetData();
    ASSERT_EQ(grid->GetRowCount(), 4);
    EXPECT_EQ(RowTexts(grid, 4), (std::vector<std::string>{"Layer 4", "Hard mud", "Go to..."}));
    Erosion(*doc)->GetItem(3)->SoftMud(true);
    dlg->SetData();
    EXPECT_EQ(grid->CellStyle(3, 1).DisplayText(), "Soft mud");
}

TEST(MTErosionListDlg, GoToSelectsTheLayerOfItsRow) {
    auto doc = NewSetup(3);
    CRecordingHost host;
    auto dlg = OpenDialog(Erosion(*doc), host);
    auto* grid = Child<CMTErosionGrid>(dlg.get(), "grid");
    ClickCell(grid, 3, 2);
    ClickCell(grid, 1, 2);
    EXPECT_EQ(host.selected,
              (std::vector<CZoSEKivBase*>{Erosion(*doc)->GetItem(3), Erosion(*doc)->GetItem(1)}));
    // The mud type is no link.
    ClickCell(grid, 2, 1);
    EXPECT_EQ(host.selected.size(), 2u);
    EXPECT_TRUE(host.hints.empty());
}

TEST(MTErosionListDlg, MaximumConcentrationIsEditedInTheUsersUnit) {
    UserUnitsReset reset;
    ASSERT_TRUE(CUnitUtil::SetUserUnit(100403, UnitNamed(100403, "g/m^3")));
    auto doc = NewSetup(1);
    CRecordingHost host;
    auto dlg = OpenDialog(Erosion(*doc), host);
    auto* field = Child<CZoNumberEdit>(dlg.get(), "maxConcentration");
    ASSERT_NE(field, nullptr);
    EXPECT_EQ(field->text(), "50000"); // the default 50 kg/m^3
    EXPECT_EQ(Child<QLabel>(dlg.get(), "maxConcentrationUnit")->text(), "g/m^3");

    Enter(field, "2000");
    EXPECT_EQ(Erosion(*doc)->MaxConcentration(), 2.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(field->text(), "2000");
}

TEST(MTErosionItemDlg, ShowsTheLayersValuesInItsForms) {
    auto doc = NewSetup(2);
    CRecordingHost host;
    CMTErosionItemKiv* layer2 = Erosion(*doc)->GetItem(2);
    auto dlg = OpenDialog(layer2, host);
    EXPECT_TRUE(Child<QRadioButton>(dlg.get(), "hardMud")->isChecked());
    EXPECT_FALSE(Child<QRadioButton>(dlg.get(), "softMud")->isChecked());
    EXPECT_EQ(Child<CZoNumberEdit>(dlg.get(), "powerOfErosion")->text(), "1");

    // Erosion coefficient above, critical shear stress below, each in its own frame.
    auto* upper = Child<CSubFormCollection>(dlg.get(), "erosionCoefficient");
    auto* lower = Child<CSubFormCollection>(dlg.get(), "criticalShearStress");
    ASSERT_TRUE(upper && lower);
    ASSERT_EQ(upper->Count(), 1);
    ASSERT_EQ(lower->Count(), 1);
    EXPECT_EQ(upper->SubForm(0)->Data(), layer2->ErosionCoefficient());
    EXPECT_EQ(lower->SubForm(0)->Data(), layer2->CriticalShearStress());
    EXPECT_EQ(lower->SubForm(0)->ConstantEdit()->text(), "0.25");
    EXPECT_TRUE(upper->isVisible() && lower->isVisible());
    EXPECT_LT(upper->mapTo(dlg.get(), QPoint()).y(), lower->mapTo(dlg.get(), QPoint()).y());
    EXPECT_EQ(qobject_cast<QGroupBox*>(upper->parentWidget())->title(), "Erosion coefficient");
    EXPECT_EQ(qobject_cast<QGroupBox*>(lower->parentWidget())->title(), "Critical shear stress");
}

TEST(MTErosionItemDlg, SwitchingMudTypeReplacesThePowerOfErosion) {
    auto doc = NewSetup(2);
    CRecordingHost host;
    CMTErosionItemKiv* layer = Erosion(*doc)->GetItem(2);
    auto dlg = OpenDialog(layer, host);
    dlg->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(dlg.get()));
    auto* soft = Child<QRadioButton>(dlg.get(), "softMud");
    auto* hard = Child<QRadioButton>(dlg.get(), "hardMud");
    auto* power = Child<CZoNumberEdit>(dlg.get(), "powerOfErosion");

    Enter(power, "3.5");
    EXPECT_EQ(layer->PowerOfErosion(), 3.5);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    // A power typed but not yet stored is stored as the field loses focus, and then
    // replaced by the soft-mud power.
    host.Clear();
    power->setFocus();
    Type(power, "4");
    ClickButton(soft);
    EXPECT_TRUE(layer->SoftMud());
    EXPECT_EQ(layer->PowerOfErosion(), 8.3);
    EXPECT_EQ(power->text(), "8.3");
    EXPECT_TRUE(soft->isChecked());
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1}));

    // Clicking the type already chosen keeps the power the user gave.
    Enter(power, "5");
    host.Clear();
    ClickButton(soft);
    EXPECT_EQ(layer->PowerOfErosion(), 5.0);
    EXPECT_EQ(power->text(), "5");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    host.Clear();
    ClickButton(hard);
    EXPECT_FALSE(layer->SoftMud());
    EXPECT_EQ(layer->PowerOfErosion(), 1.0);
    EXPECT_EQ(power->text(), "1");
    EXPECT_TRUE(hard->isChecked());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}
