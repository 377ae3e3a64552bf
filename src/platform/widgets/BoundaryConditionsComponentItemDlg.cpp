#include "BoundaryConditionsComponentItemDlg.h"

#include "FemBase.h"
#include "FemInDataDlg.h"
#include "ZoFileSelectorDlg.h"
#include "ZoNumberEdit.h"
#include "ZoPrompts.h"
#include "fem/BoundaryConditionsComponentItemKiv.h"

#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QSignalBlocker>
#include <QToolButton>
#include <QVBoxLayout>

namespace {
using BcItem = CBoundaryConditionsComponentItemKiv;

constexpr long kTimeIntervalGroup = 100290;

QString UnitText(const CZoEditStyle& style) {
    const CString unit = style.UnitName();
    return unit == "()" ? QString() : QString::fromStdString(unit);
}

void ShowIndex(QComboBox* box, int index) {
    const QSignalBlocker block(box);
    box->setCurrentIndex(index >= 0 && index < box->count() ? index : -1);
}

// Values in time come from time series, values along the boundary from line series.
const char* FilterFor(int format) {
    return format == 1 ? "Time series files (*.qrd0)|*.qrd0;*.kx0|All files (*.*)|*.*||"
                       : "Line series files (*.qrd1)|*.qrd1|All files (*.*)|*.*||";
}

QComboBox* Choice(const char* name, QWidget* parent) {
    auto* box = new QComboBox(parent);
    box->setObjectName(name);
    return box;
}
}  // namespace

CBoundaryConditionsComponentItemDlg::CBoundaryConditionsComponentItemDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_type(Choice("type", this)), m_format(Choice("format", this)),
      m_constant(new CZoNumberEdit(this)), m_constantUnit(new QLabel(this)),
      m_fileName(new QLineEdit(this)), m_browse(new QToolButton(this)),
      m_items(new QLineEdit(this)), m_select(new QPushButton("Select ...", this)),
      m_view(new QPushButton("View ...", this)), m_softTime(new CZoNumberEdit(this)),
      m_softTimeUnit(new QLabel(this)), m_refSoft(new CZoNumberEdit(this)),
      m_refSoftUnit(new QLabel(this)),
      m_typeSoft(Choice("softStartType", this)), m_typeTI(Choice("timeInterpolation", this)),
      m_typeSI(Choice("spaceInterpolation", this)) {
    m_constant->setObjectName("constant");
    m_fileName->setObjectName("fileName");
    m_browse->setObjectName("browse");
    m_browse->setText("...");
    m_browse->setToolTip("Select the data file");
    m_items->setObjectName("itemNumbers");
    m_items->setToolTip("Item numbers of the data file, separated by commas");
    m_select->setObjectName("select");
    m_select->setToolTip("Choose the data file and its item with the file selector");
    m_view->setObjectName("view");
    m_view->setToolTip("Show the values of the data file");
    m_softTime->setObjectName("softStartTime");
    m_refSoft->setObjectName("softStartReference");

    auto* layout = new QVBoxLayout(this);
    auto* top = new QGridLayout;
    top->addWidget(new QLabel("Type of boundary", this), 0, 0);
    top->addWidget(m_type, 0, 1, 1, 2);
    top->setColumnStretch(1, 1);
    layout->addLayout(top);

    auto* value = new QGroupBox("Value", this);
    value->setObjectName("valueGroup");
    auto* v = new QGridLayout(value);
    v->addWidget(new QLabel("Format", value), 0, 0);
    v->addWidget(m_format, 0, 1, 1, 2);
    v->addWidget(new QLabel("Constant value", value), 1, 0);
    v->addWidget(m_constant, 1, 1);
    v->addWidget(m_constantUnit, 1, 2);
    v->addWidget(new QLabel("Data file", value), 2, 0);
    v->addWidget(m_fileName, 2, 1);
    v->addWidget(m_browse, 2, 2);
    v->addWidget(new QLabel("Item numbers", value), 3, 0);
    v->addWidget(m_items, 3, 1);
    auto* fileButtons = new QHBoxLayout;
    fileButtons->addWidget(m_select);
    fileButtons->addWidget(m_view);
    fileButtons->addStretch(1);
    v->addLayout(fileButtons, 4, 1, 1, 2);
    v->addWidget(new QLabel("Interpolation in time", value), 5, 0);
    v->addWidget(m_typeTI, 5, 1, 1, 2);
    v->addWidget(new QLabel("Interpolation along the boundary", value), 6, 0);
    v->addWidget(m_typeSI, 6, 1, 1, 2);
    v->setColumnStretch(1, 1);
    layout->addWidget(value);

    auto* soft = new QGroupBox("Soft start", this);
    soft->setObjectName("softStartGroup");
    auto* s = new QGridLayout(soft);
    s->addWidget(new QLabel("Type", soft), 0, 0);
    s->addWidget(m_typeSoft, 0, 1, 1, 2);
    s->addWidget(new QLabel("Interval", soft), 1, 0);
    s->addWidget(m_softTime, 1, 1);
    s->addWidget(m_softTimeUnit, 1, 2);
    s->addWidget(new QLabel("Reference value", soft), 2, 0);
    s->addWidget(m_refSoft, 2, 1);
    s->addWidget(m_refSoftUnit, 2, 2);
    s->setColumnStretch(1, 1);
    layout->addWidget(soft);
    layout->addStretch(1);
    m_specifiedOnly = {value, soft};

    for (int f = 0; f <= BcItem::kFormatLast; ++f)
        m_format->addItem(QString::fromStdString(BcItem::FormatName(f)));
    for (int t = 0; t <= BcItem::kTypeSoftLast; ++t)
        m_typeSoft->addItem(QString::fromStdString(BcItem::SoftStartName(t)));
    for (int t = 0; t <= BcItem::kInterpolationLast; ++t) {
        m_typeTI->addItem(QString::fromStdString(BcItem::InterpolationName(t, false)));
        m_typeSI->addItem(QString::fromStdString(BcItem::InterpolationName(t, true)));
    }

    auto store = [this](QComboBox* box, void (BcItem::*set)(int)) {
        connect(box, &QComboBox::activated, this, [this, set](int index) {
            if (BcItem* item = BoundaryItem(); item && index >= 0) {
                (item->*set)(index);
                Changed();
            }
        });
    };
    store(m_type, &BcItem::Type);
    store(m_format, &BcItem::Format);
    store(m_typeSoft, &BcItem::TypeSoft);
    store(m_typeTI, &BcItem::TypeTI);
    store(m_typeSI, &BcItem::TypeSI);
    connect(m_fileName, &QLineEdit::editingFinished, this,
            &CBoundaryConditionsComponentItemDlg::OnFileNameEdited);
    connect(m_browse, &QToolButton::clicked, this, &CBoundaryConditionsComponentItemDlg::OnBrowse);
    connect(m_items, &QLineEdit::editingFinished, this,
            &CBoundaryConditionsComponentItemDlg::OnItemNumbersEdited);
    connect(m_select, &QPushButton::clicked, this, &CBoundaryConditionsComponentItemDlg::OnSelect);
    connect(m_view, &QPushButton::clicked, this, &CBoundaryConditionsComponentItemDlg::OnView);
}

