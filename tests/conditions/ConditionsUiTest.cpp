#include "conditions/ConditionsTestSupport.h"
#include "conditions/InitialConditionsFractionDistributionGrid.h"
#include "conditions/InitialConditionsFractionsGrid.h"
#include "conditions/InitialConditionsLayersGrid.h"
#include "conditions/MTBoundaryConditionsComponentItemDlg.h"
#include "conditions/MTBoundaryConditionsGridDlg.h"
#include "conditions/MTBoundaryGisNavigationDlg.h"
#include "conditions/MTBoundaryConditionsPropertySheet.h"
#include "conditions/MTSourceGrid.h"
#include "conditions/MTSourceItemGrid.h"
#include "conditions/MTSourceItemSubDlg.h"
#include "watercolumn/WaterColumnUiTestSupport.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/HDSourceGisPropSheet.h"
#include "widgets/ZoDataViewerDlg.h"
#include "widgets/ZoFileSelectorDlg.h"

#include <QComboBox>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QMenu>
#include <QPushButton>
#include <QTabWidget>
#include <QTest>

using namespace uitest;
using namespace wcui;
using namespace condtest;

namespace {
CInitialConditionsKiv* IC(CSetupDocument& doc) { return InitialConditions(doc.Module()); }

std::vector<QString> Tabs(CFemPropertySheetDlg* sheet) {
    std::vector<QString> out;
    for (int i = 0; i < sheet->GetPageCount(); ++i)
        out.push_back(sheet->Tabs()->tabText(i));
    return out;
}
}  // namespace

TEST_F(DialogTest, ConcentrationAndThicknessGridsShowFormatsAndLinkToTheirItems) {
    auto doc = NewSetup(3, 2);
    IC(*doc)->Fractions()->GetItem(2)->Value()->Format(2);
    IC(*doc)->Fractions()->GetItem(2)->Value()->QrdData()->FileName("ssc.qrd1");
    auto dlg = OpenDialog(IC(*doc)->Fractions(), host);
    EXPECT_EQ(dlg->GetHelpID(), 5007u);
    auto* grid = Child<CInitialConditionsFractionsGrid>(dlg.get(), "fractionsGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Fraction", "Format", "Edit"}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"Fraction 1", "Fraction 2", "Fraction 3"}));
    EXPECT_EQ(Column(grid, 1), (std::vector<std::string>{"Constant 0 kg/m^3", "Varying in domain: ssc.qrd1",
                                                         "Constant 0 kg/m^3"}));
    EXPECT_TRUE(grid->CellStyle(1, 1).readOnly);
    EXPECT_EQ(grid->CellStyle(1, 1).align, ZoCellAlign::Center);
    ClickCell(grid, 3, 2);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{IC(*doc)->Fractions()->GetItem(3)});
    EXPECT_TRUE(host.hints.empty());
    // No row operations: the list follows the number of fractions only.
    grid->SetCurrentCell(2, 1);
    QTest::keyClick(grid, Qt::Key_Delete, Qt::ControlModifier);
    EXPECT_EQ(IC(*doc)->Fractions()->GetItemCount(), 3);
    ModelDefinition(doc->Module())->NumberOfFractions(4);
    dlg->SetData();
    EXPECT_EQ(grid->GetRowCount(), 4);

    host.Clear();
    auto layers = OpenDialog(IC(*doc)->Layers(), host);
    EXPECT_EQ(layers->GetHelpID(), 5009u);
    auto* layerGrid = Child<CInitialConditionsLayersGrid>(layers.get(), "layersGrid");
    ASSERT_NE(layerGrid, nullptr);
    EXPECT_EQ(Headings(layerGrid), (std::vector<std::string>{"Layer", "Format", "Edit"}));
    EXPECT_EQ(Column(layerGrid, 0), (std::vector<std::string>{"Layer 1", "Layer 2"}));
    ClickCell(layerGrid, 1, 2);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{IC(*doc)->Layers()->GetItem(1)});
}

