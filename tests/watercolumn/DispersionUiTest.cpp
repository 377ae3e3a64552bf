#include "WaterColumnUiTestSupport.h"
#include "watercolumn/MTDispersionGrid.h"
#include "watercolumn/MTDispersionKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QComboBox>

using namespace uitest;
using namespace wcui;
using wctest::Node;

namespace {

CMTDispersionListKiv* List(CSetupDocument& doc, const char* direction) {
    return Node<CMTDispersionListKiv>(doc, {"DISPERSION", direction});
}

// Whether a sub-form is open for editing (its format, and the constant when constant).
bool Open(CFemInDataDlg* form) {
    return form->FormatBox()->isEnabled();
}

} // namespace

TEST_F(DialogTest, DispersionGridShowsFormulationsAndLinksToItems) {
    auto doc = wctest::NewSetup(3);
    for (const char* direction : {"HORIZONTAL_DISPERSION", "VERTICAL_DISPERSION"}) {
        SCOPED_TRACE(direction);
        CMTDispersionListKiv* list = List(*doc, direction);
        list->GetItem(2)->FormulationType(CMTDispersionItemKiv::kNoDispersion);
        list->GetItem(3)->FormulationType(CMTDispersionItemKiv::kDispersionCoefficient);
        host.Clear();
        auto dlg = OpenDialog(list, host);
        auto* grid = Child<CMTDispersionGrid>(dlg.get(), "dispersionGrid");
        ASSERT_NE(grid, nullptr);
        EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Component", "Formulation", ""}));
        EXPECT_EQ(Column(grid, 0),
                  (std::vector<std::string>{"Fraction 1", "Fraction 2", "Fraction 3"}));
        EXPECT_EQ(Column(grid, CMTDispersionGrid::kFormulation),
                  (std::vector<std::string>{"Scaled eddy viscosity formulation", "No dispersion",
                                            "Dispersion coefficient formulation"}));
        EXPECT_TRUE(grid->CellStyle(1, CMTDispersionGrid::kFormulation).readOnly);

        ClickCell(grid, 3, CMTDispersionGrid::kEdit);
        EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{list->GetItem(3)});
        EXPECT_TRUE(host.hints.empty());

        // A fraction added meanwhile shows on the next refresh.
        ModelDefinition(doc->Module())->NumberOfFractions(4);
        dlg->SetData();
        EXPECT_EQ(grid->GetRowCount(), 4);
        ModelDefinition(doc->Module())->NumberOfFractions(3);
    }
}

TEST_F(DialogTest, DispersionFormulationChoiceOpensOnlyItsValue) {
    auto doc = wctest::NewSetup(2);
    CMTDispersionItemKiv* item = List(*doc, "VERTICAL_DISPERSION")->GetItem(2);
    auto dlg = OpenDialog(item, host);
    auto* box = Child<QComboBox>(dlg.get(), "formulation");
    auto* eddy = Child<CFemInDataDlg>(dlg.get(), "scaledEddyViscosity");
    auto* coefficient = Child<CFemInDataDlg>(dlg.get(), "dispersionCoefficient");
    ASSERT_TRUE(box && eddy && coefficient);
    ASSERT_EQ(box->count(), 3);
    EXPECT_EQ(box->itemText(0).toStdString(), "No dispersion");
    EXPECT_EQ(box->itemText(1).toStdString(), "Dispersion coefficient formulation");
    EXPECT_EQ(box->itemText(2).toStdString(), "Scaled eddy viscosity formulation");
    EXPECT_EQ(eddy->Data(), item->ScaledEddyViscosity());
    EXPECT_EQ(coefficient->Data(), item->DispersionCoefficient());

    // A new item: scaled eddy viscosity, the coefficient not in use.
    EXPECT_EQ(box->currentIndex(), 2);
    EXPECT_TRUE(Open(eddy));
    EXPECT_FALSE(Open(coefficient));
    EXPECT_TRUE(host.hints.empty());

    Choose(box, "Dispersion coefficient formulation");
    EXPECT_EQ(item->FormulationType(), 1);
    EXPECT_EQ(item->ScaledEddyViscosity()->Type(), 1);
    EXPECT_EQ(item->DispersionCoefficient()->Type(), 1);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_FALSE(Open(eddy));
    EXPECT_TRUE(Open(coefficient));
    EXPECT_TRUE(item->ScaledEddyViscosity()->IsDisabled());
    EXPECT_FALSE(item->DispersionCoefficient()->IsDisabled());

    // The coefficient is entered in the user's unit.
    UseUnit(100153, "ft^2/s");
    coefficient->SetData();
    Enter(coefficient->ConstantEdit(), "1");
    EXPECT_DOUBLE_EQ(item->DispersionCoefficient()->Constant(), 0.3048 * 0.3048);

    host.Clear();
    Choose(box, "No dispersion");
    EXPECT_EQ(item->FormulationType(), 0);
    EXPECT_EQ(item->ScaledEddyViscosity()->Type(), 0);
    EXPECT_EQ(item->DispersionCoefficient()->Type(), 0);
    EXPECT_EQ(host.hints, std::vector<int>{kHintValueChanged});
    EXPECT_FALSE(Open(eddy));
    EXPECT_FALSE(Open(coefficient));

    // A type no entry stands for shows none and opens neither value.
    item->FormulationType(5);
    auto again = OpenDialog(item, host);
    EXPECT_EQ(Child<QComboBox>(again.get(), "formulation")->currentIndex(), -1);
    EXPECT_FALSE(Open(Child<CFemInDataDlg>(again.get(), "scaledEddyViscosity")));
    EXPECT_FALSE(Open(Child<CFemInDataDlg>(again.get(), "dispersionCoefficient")));
}
