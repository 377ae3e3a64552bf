#include "MTWaveFieldDlg.h"

#include "MTWaveFieldFile.h"
#include "MTWaveFieldKiv.h"
#include "widgets/FemBase.h"
#include "widgets/ZoFileSelectorDlg.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEDlgBase.h"

#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

namespace {
constexpr long kHeightGroup = 100084;
constexpr long kPeriodGroup = 100085;
constexpr long kDirectionGroup = 100407;
constexpr long kIntervalGroup = 100290;
const int kFormatOfIndex[] = {CMTWaveFieldKiv::kConstant, CMTWaveFieldKiv::kTimeSeries,
                              CMTWaveFieldKiv::kTimeAndDomain};

CZoNumberEdit* Edit(long group, QWidget* parent) {
    return new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(group), parent);
}
}  // namespace

CMTWaveFieldDlg::CMTWaveFieldDlg(CMTWaveFieldKiv* field, CZoSEDlgBase* owner, QWidget* parent)
    : QWidget(parent), m_field(field), m_owner(owner) {
    auto* group = new QGroupBox("Wave field", this);
    m_format = new QComboBox(group);
    m_format->addItems({"Constant", "Varying in time, constant in domain",
                        "Varying in time and domain"});
    m_heightLabel = new QLabel("Wave height", group);
    m_height = Edit(kHeightGroup, group);
    m_heightUnit = new QLabel(group);
    m_periodLabel = new QLabel("Wave period", group);
    m_period = Edit(kPeriodGroup, group);
    m_periodUnit = new QLabel(group);
    m_directionLabel = new QLabel("Wave direction", group);
    m_direction = Edit(kDirectionGroup, group);
    m_directionUnit = new QLabel(group);
    m_fileLabel = new QLabel("Data file and items", group);
    m_fileName = new QLineEdit(group);
    for (size_t i = 0; i < m_items.size(); ++i) {
        m_items[i] = new QLineEdit(group);
        m_items[i]->setReadOnly(true);
        m_items[i]->setObjectName(QString("item%1").arg(i + 1));
    }
    m_select = new QPushButton("Select ...", group);
    m_view = new QPushButton("View ...", group);
    m_softStartLabel = new QLabel("Soft start interval", group);
    m_softStart = Edit(kIntervalGroup, group);
    m_softStartUnit = new QLabel(group);

    setObjectName("waveField");
    m_format->setObjectName("format");
    m_height->setObjectName("waveHeight");
    m_period->setObjectName("wavePeriod");
    m_direction->setObjectName("waveDirection");
    m_fileName->setObjectName("fileName");
    m_select->setObjectName("select");
    m_view->setObjectName("view");
    m_softStart->setObjectName("softStartInterval");
    m_heightLabel->setBuddy(m_height);
    m_periodLabel->setBuddy(m_period);
    m_directionLabel->setBuddy(m_direction);
    m_fileLabel->setBuddy(m_fileName);
    m_softStartLabel->setBuddy(m_softStart);

    auto* formatLabel = new QLabel("Format", group);
    formatLabel->setBuddy(m_format);
    auto* grid = new QGridLayout(group);
    grid->addWidget(formatLabel, 0, 0);
    grid->addWidget(m_format, 0, 1, 1, 3);
    int row = 1;
    for (auto [label, edit, unit] : {std::tuple{m_heightLabel, m_height, m_heightUnit},
                                     std::tuple{m_periodLabel, m_period, m_periodUnit},
                                     std::tuple{m_directionLabel, m_direction, m_directionUnit}}) {
        grid->addWidget(label, row, 0);
        grid->addWidget(edit, row, 1);
        grid->addWidget(unit, row, 2);
        ++row;
    }
    grid->addWidget(m_fileLabel, row, 0);
    grid->addWidget(m_fileName, row, 1, 1, 2);
    grid->addWidget(m_select, row, 3);
    ++row;
    for (QLineEdit* item : m_items)
        grid->addWidget(item, row++, 1, 1, 2);
    grid->addWidget(m_view, row - 1, 3);
    grid->addWidget(m_softStartLabel, row, 0);
    grid->addWidget(m_softStart, row, 1);
    grid->addWidget(m_softStartUnit, row, 2);
    grid->setColumnStretch(4, 1);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(group);

    // Every edit marks the setup as changed, the constants included.
    m_height->BindDouble(
        owner, [this] { return m_field->WaveHeight(); }, [this](double v) { m_field->WaveHeight(v); });
    m_period->BindDouble(
        owner, [this] { return m_field->WavePeriod(); }, [this](double v) { m_field->WavePeriod(v); });
    m_direction->BindDouble(
        owner, [this] { return m_field->WaveDirection(); },
        [this](double v) { m_field->WaveDirection(v); });
    m_softStart->BindDouble(
        owner, [this] { return m_field->SoftStartInterval(); },
        [this](double v) { m_field->SoftStartInterval(v); });

    connect(m_format, &QComboBox::activated, this, &CMTWaveFieldDlg::OnFormatChosen);
    connect(m_fileName, &QLineEdit::editingFinished, this, &CMTWaveFieldDlg::OnFileNameEdited);
    connect(m_select, &QPushButton::clicked, this, &CMTWaveFieldDlg::OnSelect);
    connect(m_view, &QPushButton::clicked, this, &CMTWaveFieldDlg::OnView);
}

