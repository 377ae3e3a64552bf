#include "MTDredgingItemsDlg.h"

#include "MTDredgingFile.h"
#include "MTDredgingFractionGrid.h"
#include "MTDredgingItemsKiv.h"
#include "MTDredgingMapDlg.h"
#include "fem/DomainKiv.h"
#include "projection/ZoMapProjection.h"
#include "widgets/FemBase.h"
#include "widgets/ZoFileSelectorDlg.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoPrompts.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDredgingItemsDlg)

namespace {
constexpr long kMassGroup = 100076;
constexpr int kSpillTypes = 4;
const char* const kSpillTexts[kSpillTypes] = {
    "Spill in the bottom layer", "Spill in the top layer",
    "Spill uniformed in the bottom and the top layer",
    "Spill uniformed distributed in the water column"};
const char* const kItemTips[] = {"x-coordinate", "y-coordinate", "rate of dredged mass", "spill"};

QString Q(const CString& s) { return QString::fromStdString(s); }
}  // namespace

CMTDredgingItemsDlg::CMTDredgingItemsDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_spillLabel(new QLabel("Type of spilling", this)),
      m_spill(new QComboBox(this)),
      m_updateDredger(new QCheckBox("Include update of the dredger", this)),
      m_initialMass(new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kMassGroup), this)),
      m_maximumMass(new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kMassGroup), this)),
      m_initialUnit(new QLabel(this)), m_maximumUnit(new QLabel(this)),
      m_fractions(new CMTDredgingFractionGrid(this)), m_projection(new QComboBox(this)),
      m_fileName(new QLineEdit(this)), m_select(new QPushButton("Select ...", this)),
      m_view(new QPushButton("View ...", this)) {
    HelpID(5049);
    m_spill->setObjectName("spillType");
    m_spillLabel->setObjectName("spillTypeLabel");
    m_spillLabel->setBuddy(m_spill);
    m_updateDredger->setObjectName("updateDredger");
    m_initialMass->setObjectName("initialMass");
    m_maximumMass->setObjectName("maximumMass");
    m_fractions->setObjectName("fractions");
    m_projection->setObjectName("projection");
    m_fileName->setObjectName("fileName");
    m_fileName->setReadOnly(true);
    m_select->setObjectName("select");
    m_view->setObjectName("view");
    m_spill->setToolTip("Where the spill is released in the water column "
                        "(a three-dimensional domain only)");
    m_updateDredger->setToolTip("Whether the mass on the dredger is followed, from its initial "
                                "mass up to its maximum");
    m_projection->setToolTip("The projection of the x and y of the data file");
    m_select->setToolTip("Choose the time series and its items x, y, rate of dredged mass and spill");
    m_view->setToolTip("Show the time series");

    for (int i = 0; i < kSpillTypes; ++i) {
        m_spill->addItem(kSpillTexts[i], i + 1);
        m_items[static_cast<std::size_t>(i)] = new QLineEdit(this);
        m_items[static_cast<std::size_t>(i)]->setObjectName(QString("item%1").arg(i + 1));
        m_items[static_cast<std::size_t>(i)]->setReadOnly(true);
        m_items[static_cast<std::size_t>(i)]->setToolTip(kItemTips[i]);
    }
    m_projection->setEditable(true);
    // A typed projection is stored when it is known; it never joins the list.
    m_projection->setInsertPolicy(QComboBox::NoInsert);
    for (const ProjectionEntry& e : CZoMapProjection::Entries()) {
        m_projection->addItem(Q(e.name));
        m_projection->setItemData(m_projection->count() - 1, Q(e.description), Qt::ToolTipRole);
    }

    auto* grid = new QGridLayout;
    int row = 0;
    grid->addWidget(m_spillLabel, row, 0);
    grid->addWidget(m_spill, row++, 1, 1, 2);
    grid->addWidget(m_updateDredger, row++, 0, 1, 3);
    auto* initialLabel = new QLabel("Initial mass on dredger", this);
    initialLabel->setBuddy(m_initialMass);
    grid->addWidget(initialLabel, row, 0);
    grid->addWidget(m_initialMass, row, 1);
    grid->addWidget(m_initialUnit, row++, 2);
    auto* maximumLabel = new QLabel("Maximum mass on dredger", this);
    maximumLabel->setBuddy(m_maximumMass);
    grid->addWidget(maximumLabel, row, 0);
    grid->addWidget(m_maximumMass, row, 1);
    grid->addWidget(m_maximumUnit, row++, 2);
    grid->setColumnStretch(3, 1);

    auto* distribution = new QGroupBox("Distribution (%)", this);
    auto* distributionLayout = new QVBoxLayout(distribution);
    distributionLayout->addWidget(m_fractions, 0, Qt::AlignLeft | Qt::AlignTop);

    auto* projectionRow = new QGridLayout;
    auto* projectionLabel = new QLabel("Map projection", this);
    projectionLabel->setBuddy(m_projection);
    projectionRow->addWidget(projectionLabel, 0, 0);
    projectionRow->addWidget(m_projection, 0, 1);
    projectionRow->setColumnStretch(2, 1);

    auto* file = new QGroupBox("Data file and items", this);
    auto* fileLayout = new QGridLayout(file);
    fileLayout->addWidget(m_fileName, 0, 0, 1, 2);
    for (int i = 0; i < 4; ++i)
        fileLayout->addWidget(m_items[static_cast<std::size_t>(i)], 1 + i / 2, i % 2);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_select);
    buttons->addWidget(m_view);
    buttons->addStretch(1);
    fileLayout->addLayout(buttons, 3, 0, 1, 2);

    m_layout = new QVBoxLayout(this);
    m_layout->addLayout(grid);
    m_layout->addWidget(distribution);
    m_layout->addLayout(projectionRow);
    m_layout->addWidget(file);

    connect(m_spill, &QComboBox::activated, this, [this](int index) {
        if (!Dredger())
            return;
        Dredger()->Type(m_spill->itemData(index).toInt());
        UpdateDoc(kHintValueChanged);
    });
    connect(m_updateDredger, &QCheckBox::clicked, this, [this](bool on) {
        if (!Dredger())
            return;
        Dredger()->UpdateDredger(on);
        UpdateDoc(kHintValueChanged);
    });
    // Keys move an editable list's choice without "activated"; a second call stores nothing.
    connect(m_projection, &QComboBox::activated, this, &CMTDredgingItemsDlg::StoreProjection);
    connect(m_projection, &QComboBox::currentIndexChanged, this,
            &CMTDredgingItemsDlg::StoreProjection);
    connect(m_projection->lineEdit(), &QLineEdit::editingFinished, this,
            &CMTDredgingItemsDlg::StoreProjection);
    connect(m_select, &QPushButton::clicked, this, &CMTDredgingItemsDlg::OnSelect);
    connect(m_view, &QPushButton::clicked, this, &CMTDredgingItemsDlg::OnView);
}

