#include "fem/FemInDataKiv.h"
#include "fem/UnitUtil.h"
#include "support/UiTestSupport.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/FemPropertySheetDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QComboBox>
#include <QLabel>
#include <QTabWidget>
#include <QTest>
#include <QToolButton>
#include <QVBoxLayout>

#include <gtest/gtest.h>

using namespace uitest;

namespace {

// Chooses the n-th unit of a quantity as the user's unit.
void UseUnit(long type, int n) {
    const QuantityInfo* q = CUnitUtil::FindQuantity(type);
    ASSERT_TRUE(q);
    ASSERT_TRUE(CUnitUtil::SetUserUnit(type, q->units.at(n).id));
}

// A dialog with nothing of its own, for fields bound to plain values.
class FieldDialog : public ::testing::Test {
protected:
    void SetUp() override {
        dialog.Attach(nullptr, &host);
        dialog.resize(300, 200);
        dialog.show();
    }
    void TearDown() override { CUnitUtil::ResetUserUnits(); }

    CRecordingHost host;
    CZoSEDlgBase dialog;
};

TEST_F(FieldDialog, UnitFieldShowsTheUsersUnitAndStoresTheInternalOne) {
    UseUnit(100128, 1);  // mm/s
    double velocity = 0.001;
    auto* field = new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(100128), &dialog);
    field->BindDouble(&dialog, velocity);
    EXPECT_EQ(field->text(), "1");
    EXPECT_EQ(field->toolTip(), "Settling velocity [mm/s]");

    Enter(field, "2.5");
    EXPECT_DOUBLE_EQ(velocity, 0.0025);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(field->text(), "2.5");

    // A changed unit shows in the next refresh.
    UseUnit(100128, 0);
    dialog.SetData();
    EXPECT_EQ(field->text(), "0.0025");
}