QLineEdit* CMTWaveFieldDlg::ItemEdit(int index) const {
    if (index < 1 || index > static_cast<int>(m_items.size()))
        return nullptr;
    return m_items[static_cast<size_t>(index - 1)];
}

int CMTWaveFieldDlg::ListIndexOf(int format) {
    switch (format) {
    case CMTWaveFieldKiv::kConstant: return 0;
    case CMTWaveFieldKiv::kTimeSeries: return 1;
    default: return 2;
    }
}

CMTWaveFieldDlg::FileChoice CMTWaveFieldDlg::FileChoiceFor(int listIndex, const CString& fileName) {
    switch (listIndex) {
    case 1:
        return {"qrd0", "Time series files (*.qrd0) |*.qrd0|Unstructured data files "
                        "(*.qrdu)|*.qrdu|All files (*.*) |*.*||"};
    case 2:
        if (EndsWithNoCase(fileName, "qrd2"))
            return {"qrd2", "2D grid files (*.qrd2) |*.qrd2|Unstructured data files "
                            "(*.qrdu)|*.qrdu|All files (*.*) |*.*||"};
        return {"qrdu", "Unstructured data files (*.qrdu)|*.qrdu|2D grid files (*.qrd2) "
                        "|*.qrd2|All files (*.*) |*.*||"};
    default:
        return {};
    }
}

void CMTWaveFieldDlg::SetData() {
    {
        const QSignalBlocker block(m_format);
        m_format->setCurrentIndex(ListIndexOf(m_field->GetFormat()));
    }
    CMTWaveFieldFile* file = m_field->File();
    if (!m_fileName->hasFocus() || m_fileName->text().toStdString() == file->FileName())
        m_fileName->setText(QString::fromStdString(file->FileName()));
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i)
        ItemEdit(i)->setText("Item:   " + QString::fromStdString(file->ItemName(i)));
    m_heightUnit->setText(QString::fromStdString(m_height->Style().UnitName()));
    m_periodUnit->setText(QString::fromStdString(m_period->Style().UnitName()));
    m_directionUnit->setText(QString::fromStdString(m_direction->Style().UnitName()));
    m_softStartUnit->setText(QString::fromStdString(m_softStart->Style().UnitName()));
    for (CZoNumberEdit* e : {m_height, m_period, m_direction, m_softStart})
        e->Refresh();
    RefreshControls();
}

void CMTWaveFieldDlg::RefreshControls() {
    const bool fromFile = m_format->currentIndex() != 0;
    for (QWidget* w : std::initializer_list<QWidget*>{m_fileLabel, m_fileName, m_select,
                                                      m_softStartLabel, m_softStart,
                                                      m_softStartUnit})
        w->setEnabled(fromFile);
    for (QLineEdit* item : m_items)
        item->setEnabled(fromFile);
    for (QWidget* w : std::initializer_list<QWidget*>{m_heightLabel, m_height, m_heightUnit,
                                                      m_periodLabel, m_period, m_periodUnit,
                                                      m_directionLabel, m_direction,
                                                      m_directionUnit})
        w->setEnabled(!fromFile);
    // Only a file that is there and will do can be viewed.
    m_view->setEnabled(fromFile && !m_field->File()->FileName().empty() &&
                       m_field->File()->CheckFile());
}

void CMTWaveFieldDlg::Changed() {
    if (m_owner)
        m_owner->UpdateDoc(1);
}

void CMTWaveFieldDlg::OnFormatChosen(int index) {
    if (index < 0 || index > 2)
        return;
    m_field->SetFormat(kFormatOfIndex[index]);
    Changed();
    RefreshControls();
}

void CMTWaveFieldDlg::OnFileNameEdited() {
    const CString name = m_fileName->text().trimmed().toStdString();
    if (name == m_field->File()->FileName())
        return;
    m_field->File()->FileName(name);
    Changed();
    RefreshControls();
}

void CMTWaveFieldDlg::OnSelect() {
    CMTWaveFieldFile* file = m_field->File();
    const FileChoice choice = FileChoiceFor(m_format->currentIndex(), file->FileName());
    if (!ZoSelectDataFile(file, choice.filter, choice.defaultExt, this))
        return;
    // Three items whatever the selector handed back (a stored format 2 asks for none).
    file->SetNoItems(CMTWaveFieldFile::kItems);
    const CZoFileSelector names = file->MakeFileSelector();
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i)
        file->ItemName(i, names.GetNameOfItem(file->ItemNumber(i)));
    Changed();
    SetData();
}

void CMTWaveFieldDlg::OnView() {
    const CMTWaveFieldFile* file = m_field->File();
    if (!m_owner || file->FileName().empty())
        return;
    CFemBase::OpenDataFile(m_owner, file->FileName(), file->ItemNumber());
}