CMTDredgingItemsKiv* CMTDredgingItemsDlg::Dredger() const { return Section<CMTDredgingItemsKiv>(); }

void CMTDredgingItemsDlg::Initialize() {
    if (CMTDredgingItemsKiv* d = Dredger()) {
        // Weights of another number of fractions are of no use on this page.
        d->MatchWeightsToFractions();
        m_fractions->Initialize(this, d);
        m_initialMass->BindDouble(
            this, [this] { return Dredger()->InitialDredgerMass(); },
            [this](double v) { Dredger()->InitialDredgerMass(v); });
        m_maximumMass->BindDouble(
            this, [this] { return Dredger()->MaximumDredgerMass(); },
            [this](double v) { Dredger()->MaximumDredgerMass(v); });
        // The track of this dredger, highlighted among the others.
        m_map = new CMTDredgingMapDlg;
        m_map->setParent(this);
        m_map->setObjectName("map");
        m_map->setMinimumHeight(320);
        m_map->Attach(d, Host());
        m_map->Initialize();
        m_layout->addWidget(m_map, 1);
    } else {
        m_layout->addStretch(1);
    }
    CZoSEDlgBase::Initialize();
}

void CMTDredgingItemsDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTDredgingItemsKiv* d = Dredger();
    if (!d)
        return;
    const QSignalBlocker b1(m_spill), b2(m_updateDredger), b3(m_projection);
    ShowItems();
    m_updateDredger->setChecked(d->UpdateDredger());
    // A type read from a file that no entry stands for is shown as it is, until one is chosen.
    while (m_spill->count() > kSpillTypes)
        m_spill->removeItem(m_spill->count() - 1);
    int index = m_spill->findData(d->Type());
    if (index < 0) {
        m_spill->addItem(QString("Unknown type of spilling %1").arg(d->Type()), d->Type());
        index = m_spill->count() - 1;
    }
    m_spill->setCurrentIndex(index);
    if (!m_projection->lineEdit()->hasFocus())
        m_projection->setCurrentText(Q(d->CoordinateType()));
    m_initialUnit->setText(Q(m_initialMass->Style().UnitName()));
    m_maximumUnit->setText(Q(m_maximumMass->Style().UnitName()));
    m_fractions->Refresh();
    if (m_map)
        m_map->SetData();

    const CDomainKiv* domain = Domain(d);
    const bool threeD = domain && domain->ThreeD();
    // The type matters only in three dimensions, but one the engine does not know makes the
    // dredger invalid anywhere, so it can be mended here in two dimensions as well.
    const bool known = index < kSpillTypes;
    m_spill->setEnabled(threeD || !known);
    m_spillLabel->setEnabled(threeD || !known);
    m_initialMass->setEnabled(d->UpdateDredger());
    m_maximumMass->setEnabled(d->UpdateDredger());
}

