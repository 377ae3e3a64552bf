#include "FemInDataDlg.h"

#include "FemBase.h"
#include "ZoFileSelectorDlg.h"
#include "ZoNumberEdit.h"
#include "ZoPrompts.h"
#include "ZoSEDlgBase.h"
#include "fem/FemInDataKiv.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRegularExpression>
#include <QSignalBlocker>
#include <QToolButton>

#include <algorithm>

QString ZoItemNumbersText(const std::vector<int>& items) {
    QStringList parts;
    for (int n : items)
        parts << QString::number(n);
    return parts.join(", ");
}

bool ZoParseItemNumbers(const QString& text, std::vector<int>& items) {
    std::vector<int> out;
    const QStringList parts =
        text.split(QRegularExpression("[,;\\s]+"), Qt::SkipEmptyParts);
    for (const QString& part : parts) {
        bool ok = false;
        const int n = part.toInt(&ok);
        if (!ok || n < 1)
            return false;
        out.push_back(n);
    }
    items = std::move(out);
    return true;
}

CFemInDataDlg::CFemInDataDlg(CFemInDataKiv* data, CZoSEDlgBase* owner, QWidget* parent)
    : QWidget(parent), m_data(data), m_owner(owner), m_format(new QComboBox(this)),
      m_constant(new CZoNumberEdit(this)), m_unit(new QLabel(this)),
      m_fileName(new QLineEdit(this)), m_browse(new QToolButton(this)),
      m_items(new QLineEdit(this)), m_itemName(new QLineEdit(this)),
      m_select(new QPushButton(tr("Select ..."), this)), m_view(new QPushButton(tr("View ..."), this)) {
    m_format->setObjectName("format");
    m_constant->setObjectName("constant");
    m_fileName->setObjectName("fileName");
    m_browse->setObjectName("browse");
    m_items->setObjectName("itemNumbers");
    m_itemName->setObjectName("itemName");
    m_select->setObjectName("select");
    m_view->setObjectName("view");
    m_select->setToolTip("Choose the data file and its item with the file selector");
    m_browse->setText("...");
    m_browse->setToolTip("Select the data file");
    m_items->setToolTip("Item numbers of the data file, separated by commas");

    auto* grid = new QGridLayout(this);
    grid->setContentsMargins(0, 0, 0, 0);
    grid->addWidget(new QLabel("Format", this), 0, 0);
    grid->addWidget(m_format, 0, 1, 1, 2);
    grid->addWidget(new QLabel("Constant value", this), 1, 0);
    grid->addWidget(m_constant, 1, 1);
    grid->addWidget(m_unit, 1, 2);
    grid->addWidget(new QLabel("Data file", this), 2, 0);
    grid->addWidget(m_fileName, 2, 1);
    grid->addWidget(m_browse, 2, 2);
    grid->addWidget(new QLabel("Item numbers", this), 3, 0);
    grid->addWidget(m_items, 3, 1);
    grid->addWidget(new QLabel("Item name", this), 4, 0);
    grid->addWidget(m_itemName, 4, 1);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(m_select);
    buttons->addWidget(m_view);
    grid->addLayout(buttons, 5, 1, 1, 2);
    grid->setColumnStretch(1, 1);

    SetConstantStyle(CZoEditStyle());
    m_constant->BindDouble(
        owner, [this] { return m_data->Constant(); }, [this](double v) { m_data->Constant(v); });

    connect(m_format, &QComboBox::activated, this, &CFemInDataDlg::OnFormatChosen);
    connect(m_fileName, &QLineEdit::editingFinished, this, &CFemInDataDlg::OnFileNameEdited);
    connect(m_browse, &QToolButton::clicked, this, &CFemInDataDlg::OnBrowse);
    connect(m_items, &QLineEdit::editingFinished, this, &CFemInDataDlg::OnItemNumbersEdited);
    connect(m_itemName, &QLineEdit::editingFinished, this, &CFemInDataDlg::OnItemNameEdited);
    connect(m_select, &QPushButton::clicked, this, &CFemInDataDlg::OnSelect);
    connect(m_view, &QPushButton::clicked, this, &CFemInDataDlg::OnView);
    SetData();
}

void CFemInDataDlg::SetConstantStyle(const CZoEditStyle& style) {
    CZoEditStyle s = style;
    s.SetOvuUnitBaseGroup(m_data->ItemType());
    if (m_data->ConstantIsFloat())
        s.SetFloatRange();
    m_constant->SetStyle(s);
    const CString unit = s.UnitName();
    m_unit->setText(unit == "()" ? QString() : QString::fromStdString(unit));
}

void CFemInDataDlg::SetData() {
    const std::vector<int> formats = m_data->AllowedFormats();
    const auto it = std::find(formats.begin(), formats.end(), m_data->Format());
    {
        // A format read from a file that the value may not take is shown as it is, after
        // the formats to choose from, until another is chosen.
        const QSignalBlocker block(m_format);
        m_format->clear();
        for (int format : formats)
            m_format->addItem(QString::fromStdString(CFemInDataKiv::FormatName(format)));
        if (it == formats.end())
            m_format->addItem(QString::fromStdString(CFemInDataKiv::FormatName(m_data->Format())));
        m_format->setCurrentIndex(it == formats.end() ? int(formats.size())
                                                      : int(it - formats.begin()));
    }
    m_constant->Refresh();
    const CFemInDataFile* file = m_data->QrdData();
    m_fileName->setText(QString::fromStdString(file->FileName()));
    m_items->setText(ZoItemNumbersText(file->ItemNumbers()));
    m_itemName->setText(QString::fromStdString(file->ItemName()));

    const bool on = m_enabled && !m_data->IsDisabled();
    const bool constant = m_data->Format() == 0;
    m_format->setEnabled(on);
    m_constant->setEnabled(on && constant);
    m_unit->setEnabled(on && constant);
    for (QWidget* w : {static_cast<QWidget*>(m_fileName), static_cast<QWidget*>(m_browse),
                       static_cast<QWidget*>(m_items), static_cast<QWidget*>(m_itemName),
                       static_cast<QWidget*>(m_select)})
        w->setEnabled(on && !constant);
    bool readable = false;
    if (on && !constant && !file->FileName().empty()) {
        const auto header = CZoFileSelector(m_data).Header(file->FileName());
        readable = header->header.has_value();
    }
    m_view->setEnabled(readable);
}