TEST_F(DialogTest, ConcentrationAndThicknessItemsEditTheirValue) {
    auto doc = NewSetup(2, 2);
    struct Case {
        CZoSEKivBase* item;
        CFemInDataKiv* value;
        unsigned long help;
    };
    const Case cases[] = {
        {IC(*doc)->Fractions()->GetItem(2), IC(*doc)->Fractions()->GetItem(2)->Value(), 5008},
        {IC(*doc)->Layers()->GetItem(1), IC(*doc)->Layers()->GetItem(1)->Value(), 5010},
    };
    for (const Case& c : cases) {
        host.Clear();
        auto dlg = OpenDialog(c.item, host);
        EXPECT_EQ(dlg->GetHelpID(), c.help);
        auto* form = Child<CFemInDataDlg>(dlg.get(), "value");
        ASSERT_NE(form, nullptr);
        EXPECT_EQ(form->Data(), c.value);
        Enter(form->ConstantEdit(), "0.5");
        EXPECT_EQ(host.hints, (std::vector<int>{1}));
        EXPECT_DOUBLE_EQ(c.value->Constant(),
                         CZoEditStyle().SetOvuUnitBaseGroup(c.value->ItemType()).ToInternal(0.5));
    }
}

TEST_F(DialogTest, DistributionGridIsLayersByFractionsAndStoresAShare) {
    auto doc = NewSetup(3, 2);
    auto dlg = OpenDialog(IC(*doc)->FractionDistribution(), host);
    EXPECT_EQ(dlg->GetHelpID(), 5006u);
    auto* grid = Child<CInitialConditionsFractionDistributionGrid>(dlg.get(), "distributionGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"", "Fraction 1", "Fraction 2", "Fraction 3"}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"Layer 1", "Layer 2"}));
    EXPECT_EQ(Column(grid, 3), (std::vector<std::string>{"34", "34"}));
    // Every column as wide as its heading, the row headings as wide as theirs.
    for (int c = 0; c < 3; ++c)
        EXPECT_GE(grid->columnWidth(c), grid->horizontalHeader()->fontMetrics().horizontalAdvance("Fraction 1"));
    EXPECT_GE(grid->verticalHeader()->width(), grid->verticalHeader()->fontMetrics().horizontalAdvance("Layer 2"));
    EXPECT_FALSE(grid->LastFit().horizontalBar || grid->LastFit().verticalBar);
    EXPECT_TRUE(grid->verticalHeader()->font().bold());

    EnterInCell(grid, 2, 1, "40");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    const auto* layer = IC(*doc)->FractionDistribution()->GetItem(2);
    EXPECT_EQ(layer->Share(1), 40.0f);
    EXPECT_EQ(layer->Share(2), 33.0f);
    EXPECT_EQ(IC(*doc)->FractionDistribution()->GetItem(1)->Share(1), 33.0f);

    // Fewer fractions: the columns follow on the next refresh, and a column gone meanwhile
    // reads nothing.
    ModelDefinition(doc->Module())->NumberOfFractions(2);
    EXPECT_EQ(CellText(grid, 1, 3), "");
    dlg->SetData();
    EXPECT_EQ(grid->GetColCount(), 2);
    EXPECT_EQ(Column(grid, 2), (std::vector<std::string>{"50", "50"}));
}

TEST_F(DialogTest, BoundaryConditionListViewLaysOutABlockPerBoundary) {
    auto doc = NewSetup(2, 1, 2);
    MTBoundaryConditions(doc->Module())->GetItem(2)->GetItem(1)->Type(1);
    CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(0);
    auto dlg = OpenDialog(MTBoundaryConditions(doc->Module()), host);
    auto* sheet = dynamic_cast<CMTBoundaryConditionsPropertySheet*>(dlg.get());
    ASSERT_NE(sheet, nullptr);
    EXPECT_EQ(Tabs(sheet), (std::vector<QString>{"Geographic View", "List view"}));
    EXPECT_EQ(sheet->GetPage(0)->GetHelpID(), 5013u);
    EXPECT_EQ(sheet->GetPage(1)->GetHelpID(), 5016u);
    auto* grid = Child<CMTBoundaryConditionsGridDlg>(dlg.get(), "boundaryConditionsGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Boundary Name", "Format", "Edit"}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"B1", "Fraction 1", "Fraction 2", "B2",
                                                         "Fraction 1", "Fraction 2"}));
    EXPECT_EQ(Column(grid, 1), (std::vector<std::string>{"", "Zero gradient", "Zero gradient", "",
                                                         "Specified values", "Zero gradient"}));
    EXPECT_EQ(Column(grid, 2), (std::vector<std::string>{"", "Go to...", "Go to...", "",
                                                         "Go to...", "Go to..."}));
    EXPECT_TRUE(grid->CellStyle(2, 1).readOnly);
    // A boundary's row is its title drawn across the row, not a heading beside grey cells.
    EXPECT_TRUE(grid->IsTitleRow(1) && grid->IsTitleRow(4));
    EXPECT_FALSE(grid->IsTitleRow(2) || grid->IsTitleRow(6));
    EXPECT_FALSE(grid->CellStyle(1, 1).readOnly || grid->CellStyle(1, 2).readOnly);

    ClickCell(grid, 6, 2);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{
                                 MTBoundaryConditions(doc->Module())->GetItem(2)->GetItem(2)}));
    host.Clear();
    ClickCell(grid, 4, 2);
    EXPECT_TRUE(host.selected.empty());
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(DialogTest, BoundaryGridOpenWhileTheHostListChangesNeverReachesPastIt) {
    auto doc = NewSetup(3, 1, 4);
    auto dlg = OpenDialog(MTBoundaryConditions(doc->Module()), host);
    auto* grid = Child<CMTBoundaryConditionsGridDlg>(dlg.get(), "boundaryConditionsGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(grid->GetRowCount(), 16);
    // Boundaries and fractions go while the grid shows them; before any refresh, every
    // row it may still draw maps into the lists as they are now.
    doc->GetBoundaryNames()->SetItemCount(1, 1);
    ModelDefinition(doc->Module())->NumberOfFractions(1);
    for (int row = 1; row <= 16; ++row)
        for (int col = 0; col <= 2; ++col)
            (void)grid->CellStyle(row, col);
    EXPECT_EQ(grid->ItemNodeOfRow(16), nullptr);
    grid->OnClickedButtonRowCol(16, 2);
    EXPECT_TRUE(host.selected.empty());
    dlg->SetData();
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"B1", "Fraction 1"}));
    // And the source list view the same.
    auto sources = NewSetup(1, 1, 0, 3);
    auto list = OpenDialog(MTSources(sources->Module()), host);
    auto* sourceGrid = Child<CMTSourceGrid>(list.get(), "sourceGrid");
    ASSERT_NE(sourceGrid, nullptr);
    EXPECT_EQ(sourceGrid->GetRowCount(), 3);
    sources->GetSources()->Delete(1, 1);
    sourceGrid->Redraw();
    EXPECT_EQ(Column(sourceGrid, 1), (std::vector<std::string>{"S2", "S3"}));
}