void CMTDredgingItemsDlg::ShowItems() {
    const CMTDredgingFile* file = Dredger()->DataFile();
    m_fileName->setText(Q(file->FileName()));
    for (int i = 0; i < 4; ++i)
        m_items[static_cast<std::size_t>(i)]->setText("Item:   " + Q(file->ItemName(i + 1)));
    m_view->setEnabled(!file->FileName().empty());
}

void CMTDredgingItemsDlg::StoreProjection() {
    CMTDredgingItemsKiv* d = Dredger();
    if (!d)
        return;
    const CString p = m_projection->currentText().trimmed().toStdString();
    if (p == d->CoordinateType())
        return;
    if (!CZoMapProjection::IsKnown(p)) {
        ZoShowMessage(this, QString("\"%1\" is not a known projection.").arg(Q(p)));
        const QSignalBlocker block(m_projection);
        m_projection->setCurrentText(Q(d->CoordinateType()));
        return;
    }
    d->CoordinateType(p);
    UpdateDoc(kHintValueChanged);
}

void CMTDredgingItemsDlg::OnSelect() {
    CMTDredgingItemsKiv* d = Dredger();
    if (!d)
        return;
    CMTDredgingFile* file = d->DataFile();
    CZoFileSelectorDlg dialog(file->FileName(), kSelectorFilter, "qrd0", this);
    dialog.SetBaseFolder(CZoFileSelector(file).BaseFolder());
    file->SetUpFileSelector(dialog);
    dialog.SetSelectedItems(file->ItemNumber());
    if (ZoRunFileSelector(dialog) != QDialog::Accepted)
        return;
    file->FileName(dialog.FileName());
    const std::vector<int>& chosen = dialog.SelectedItems();
    for (int i = 1; i <= CMTDredgingFile::kItemCount; ++i) {
        const int number = i <= static_cast<int>(chosen.size()) ? chosen[static_cast<std::size_t>(i - 1)] : i;
        file->ItemNumber(i, number);
        file->ItemName(i, dialog.GetNameOfItem(number));
    }
    ShowItems();
    UpdateDoc(kHintValueChanged);
}

void CMTDredgingItemsDlg::OnView() {
    CMTDredgingItemsKiv* d = Dredger();
    if (!d || d->DataFile()->FileName().empty())
        return;
    const CMTDredgingFile* file = d->DataFile();
    CFemBase::OpenDataFile(this, file->FileName(),
                           {file->ItemNumber(1), file->ItemNumber(2), file->ItemNumber(3),
                            file->ItemNumber(4)});
}