namespace {
// The files a format reads: time series for values in time, grids and mesh data in space.
const char* FilterFor(int format) {
    if (format == 1)
        return "Time series files (*.qrd0)|*.qrd0;*.kx0|All files (*.*)|*.*||";
    return "Unstructured data files (*.qrdu)|*.qrdu|2D grid files (*.qrd2)|*.qrd2;*.kx2|"
           "All files (*.*)|*.*||";
}
}  // namespace

void CFemInDataDlg::OnSelect() {
    CFemInDataFile* file = m_data->QrdData();
    const int format = m_data->Format();
    CZoFileSelectorDlg dialog(file->FileName(), FilterFor(format), format == 1 ? "qrd0" : "qrdu",
                              this);
    dialog.SetBaseFolder(CZoFileSelector(m_data).BaseFolder());
    m_data->SetUpFileSelector(dialog);
    dialog.SetSelectedItems(file->ItemNumbers());
    QPointer<CFemInDataDlg> self(this);
    if (ZoRunFileSelector(dialog) != QDialog::Accepted || !self)
        return;
    file->FileName(dialog.FileName());
    file->ItemNumbers(dialog.SelectedItems());
    file->ItemName(dialog.SelectedItems().empty() ? CString()
                                                  : dialog.GetNameOfItem(dialog.SelectedItems().front()));
    Changed();
}

void CFemInDataDlg::OnView() {
    const CFemInDataFile* file = m_data->QrdData();
    CFemBase::OpenDataFile(CZoFileSelector(m_data).AbsolutePath(file->FileName()), file->ItemNumbers(),
                           this);
}

void CFemInDataDlg::EnableControls(bool enable) {
    m_enabled = enable;
    SetData();
}

void CFemInDataDlg::Changed() {
    QPointer<CFemInDataDlg> self(this);
    if (m_owner)
        m_owner->UpdateDoc(kHintValueChanged);
    if (self)
        SetData();
}

void CFemInDataDlg::OnFormatChosen(int index) {
    const std::vector<int> formats = m_data->AllowedFormats();
    if (index < 0 || index >= static_cast<int>(formats.size()))
        return;
    m_data->Format(formats[index]);
    Changed();
}

void CFemInDataDlg::OnFileNameEdited() {
    const CString name = m_fileName->text().trimmed().toStdString();
    if (name == m_data->QrdData()->FileName())
        return;
    m_data->QrdData()->FileName(name);
    Changed();
}

void CFemInDataDlg::OnBrowse() {
    const CString current = m_data->QrdData()->FileName();
    const QString start =
        QString::fromStdString(m_owner && !current.empty() ? m_owner->AbsoluteFilePath(current)
                                                           : current);
    const QString chosen = ZoGetOpenFileName(
        this, "Select data file", start,
        "Data files (*.qrd0 *.qrd1 *.qrd2 *.qrdu *.kx0 *.kx2);;All files (*)");
    if (chosen.isEmpty())
        return;
    m_data->QrdData()->FileName(chosen.toStdString());
    Changed();
}

void CFemInDataDlg::OnItemNumbersEdited() {
    const std::vector<int>& current = m_data->QrdData()->ItemNumbers();
    if (m_items->text() == ZoItemNumbersText(current))
        return;
    std::vector<int> items;
    if (!ZoParseItemNumbers(m_items->text(), items)) {
        m_items->setText(ZoItemNumbersText(current));
        ZoShowMessage(m_items, "Please enter item numbers of 1 or more, separated by commas.");
        return;
    }
    m_data->QrdData()->ItemNumbers(std::move(items));
    Changed();
}

void CFemInDataDlg::OnItemNameEdited() {
    const CString name = m_itemName->text().toStdString();
    if (name == m_data->QrdData()->ItemName())
        return;
    m_data->QrdData()->ItemName(name);
    Changed();
}

CSubFormCollection::CSubFormCollection(QWidget* parent) : QStackedWidget(parent) {}

int CSubFormCollection::CreateSubForm(CFemInDataDlg* subForm) { return addWidget(subForm); }

void CSubFormCollection::CreateSubForms(CZoSEDlgBase* dialog) {
    CZoSEKivBase* node = dialog->GetSection();
    if (!node)
        return;
    POSITION pos = 0;
    for (CZoSEKivBase* c = node->GetFirstChild(pos); c; c = node->GetNextChild(pos))
        if (auto* data = dynamic_cast<CFemInDataKiv*>(c))
            CreateSubForm(new CFemInDataDlg(data, dialog, this));
}

void CSubFormCollection::ShowSubForm(int index) {
    if (index >= 0 && index < count())
        setCurrentIndex(index);
}

CFemInDataDlg* CSubFormCollection::SubForm(int index) const {
    return qobject_cast<CFemInDataDlg*>(widget(index));
}

void CSubFormCollection::SetData() {
    for (int i = 0; i < count(); ++i)
        SubForm(i)->SetData();
}

void CSubFormCollection::EnableControls(bool enable) {
    for (int i = 0; i < count(); ++i)
        SubForm(i)->EnableControls(enable);
}
