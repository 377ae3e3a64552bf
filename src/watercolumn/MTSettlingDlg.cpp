#include "MTSettlingDlg.h"

#include "MTSettlingGrid.h"
#include "MTSettlingKiv.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QRadioButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSettlingDlg)

namespace {
constexpr long kConcentration = 100403;
constexpr long kDensity = 100017;

QRadioButton* Choice(const char* text, const char* name, QWidget* parent) {
    auto* button = new QRadioButton(text, parent);
    button->setObjectName(name);
    return button;
}
} // namespace

CMTSettlingDlg::CMTSettlingDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5036);

    auto* flocculation = new QGroupBox("Flocculation", this);
    m_flocculation =
        Choice("Include flocculation calculations", "includeFlocculation", flocculation);
    m_constant = Choice("Use constant settling velocity", "constantSettlingVelocity", flocculation);
    auto* flocculationLayout = new QVBoxLayout(flocculation);
    flocculationLayout->addWidget(m_flocculation);
    flocculationLayout->addWidget(m_constant);

    auto* hindered = new QGroupBox("Hindered settling", this);
    m_hindered = new QCheckBox("Include hindered settling calculations", hindered);
    m_hindered->setObjectName("includeHinderedSettling");
    m_winterwerp = Choice("Use Winterwerp formulation", "winterwerp", hindered);
    m_richardsonZaki = Choice("Use Richardson and Zaki formulation", "richardsonZaki", hindered);
    auto* hinderedLayout = new QVBoxLayout(hindered);
    hinderedLayout->addWidget(m_hindered);
    hinderedLayout->addWidget(m_winterwerp);
    hinderedLayout->addWidget(m_richardsonZaki);

    auto* parameters = new QGroupBox("Settling parameters", this);
    auto* grid = new QGridLayout(parameters);
    const CZoEditStyle concentration = CZoEditStyle().SetOvuUnitBaseGroup(kConcentration);
    m_cgel = mtdlg::NumberRow(grid, 0, "Gelling Point", concentration, "gellingPoint", parameters);
    m_rhoSediment = mtdlg::NumberRow(grid, 1, "Density of sediment",
                                     CZoEditStyle().SetOvuUnitBaseGroup(kDensity),
                                     "sedimentDensity", parameters);
    m_cfloc = mtdlg::NumberRow(grid, 2, "Concentration for flocculation", concentration,
                               "flocculationConcentration", parameters);
    m_chinder = mtdlg::NumberRow(grid, 3, "Concentration for hindered settling", concentration,
                                 "hinderedSettlingConcentration", parameters);
    grid->setColumnStretch(3, 1);

    // Both grids stand at the same place; the flocculation choice shows one of them.
    m_gridGroup = new QGroupBox(this);
    m_gridGroup->setObjectName("settlingGridGroup");
    m_constantGrid = new CMTSettlingGrid(CMTSettlingGrid::kConstantVelocity, m_gridGroup);
    m_constantGrid->setObjectName("constantVelocityGrid");
    m_coefficientGrid = new CMTSettlingGrid(CMTSettlingGrid::kCoefficient, m_gridGroup);
    m_coefficientGrid->setObjectName("coefficientGrid");
    auto* grids = new QGridLayout(m_gridGroup);
    grids->addWidget(m_constantGrid, 0, 0, Qt::AlignLeft | Qt::AlignTop);
    grids->addWidget(m_coefficientGrid, 0, 0, Qt::AlignLeft | Qt::AlignTop);
    grids->setRowStretch(1, 1);
    grids->setColumnStretch(1, 1);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(flocculation);
    layout->addWidget(hindered);
    layout->addWidget(parameters);
    layout->addWidget(m_gridGroup, 1);

    for (QAbstractButton* button :
         {static_cast<QAbstractButton*>(m_flocculation), static_cast<QAbstractButton*>(m_constant),
          static_cast<QAbstractButton*>(m_hindered), static_cast<QAbstractButton*>(m_winterwerp),
          static_cast<QAbstractButton*>(m_richardsonZaki)})
        connect(button, &QAbstractButton::clicked, this, [this] { Store(); });
}