TEST_F(FieldDialog, LeavingAChangedFieldSendsExactlyOneHint) {
    double a = 1.0, b = 2.0;
    auto* first = new CZoNumberEdit(&dialog);
    auto* second = new CZoNumberEdit(&dialog);
    first->BindDouble(&dialog, a);
    second->BindDouble(&dialog, b);
    second->move(0, 40);
    first->show();
    second->show();
    dialog.activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&dialog));
    first->setFocus();
    Type(first, "4");
    EXPECT_TRUE(host.hints.empty());
    second->setFocus();
    EXPECT_EQ(a, 4.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    first->setFocus();
    second->setFocus();
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST_F(FieldDialog, LeavingAFieldUntouchedKeepsTheValueAShortDisplayRounds) {
    double value = 0.123456789;
    auto* field = new CZoNumberEdit(CZoEditStyle().SetFormat("%.2f"), &dialog);
    field->BindDouble(&dialog, value);
    EXPECT_EQ(field->text(), "0.12");
    QTest::keyClick(field, Qt::Key_Return);
    field->clearFocus();
    EXPECT_EQ(value, 0.123456789);
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(FieldDialog, RefusedEntriesLeaveTheValueAndShowItAgain) {
    UseUnit(100128, 1);  // mm/s
    double velocity = 0.001;
    auto* field = new CZoNumberEdit(
        CZoEditStyle().SetOvuUnitBaseGroup(100128).SetRange(0.0, 0.01), &dialog);
    field->BindDouble(&dialog, velocity);
    MessageRecorder messages;
    Enter(field, "abc");
    Enter(field, "20");     // 0.02 m/s
    Enter(field, "1e999");  // not finite
    EXPECT_EQ(velocity, 0.001);
    EXPECT_EQ(field->text(), "1");
    EXPECT_TRUE(host.hints.empty());
    EXPECT_EQ(messages.Messages(),
              (std::vector<QString>{"Please enter a number.",
                                    "Please enter a number between 0 and 10 mm/s.",
                                    "Please enter a number."}));
    Enter(field, "10");
    EXPECT_DOUBLE_EQ(velocity, 0.01);

    // A double saved as a float: beyond the float range is refused, not saved as inf.
    double concentration = 50.0;
    auto* big = new CZoNumberEdit(CZoEditStyle().SetFloatRange(), &dialog);
    big->BindDouble(&dialog, concentration);
    Enter(big, "1e42");
    EXPECT_EQ(concentration, 50.0);
    EXPECT_EQ(messages.Messages().back(),
              "Please enter a number between -3.4028234663852886e+38 and 3.4028234663852886e+38.");
    Enter(big, "3e38");
    EXPECT_EQ(concentration, 3e38);
}

TEST_F(FieldDialog, FloatsIntsAndFormatsShowAndReadAsTheirKind) {
    float f = 0.1f;
    int n = 4;
    auto* floatField = new CZoNumberEdit(&dialog);
    floatField->BindFloat(&dialog, f);
    auto* intField = new CZoNumberEdit(CZoEditStyle().SetFormat("%s"), &dialog);
    intField->BindInt(&dialog, n);
    EXPECT_EQ(floatField->text(), "0.1");
    EXPECT_EQ(intField->text(), "4");
    Enter(floatField, "0.3");
    EXPECT_EQ(f, 0.3f);

    MessageRecorder messages;
    Enter(intField, "3.5");
    Enter(intField, "99999999999");
    EXPECT_EQ(n, 4);
    ASSERT_EQ(messages.Messages().size(), 2u);
    EXPECT_EQ(messages.Messages()[0], "Please enter an integer.");
    EXPECT_EQ(messages.Messages()[1], "Please enter an integer between -2147483648 and 2147483647.");
    Enter(intField, "+7");
    EXPECT_EQ(n, 7);

    // Only a single floating conversion is taken as a format.
    CZoEditStyle style;
    EXPECT_EQ(style.SetFormat("%s").GetFormat(), "");
    EXPECT_EQ(style.SetFormat("%d").GetFormat(), "");
    EXPECT_EQ(style.SetFormat("%f %f").GetFormat(), "");
    EXPECT_EQ(style.SetFormat("%.3f %%").GetFormat(), "%.3f %%");
    EXPECT_EQ(style.Format(2.0, ZoNumberKind::Double), "2.000 %");
}

class InDataSubForm : public ::testing::Test {
protected:
    InDataSubForm()
        : node(new CZoSEKivBase("Source", "SOURCE", &root)),
          data(new CFemInDataKiv("CONCENTRATION", "Concentration", 3, false, false, 0.5, 100403,
                                 node)) {
        root.AddChild(node);
        node->AddChild(data);
        dialog.Attach(node, &host);
        UseUnit(100403, 1);  // g/m^3
        form = new CFemInDataDlg(data, &dialog, &dialog);
        new QVBoxLayout(&dialog);
        dialog.layout()->addWidget(form);
        dialog.show();
    }
    ~InDataSubForm() override { CUnitUtil::ResetUserUnits(); }

    CZoSEKivGlobalBase root;
    CZoSEKivBase* node;
    CFemInDataKiv* data;
    CRecordingHost host;
    CZoSEDlgBase dialog;
    CFemInDataDlg* form = nullptr;
};

TEST_F(InDataSubForm, ConstantInTheUsersUnitThenADataFileWithItems) {
    QComboBox* format = form->FormatBox();
    QStringList formats;
    for (int i = 0; i < format->count(); ++i)
        formats << format->itemText(i);
    EXPECT_EQ(formats, (QStringList{"Constant", "Varying in time", "Varying in domain",
                                    "Varying in time and domain"}));
    EXPECT_EQ(form->ConstantEdit()->text(), "500");
    EXPECT_TRUE(form->ConstantEdit()->isEnabled());
    EXPECT_FALSE(form->FileNameEdit()->isEnabled());
    EXPECT_FALSE(form->BrowseButton()->isEnabled());

    Enter(form->ConstantEdit(), "250");
    EXPECT_DOUBLE_EQ(data->Constant(), 0.25);

    Choose(format, "Varying in time");
    EXPECT_EQ(data->Format(), 1);
    EXPECT_FALSE(form->ConstantEdit()->isEnabled());
    EXPECT_TRUE(form->FileNameEdit()->isEnabled());
    EXPECT_TRUE(form->ItemNumbersEdit()->isEnabled());

    Enter(form->FileNameEdit(), "data/inflow.qrd0");
    EXPECT_EQ(data->QrdData()->FileName(), "data/inflow.qrd0");
    {
        FileChooserStub chooser("/elsewhere/tide.qrd0");
        QTest::mouseClick(form->BrowseButton(), Qt::LeftButton);
        EXPECT_EQ(chooser.Calls(), 1);
        EXPECT_EQ(chooser.LastStartPath(), "/setups/data/inflow.qrd0");
    }
    EXPECT_EQ(data->QrdData()->FileName(), "/elsewhere/tide.qrd0");
    EXPECT_EQ(form->FileNameEdit()->text(), "/elsewhere/tide.qrd0");

    Enter(form->ItemNumbersEdit(), "1, 3,4");
    EXPECT_EQ(data->QrdData()->ItemNumbers(), (std::vector<int>{1, 3, 4}));
    EXPECT_EQ(form->ItemNumbersEdit()->text(), "1, 3, 4");
    Enter(form->ItemNameEdit(), "Surface");
    EXPECT_EQ(data->QrdData()->ItemName(), "Surface");
    EXPECT_EQ(host.hints, (std::vector<int>(6, 1)));
    EXPECT_TRUE(node->GetHasBeenTouched());
}

TEST_F(InDataSubForm, BadItemNumbersAndCancelledBrowsingStoreNothing) {
    Choose(form->FormatBox(), "Varying in domain");
    host.Clear();
    MessageRecorder messages;
    Enter(form->ItemNumbersEdit(), "1, x");
    Enter(form->ItemNumbersEdit(), "0");
    EXPECT_EQ(data->QrdData()->ItemNumbers(), (std::vector<int>{1}));
    EXPECT_EQ(form->ItemNumbersEdit()->text(), "1");
    EXPECT_EQ(messages.Messages().size(), 2u);
    FileChooserStub cancelled("");
    QTest::mouseClick(form->BrowseButton(), Qt::LeftButton);
    EXPECT_EQ(data->QrdData()->FileName(), "");
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(InDataSubForm, AFormatTheValueMayNotTakeIsShownAsRead) {
    data->Format(8);  // vertical, from a file; the value varies in time and domain only
    form->SetData();
    QComboBox* format = form->FormatBox();
    EXPECT_EQ(format->currentText(), "Varying in vertical");
    EXPECT_EQ(format->count(), 5);
    Choose(format, "Varying in domain");
    EXPECT_EQ(data->Format(), 2);
    EXPECT_EQ(format->count(), 4);
}

TEST_F(InDataSubForm, DisabledFormsAndValuesOfferNoControls) {
    form->EnableControls(false);
    for (QWidget* w : form->findChildren<QWidget*>()) {
        if (!qobject_cast<QLabel*>(w)) {
            EXPECT_FALSE(w->isEnabled()) << w->objectName().toStdString();
        }
    }
    form->EnableControls(true);
    EXPECT_TRUE(form->FormatBox()->isEnabled());
    data->Disable(true);
    form->SetData();
    EXPECT_FALSE(form->FormatBox()->isEnabled());
}

TEST(SubFormCollection, OneSubFormPerDataInputChildShownOneAtATime) {
    CZoSEKivGlobalBase root;
    auto* node = new CZoSEKivBase("Item", "ITEM", &root);
    root.AddChild(node);
    node->AddChild(new CFemInDataKiv("A", "A", 1, false, false, 1.0, 100403, node));
    node->AddChild(new CZoSEKivBase("Other", "OTHER", node));
    node->AddChild(new CFemInDataKiv("B", "B", 2, false, false, 2.0, 100017, node));
    CRecordingHost host;
    CZoSEDlgBase dialog;
    dialog.Attach(node, &host);
    auto* forms = new CSubFormCollection(&dialog);
    forms->CreateSubForms(&dialog);
    ASSERT_EQ(forms->Count(), 2);
    EXPECT_EQ(forms->SubForm(0)->Data()->GetTitle(), "A");
    EXPECT_EQ(forms->SubForm(1)->Data()->GetTitle(), "B");
    forms->ShowSubForm(1);
    EXPECT_EQ(forms->ShownSubForm(), 1);
    forms->ShowSubForm(5);
    EXPECT_EQ(forms->ShownSubForm(), 1);
    forms->EnableControls(false);
    EXPECT_FALSE(forms->SubForm(0)->FormatBox()->isEnabled());
    EXPECT_FALSE(forms->SubForm(1)->FormatBox()->isEnabled());
}

// Pages for the property sheet: a value of their node and a help topic of their own.
struct PageNode : CZoSEKivBase {
    using CZoSEKivBase::CZoSEKivBase;
    double value = 1.0;
};

class CTestPageDlg : public CZoSEDlgBase {
public:
    CTestPageDlg() {
        HelpID(6001);
        field = new CZoNumberEdit(this);
        field->setObjectName("value");
    }
    void Initialize() override {
        field->BindDouble(this, static_cast<PageNode*>(GetSection())->value);
        CZoSEDlgBase::Initialize();
    }
    void SetData() override {
        CZoSEDlgBase::SetData();
        ++refreshes;
    }
    CZoNumberEdit* field;
    int refreshes = 0;
};
IMPLEMENT_DYNCREATE_DLG(CTestPageDlg)

TEST(PropertySheet, PagesByClassNameReportThroughTheSheetAndOpenOnTheInitialPage) {
    CZoSEKivGlobalBase root;
    auto* first = new PageNode("First", "FIRST", &root);
    auto* second = new PageNode("Second", "SECOND", &root);
    root.AddChild(first);
    root.AddChild(second);
    CRecordingHost host;
    CFemPropertySheetDlg sheet;
    sheet.HelpID(6000);
    sheet.Attach(first, &host);
    ASSERT_TRUE(sheet.AddPage("CTestPageDlg"));
    ASSERT_TRUE(sheet.AddPage("CTestPageDlg", second, "Other"));
    EXPECT_EQ(sheet.AddPage("CNoSuchDlg"), nullptr);
    CFemPropertySheetDlg::SetInitialSelectedPage(1);
    sheet.Initialize();
    CFemPropertySheetDlg::SetInitialSelectedPage(0);
    sheet.show();
    ASSERT_EQ(sheet.GetPageCount(), 2);
    EXPECT_EQ(sheet.GetActiveIndex(), 1);
    EXPECT_EQ(sheet.Tabs()->tabText(0), "First");
    EXPECT_EQ(sheet.Tabs()->tabText(1), "Other");

    auto* page = static_cast<CTestPageDlg*>(sheet.GetPage(1));
    auto* other = static_cast<CTestPageDlg*>(sheet.GetPage(0));
    const int before = other->refreshes;
    Enter(page->field, "3");
    EXPECT_EQ(second->value, 3.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(second->GetHasBeenTouched());
    EXPECT_TRUE(first->GetHasBeenTouched());
    EXPECT_EQ(other->refreshes, before + 1);  // the document refreshed the whole sheet

    QTest::keyClick(page->field, Qt::Key_F1);  // the page's topic, once
    page->HelpID(0);
    sheet.ShowHelp();
    EXPECT_EQ(host.helpIds, (std::vector<unsigned long>{6001, 6000}));
}

TEST(PropertySheet, ASheetDeletedWhileAPageFieldIsEditedDoesNotReachBackIntoIt) {
    CZoSEKivGlobalBase root;
    auto* node = new PageNode("First", "FIRST", &root);
    root.AddChild(node);
    const double before = node->value;
    CRecordingHost host;
    auto sheet = std::make_unique<CFemPropertySheetDlg>();
    sheet->Attach(node, &host);
    ASSERT_TRUE(sheet->AddPage("CTestPageDlg"));
    sheet->Initialize();
    sheet->show();
    sheet->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(sheet.get()));
    auto* page = static_cast<CTestPageDlg*>(sheet->GetPage(0));
    page->field->setFocus();
    Type(page->field, "7");
    ASSERT_TRUE(page->field->hasFocus());
    sheet.reset();  // the window closes as it goes, and the field loses the focus
    EXPECT_EQ(node->value, before);
    EXPECT_TRUE(host.hints.empty());
}

}  // namespace