TEST_F(DialogTest, BoundaryConditionSheetRemembersThePageShown) {
    auto doc = NewSetup(1, 1, 1);
    CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(5);
    auto dlg = OpenDialog(MTBoundaryConditions(doc->Module()), host);
    auto* sheet = dynamic_cast<CMTBoundaryConditionsPropertySheet*>(dlg.get());
    ASSERT_NE(sheet, nullptr);
    EXPECT_EQ(sheet->GetActiveIndex(), 0);
    sheet->SetActivePage(1);
    EXPECT_EQ(CMTBoundaryConditionsPropertySheet::GetInitialSelectedPage(), 1);
    auto again = OpenDialog(MTBoundaryConditions(doc->Module()), host);
    EXPECT_EQ(dynamic_cast<CMTBoundaryConditionsPropertySheet*>(again.get())->GetActiveIndex(), 1);
    CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(0);
}

TEST_F(DialogTest, BoundaryValueFormEnablesWhatItsTypeAndFormatUse) {
    auto doc = NewSetup(1, 1, 1);
    CMTBoundaryConditionsComponentItemKiv* item = MTBoundaryConditions(doc->Module())->GetItem(1)->GetItem(1);
    auto dlg = OpenDialog(item, host);
    auto* form = dynamic_cast<CMTBoundaryConditionsComponentItemDlg*>(dlg.get());
    ASSERT_NE(form, nullptr);
    EXPECT_EQ(form->GetHelpID(), 5015u);
    QComboBox* type = form->TypeBox();
    ASSERT_EQ(type->count(), 3);
    EXPECT_EQ(type->itemText(0), "Land");
    EXPECT_EQ(type->itemText(1), "Specified values");
    EXPECT_EQ(type->currentText(), "Zero gradient");
    auto* value = Child<QGroupBox>(dlg.get(), "valueGroup");
    auto* soft = Child<QGroupBox>(dlg.get(), "softStartGroup");
    EXPECT_FALSE(value->isEnabled());
    EXPECT_FALSE(soft->isEnabled());

    Choose(type, "Specified values");
    EXPECT_EQ(item->Type(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(value->isEnabled());
    EXPECT_TRUE(form->ConstantEdit()->isEnabled());
    EXPECT_FALSE(form->FileNameEdit()->isEnabled());
    EXPECT_FALSE(form->TimeInterpolationBox()->isEnabled());

    host.Clear();
    Enter(form->ConstantEdit(), "0.04");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_DOUBLE_EQ(item->Constant(), 0.04 * CZoEditStyle().SetOvuUnitBaseGroup(100403).ToInternal(1.0));

    Choose(form->FormatBox(), "Varying in time");
    EXPECT_EQ(item->Format(), 1);
    EXPECT_FALSE(form->ConstantEdit()->isEnabled());
    EXPECT_TRUE(form->FileNameEdit()->isEnabled());
    EXPECT_TRUE(form->TimeInterpolationBox()->isEnabled());
    EXPECT_FALSE(form->SpaceInterpolationBox()->isEnabled());
    Enter(form->FileNameEdit(), "sea ssc.qrd0");
    EXPECT_EQ(item->QrdData()->FileName(), "sea ssc.qrd0");

    // Soft start "None" leaves its interval and reference value off.
    Choose(form->SoftTypeBox(), "None");
    EXPECT_EQ(item->TypeSoft(), 0);
    EXPECT_FALSE(form->SoftTimeEdit()->isEnabled());
    Choose(form->SoftTypeBox(), "Linear");
    EXPECT_TRUE(form->SoftTimeEdit()->isEnabled());
    EXPECT_EQ(doc->ValidateAll(), 1) << ::testing::PrintToString(testsupport::Messages(*doc));
}

TEST_F(DialogTest, BoundaryComponentFormNamesItsBoundary) {
    auto doc = NewSetup(1, 1, 2);
    auto dlg = OpenDialog(MTBoundaryConditions(doc->Module())->GetItem(2), host);
    EXPECT_EQ(dlg->GetHelpID(), 5014u);
    EXPECT_EQ(Child<QLabel>(dlg.get(), "boundary")->text(), "Boundary B2, code 3");
}

TEST_F(DialogTest, TenThousandBoundariesOpenInTheListView) {
    auto doc = NewSetup(8, 1, 10000);
    auto dlg = OpenDialog(MTBoundaryConditions(doc->Module()), host, QSize(800, 600));
    auto* grid = Child<CMTBoundaryConditionsGridDlg>(dlg.get(), "boundaryConditionsGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(grid->GetRowCount(), 90000);
    EXPECT_EQ(CellText(grid, 89983, 0), "B9999");
    EXPECT_EQ(CellText(grid, 90000, 0), "Fraction 8");
    EXPECT_TRUE(grid->LastFit().verticalBar);
    // The corner's heading and the titles of boundaries far down the list are shown whole.
    const QFontMetrics fm(grid->horizontalHeader()->font());
    const int rowWidth = grid->verticalHeader()->width() + grid->horizontalHeader()->length();
    EXPECT_LE(fm.horizontalAdvance("Boundary Name"), grid->verticalHeader()->width());
    EXPECT_LE(fm.horizontalAdvance("B9999"), rowWidth);
    EXPECT_TRUE(grid->IsTitleRow(89983));
    EXPECT_FALSE(grid->IsTitleRow(89984));
}

TEST_F(DialogTest, SourceSheetListsTheHydrodynamicSources) {
    auto doc = NewSetup(1, 1, 0, 2);
    doc->GetSources()->GetItem(2)->Include(false);
    CHDSourceGisPropSheet::SetInitialSelectedPage(0);
    auto dlg = OpenDialog(MTSources(doc->Module()), host);
    auto* sheet = dynamic_cast<CHDSourceGisPropSheet*>(dlg.get());
    ASSERT_NE(sheet, nullptr);
    EXPECT_EQ(Tabs(sheet), (std::vector<QString>{"Geographic View", "List view"}));
    EXPECT_EQ(sheet->GetPage(1)->GetHelpID(), 5041u);
    sheet->ShowHelp();
    sheet->SetActivePage(1);
    sheet->ShowHelp();
    EXPECT_EQ(host.helpIds, (std::vector<unsigned long>{5037, 5038}));
    CHDSourceGisPropSheet::SetInitialSelectedPage(0);
    auto* grid = Child<CMTSourceGrid>(dlg.get(), "sourceGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Source No.", "Name", ""}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"1", "2"}));
    EXPECT_EQ(Column(grid, 1), (std::vector<std::string>{"S1", "S2"}));
    EXPECT_TRUE(grid->CellStyle(1, 1).readOnly);
    EXPECT_FALSE(grid->CellStyle(1, 0).readOnly);
    EXPECT_TRUE(grid->CellStyle(2, 0).readOnly);
    EXPECT_EQ(grid->columnWidth(0), 150);
    ClickCell(grid, 2, 2);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{MTSources(doc->Module())->GetItem(2)});
}