CBoundaryConditionsComponentItemKiv* CBoundaryConditionsComponentItemDlg::BoundaryItem() const {
    return Section<CBoundaryConditionsComponentItemKiv>();
}

void CBoundaryConditionsComponentItemDlg::Initialize() {
    if (BcItem* item = BoundaryItem()) {
        {
            const QSignalBlocker block(m_type);
            m_type->clear();
            for (const CString& text : item->TypeTextArr())
                m_type->addItem(QString::fromStdString(text));
        }
        // The value in the user's unit of its quantity; the soft start's reference likewise.
        CZoEditStyle valueStyle;
        valueStyle.SetOvuUnitBaseGroup(item->OvuType());
        m_constant->SetStyle(valueStyle);
        m_refSoft->SetStyle(valueStyle);
        m_constantUnit->setText(UnitText(valueStyle));
        m_refSoftUnit->setText(UnitText(valueStyle));
        CZoEditStyle timeStyle;
        timeStyle.SetOvuUnitBaseGroup(kTimeIntervalGroup).SetMinimum(0.0);
        m_softTime->SetStyle(timeStyle);
        m_softTimeUnit->setText(UnitText(timeStyle));
        m_constant->BindDouble(this, [this] { return BoundaryItem() ? BoundaryItem()->Constant() : 0.0; },
                               [this](double v) { if (BoundaryItem()) BoundaryItem()->Constant(v); });
        m_refSoft->BindDouble(this, [this] { return BoundaryItem() ? BoundaryItem()->RefSoft() : 0.0; },
                              [this](double v) { if (BoundaryItem()) BoundaryItem()->RefSoft(v); });
        m_softTime->BindDouble(this, [this] { return BoundaryItem() ? BoundaryItem()->SoftTime() : 0.0; },
                               [this](double v) { if (BoundaryItem()) BoundaryItem()->SoftTime(v); });
    }
    CZoSEDlgBase::Initialize();
}

void CBoundaryConditionsComponentItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    const BcItem* item = BoundaryItem();
    if (!item)
        return;
    ShowIndex(m_type, item->Type());
    ShowIndex(m_format, item->Format());
    ShowIndex(m_typeSoft, item->TypeSoft());
    ShowIndex(m_typeTI, item->TypeTI());
    ShowIndex(m_typeSI, item->TypeSI());
    m_fileName->setText(QString::fromStdString(item->QrdData()->FileName()));
    m_items->setText(ZoItemNumbersText(item->QrdData()->ItemNumbers()));

    // Only specified values have a value; a constant or a file as the format says, the
    // interpolations as the file varies.
    const bool specified = item->Type() == BcItem::kTypeSpecified;
    const int format = item->Format();
    for (QWidget* w : m_specifiedOnly)
        w->setEnabled(specified);
    m_constant->setEnabled(format == 0);
    m_constantUnit->setEnabled(format == 0);
    m_fileName->setEnabled(format != 0);
    m_browse->setEnabled(format != 0);
    m_items->setEnabled(format != 0);
    m_select->setEnabled(format != 0);
    // Only a file that reads can be shown.
    bool readable = false;
    if (specified && format != 0 && !item->QrdData()->FileName().empty())
        readable = CZoFileSelector(item).Header(item->QrdData()->FileName())->header.has_value();
    m_view->setEnabled(readable);
    m_typeTI->setEnabled(format > 0 && (format & 1));
    m_typeSI->setEnabled(format > 0 && (format & 2));
    const bool soft = item->TypeSoft() != 0;
    m_softTime->setEnabled(soft);
    m_refSoft->setEnabled(soft);
}

void CBoundaryConditionsComponentItemDlg::Changed() {
    QPointer<CBoundaryConditionsComponentItemDlg> self(this);
    UpdateDoc(kHintValueChanged);
    if (self && !Host())
        SetData();
}

void CBoundaryConditionsComponentItemDlg::OnFileNameEdited() {
    BcItem* item = BoundaryItem();
    const CString name = m_fileName->text().trimmed().toStdString();
    if (!item || name == item->QrdData()->FileName())
        return;
    item->QrdData()->FileName(name);
    Changed();
}

void CBoundaryConditionsComponentItemDlg::OnBrowse() {
    BcItem* item = BoundaryItem();
    if (!item)
        return;
    const CString current = item->QrdData()->FileName();
    const QString start = QString::fromStdString(current.empty() ? current : AbsoluteFilePath(current));
    const QString chosen = ZoGetOpenFileName(this, "Select data file", start,
                                             "Data files (*.qrd0 *.qrd1 *.qrd2 *.qrdu);;All files (*)");
    if (chosen.isEmpty())
        return;
    item->QrdData()->FileName(chosen.toStdString());
    Changed();
}

void CBoundaryConditionsComponentItemDlg::OnItemNumbersEdited() {
    BcItem* item = BoundaryItem();
    if (!item)
        return;
    const std::vector<int>& current = item->QrdData()->ItemNumbers();
    if (m_items->text() == ZoItemNumbersText(current))
        return;
    std::vector<int> items;
    if (!ZoParseItemNumbers(m_items->text(), items)) {
        m_items->setText(ZoItemNumbersText(current));
        ZoShowMessage(m_items, "Please enter item numbers of 1 or more, separated by commas.");
        return;
    }
    item->QrdData()->ItemNumbers(std::move(items));
    Changed();
}

void CBoundaryConditionsComponentItemDlg::OnSelect() {
    BcItem* item = BoundaryItem();
    if (!item)
        return;
    CFemInDataFile* file = item->QrdData();
    const int format = item->Format();
    CZoFileSelectorDlg dialog(file->FileName(), FilterFor(format), format == 1 ? "qrd0" : "qrd1", this);
    dialog.SetBaseFolder(CZoFileSelector(item).BaseFolder());
    dialog.AddRequest(item->GetTitle().empty() ? CString("Boundary value") : item->GetTitle())
        .SetOvuType(item->OvuType());
    dialog.SetMinNoItems(1);
    dialog.SetAcceptedKinds({format == 1 ? datafile::Kind::TimeSeries : datafile::Kind::LineSeries});
    dialog.SetSelectedItems(file->ItemNumbers());
    QPointer<CBoundaryConditionsComponentItemDlg> self(this);
    if (ZoRunFileSelector(dialog) != QDialog::Accepted || !self)
        return;
    file->FileName(dialog.FileName());
    file->ItemNumbers(dialog.SelectedItems());
    file->ItemName(dialog.SelectedItems().empty() ? CString()
                                                  : dialog.GetNameOfItem(dialog.SelectedItems().front()));
    Changed();
}

void CBoundaryConditionsComponentItemDlg::OnView() {
    const BcItem* item = BoundaryItem();
    if (!item)
        return;
    const CFemInDataFile* file = item->QrdData();
    CFemBase::OpenDataFile(CZoFileSelector(item).AbsolutePath(file->FileName()), file->ItemNumbers(), this);
}