CMTSettlingKiv* CMTSettlingDlg::Settling() const {
    return Section<CMTSettlingKiv>();
}

void CMTSettlingDlg::Initialize() {
    if (CMTSettlingKiv* s = Settling()) {
        mtdlg::BindDouble(this, m_cgel.Edit(), &CMTSettlingKiv::Cgel, &CMTSettlingKiv::Cgel);
        mtdlg::BindDouble(this, m_rhoSediment.Edit(), &CMTSettlingKiv::RhoSediment,
                          &CMTSettlingKiv::RhoSediment);
        mtdlg::BindDouble(this, m_cfloc.Edit(), &CMTSettlingKiv::Cfloc, &CMTSettlingKiv::Cfloc);
        mtdlg::BindDouble(this, m_chinder.Edit(), &CMTSettlingKiv::Chinder,
                          &CMTSettlingKiv::Chinder);
        for (CMTSettlingGrid* g : {m_constantGrid, m_coefficientGrid}) {
            g->Initialize(this, s);
            g->FitColumns();
            g->SizeToDialog();
        }
    }
    CZoSEDlgBase::Initialize();
}

void CMTSettlingDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTSettlingKiv* s = Settling();
    if (!s)
        return;
    const int flocculation = s->Flocculation();
    const int hindered = s->HinderedSettling();
    // Values no choice stands for (kept from the file) show no choice.
    mtdlg::ShowChoice({m_flocculation, m_constant}, flocculation == 1   ? m_flocculation
                                                    : flocculation == 0 ? m_constant
                                                                        : nullptr);
    {
        const QSignalBlocker block(m_hindered);
        m_hindered->setChecked(hindered >= 1);
    }
    mtdlg::ShowChoice({m_winterwerp, m_richardsonZaki}, hindered == 0 || hindered == 1
                                                            ? m_winterwerp
                                                        : hindered == 2 ? m_richardsonZaki
                                                                        : nullptr);
    for (mtdlg::NumberRow* row : {&m_cgel, &m_rhoSediment, &m_cfloc, &m_chinder})
        row->ShowUnit();

    const bool f = flocculation > 0;
    m_hindered->setEnabled(f);
    m_cfloc.SetEnabled(f);
    m_chinder.SetEnabled(f);
    m_rhoSediment.SetEnabled(f);
    const bool formulations = f && hindered >= 1;
    m_winterwerp->setEnabled(formulations);
    m_richardsonZaki->setEnabled(formulations);
    m_cgel.SetEnabled(formulations);

    m_gridGroup->setTitle(flocculation != 0 ? "Settling Velocity Coefficient"
                                            : "Constant Velocity Settling");
    m_constantGrid->setVisible(flocculation == 0);
    m_coefficientGrid->setVisible(flocculation != 0);
    mtdlg::RefreshGrid(m_constantGrid);
    mtdlg::RefreshGrid(m_coefficientGrid);
}

void CMTSettlingDlg::Store() {
    CMTSettlingKiv* s = Settling();
    if (!s)
        return;
    if (m_flocculation->isChecked())
        s->Flocculation(1);
    else if (m_constant->isChecked())
        s->Flocculation(0);
    if (!m_hindered->isChecked())
        s->HinderedSettling(0);
    else if (m_richardsonZaki->isChecked())
        s->HinderedSettling(2);
    else if (m_winterwerp->isChecked() || s->HinderedSettling() < 1)
        s->HinderedSettling(1);
    // else: a value above 2 that no formulation stands for, kept as read
    // The items' values in use follow the choice at once, not only at the next validation,
    // so that the item dialogs and the tree show the value the choice needs as in use.
    for (int i = 1; i <= s->GetItemCount(); ++i)
        s->GetItem(i)->UpdateValuesInUse();
    UpdateDoc(kHintValueChanged);
}