TEST_F(DialogTest, SourceFormShowsEachFractionsValueOrFile) {
    auto doc = NewSetup(3, 1, 0, 1);
    CMTSourceItemKiv* source = MTSources(doc->Module())->GetItem(1);
    source->GetItem(1)->Value()->Constant(0.3);
    CFemInDataKiv* file = source->GetItem(2)->Value();
    file->Format(1);
    file->QrdData()->FileName("data\\outfall ssc.qrd0");
    file->QrdData()->ItemNumbers({3});
    auto dlg = OpenDialog(source, host);
    EXPECT_EQ(dlg->GetHelpID(), 5040u);
    auto* grid = Child<CMTSourceItemGrid>(dlg.get(), "sourceItemGrid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(Headings(grid), (std::vector<std::string>{"Component", "Value/Item", ""}));
    EXPECT_EQ(Column(grid, 0), (std::vector<std::string>{"Fraction 1", "Fraction 2", "Fraction 3"}));
    EXPECT_EQ(Column(grid, 1), (std::vector<std::string>{"Value: 0.3", "Item: 3 (File: outfall ssc.qrd0)",
                                                         "Value: 0"}));
    EXPECT_EQ(grid->CellStyle(1, 1).align, ZoCellAlign::Right);
    EXPECT_EQ(grid->CellStyle(2, 1).align, ZoCellAlign::Left);
    EXPECT_TRUE(grid->CellStyle(2, 1).readOnly);
    ClickCell(grid, 2, 2);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{source->GetItem(2)});
}

TEST_F(DialogTest, SourceComponentFormStoresItsTypeAndViewsTheLocation) {
    auto doc = NewSetup(2, 1, 0, 3);
    CMTSourceItemSubKiv* component = MTSources(doc->Module())->GetItem(3)->GetItem(2);
    auto dlg = OpenDialog(component, host);
    auto* form = dynamic_cast<CMTSourceItemSubDlg*>(dlg.get());
    ASSERT_NE(form, nullptr);
    EXPECT_EQ(form->GetHelpID(), 5039u);
    ASSERT_EQ(form->TypeBox()->count(), 2);
    EXPECT_EQ(form->TypeBox()->itemText(0), "Specified concentration");
    EXPECT_EQ(form->TypeBox()->itemText(1), "Excess concentration");
    EXPECT_EQ(form->TypeBox()->currentIndex(), 0);
    ASSERT_NE(Child<CFemInDataDlg>(dlg.get(), "value"), nullptr);
    EXPECT_EQ(Child<CFemInDataDlg>(dlg.get(), "value")->Data(), component->Value());

    Choose(form->TypeBox(), "Excess concentration");
    EXPECT_EQ(component->TypeOfComponent(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    CHDSourceGisPropSheet::SetInitialSelectedPage(1);
    QTest::mouseClick(form->ViewLocationButton(), Qt::LeftButton);
    EXPECT_EQ(host.selected, std::vector<CZoSEKivBase*>{MTSources(doc->Module())});
    EXPECT_EQ(CHDSourceGisPropSheet::GetInitialSelectedPage(), 0);
    EXPECT_EQ(CHDSourceGisPropSheet::GetInitialSelectedFeature(), 3);
    // The sheet then opens with that source selected, once.
    auto sheet = OpenDialog(MTSources(doc->Module()), host);
    auto* grid = Child<CMTSourceGrid>(sheet.get(), "sourceGrid");
    ASSERT_NE(grid, nullptr);
    ASSERT_EQ(grid->GetSelectedRowRanges().size(), 1u);
    EXPECT_EQ(grid->GetSelectedRowRanges()[0].top, 3);
    EXPECT_EQ(CHDSourceGisPropSheet::GetInitialSelectedFeature(), 0);
}

TEST_F(DialogTest, BoundaryMapOpensFormsAndKeepsItsExtent) {
    CSetupDocument::OpenResult r = CSetupDocument::Open(MUD_SOURCE_DIR "/examples/estuary.setup");
    ASSERT_TRUE(r.document);
    CSetupDocument& doc = *r.document;
    CMTBoundaryConditionsKiv* bc = MTBoundaryConditions(doc.Module());
    CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(0);
    host.setupDir = MUD_SOURCE_DIR "/examples";
    auto dlg = OpenDialog(bc, host);
    auto* map = Child<CMTBoundaryGisNavigationDlg>(dlg.get(), "boundaryMap");
    ASSERT_NE(map, nullptr);
    EXPECT_EQ(map->ContourItem(), 2);
    EXPECT_GE(map->BoundaryLayer(), 0);

    // The menu: the default entries and, where no boundary is hit, no "Edit".
    QMenu menu;
    EXPECT_EQ(map->BuildContextMenu(menu, QPointF(-1000, -1000)), 0);
    EXPECT_EQ(menu.actions().front()->text(), "Fit to mesh");
    // An "Edit" entry opens the boundary, or its fraction's value by the sub-index.
    QAction boundary;
    boundary.setData(2 << 16);
    map->OnEditCommand(&boundary);
    QAction value;
    value.setData((1 << 16) | 3);
    map->OnEditCommand(&value);
    QAction past;
    past.setData(9 << 16);
    map->OnEditCommand(&past);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{bc->GetItem(2), bc->GetItem(1)->GetItem(3)}));

    // The extent shown last comes back on the next boundary map.
    const QRectF extent(480000, 5940000, 20000, 15000);
    map->Map()->SetViewRect(extent);
    const QRectF shared = CMTBoundaryGisNavigationDlg::SharedView();
    EXPECT_FALSE(shared.isEmpty());
    auto next = OpenDialog(bc, host);
    auto* nextMap = Child<CMTBoundaryGisNavigationDlg>(next.get(), "boundaryMap");
    ASSERT_NE(nextMap, nullptr);
    EXPECT_EQ(CMTBoundaryGisNavigationDlg::SharedView(), shared);
}

// The data file of a boundary value is chosen and shown as every other data file is.
TEST_F(DialogTest, BoundaryValueSelectsAndViewsItsDataFile) {
    auto doc = NewSetup(1, 1, 1);
    CMTBoundaryConditionsComponentItemKiv* item = MTBoundaryConditions(doc->Module())->GetItem(1)->GetItem(1);
    item->Type(1);
    auto dlg = OpenDialog(item, host);
    auto* form = dynamic_cast<CMTBoundaryConditionsComponentItemDlg*>(dlg.get());
    ASSERT_NE(form, nullptr);
    EXPECT_EQ(form->SelectButton()->text(), "Select ...");
    EXPECT_EQ(form->ViewButton()->text(), "View ...");
    // A constant has no file; a file not chosen yet cannot be shown.
    EXPECT_FALSE(form->SelectButton()->isEnabled());
    Choose(form->FormatBox(), "Varying in time");
    EXPECT_TRUE(form->SelectButton()->isEnabled());
    EXPECT_FALSE(form->ViewButton()->isEnabled());

    const std::string path = MUD_SOURCE_DIR "/examples/data/boundary_sea.qrd0";
    host.Clear();
    int shown = 0;
    const ZoFileSelectorHook previous = ZoSetFileSelectorHook([&](CZoFileSelectorDlg& d) {
        ++shown;
        d.Prepare();
        EXPECT_EQ(d.RequestCount(), 1);
        EXPECT_EQ(d.Request(0).OvuTypes(), (std::vector<long>{100403}));
        if (shown == 2)
            return int(QDialog::Rejected);
        d.ChooseFile(path);
        EXPECT_TRUE(d.AssignItem(0, 2));
        d.accept();
        return d.result();
    });
    QTest::mouseClick(form->SelectButton(), Qt::LeftButton);
    EXPECT_EQ(item->QrdData()->FileName(), path);
    EXPECT_EQ(item->QrdData()->ItemNumbers(), (std::vector<int>{2}));
    EXPECT_EQ(item->QrdData()->ItemName(), "mud 2");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    // Cancel changes nothing.
    host.Clear();
    QTest::mouseClick(form->SelectButton(), Qt::LeftButton);
    ZoSetFileSelectorHook(previous);
    EXPECT_EQ(shown, 2);
    EXPECT_TRUE(host.hints.empty());

    ASSERT_TRUE(form->ViewButton()->isEnabled());
    QTest::mouseClick(form->ViewButton(), Qt::LeftButton);
    auto* viewer = form->findChild<CZoDataViewerDlg*>();
    ASSERT_TRUE(viewer);
    EXPECT_EQ(viewer->Path(), path);
    EXPECT_EQ(viewer->Items(), (std::vector<int>{2}));
    viewer->close();
}

// A click on the boundary map stays on the map and highlights the boundary; "Edit" under the
// cursor lists the boundary and each of its fractions, and opens the one chosen.
TEST_F(DialogTest, BoundaryMapClickHighlightsAndEditListsTheFractions) {
    CSetupDocument::OpenResult r = CSetupDocument::Open(MUD_SOURCE_DIR "/examples/estuary.setup");
    ASSERT_TRUE(r.document);
    CMTBoundaryConditionsKiv* bc = MTBoundaryConditions(r.document->Module());
    CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(0);
    host.setupDir = MUD_SOURCE_DIR "/examples";
    auto dlg = OpenDialog(bc, host);
    auto* map = Child<CMTBoundaryGisNavigationDlg>(dlg.get(), "boundaryMap");
    ASSERT_NE(map, nullptr);
    const int layer = map->BoundaryLayer();
    ASSERT_GE(layer, 0);
    map->Map()->FitToMesh();

    emit map->Map()->featureClicked(layer, 2);
    EXPECT_TRUE(host.selected.empty());
    EXPECT_EQ(map->Map()->Overlay(layer).selected, 2);

    const CZoMapFeature& sea = map->Map()->Overlay(layer).features.at(0);
    ASSERT_EQ(sea.number, 1);
    const QPointF middle = sea.points.at(sea.points.size() / 2);
    QMenu menu;
    EXPECT_EQ(map->BuildContextMenu(menu, map->Map()->ToPixel(middle.x(), middle.y())), 1 + 3);
    QMenu* edit = menu.actions().back()->menu();
    ASSERT_TRUE(edit);
    EXPECT_EQ(edit->title(), "Edit");
    QStringList texts;
    for (const QAction* a : edit->actions())
        texts << a->text();
    EXPECT_EQ(texts, (QStringList{"Sea boundary", "Sea boundary: Fraction 1", "Sea boundary: Fraction 2",
                                  "Sea boundary: Fraction 3"}));
    map->OnEditCommand(edit->actions().at(2));
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{bc->GetItem(1)->GetItem(2)}));
}
