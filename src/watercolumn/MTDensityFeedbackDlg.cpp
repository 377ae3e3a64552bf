#include "MTDensityFeedbackDlg.h"

#include "MTDensityFeedbackKiv.h"

#include <QCheckBox>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDensityFeedbackDlg)

CMTDensityFeedbackDlg::CMTDensityFeedbackDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5019);
    m_include = new QCheckBox("Density Feedback on HD", this);
    m_include->setObjectName("densityFeedback");
    auto* grid = new QGridLayout;
    m_density =
        mtdlg::NumberRow(grid, 0, "Density of Suspended Sediment",
                         CZoEditStyle().SetOvuUnitBaseGroup(100017).SetFloatRange(), "sedimentDensity", this);
    m_base = mtdlg::NumberRow(grid, 1, "Base in Viscosity Formula",
                              CZoEditStyle().SetOvuUnitBaseGroup(100144).SetFloatRange(), "viscosityBase", this);
    m_concentration = mtdlg::NumberRow(grid, 2, "Concentration in Viscosity Formula",
                                       CZoEditStyle().SetOvuUnitBaseGroup(100403).SetFloatRange(),
                                       "viscosityConcentration", this);
    grid->setColumnStretch(3, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_include);
    layout->addLayout(grid);
    layout->addStretch(1);

    connect(m_include, &QCheckBox::clicked, this, [this](bool on) {
        if (CMTDensityFeedbackKiv* f = Feedback()) {
            f->IncludeDensityFeedback(on);
            UpdateDoc(kHintValueChanged);
        }
    });
}

CMTDensityFeedbackKiv* CMTDensityFeedbackDlg::Feedback() const {
    return Section<CMTDensityFeedbackKiv>();
}

void CMTDensityFeedbackDlg::Initialize() {
    mtdlg::BindDouble(this, m_density.Edit(), &CMTDensityFeedbackKiv::DensityOfSediment,
                      &CMTDensityFeedbackKiv::DensityOfSediment);
    mtdlg::BindDouble(this, m_base.Edit(), &CMTDensityFeedbackKiv::BaseInViscosityFormula,
                      &CMTDensityFeedbackKiv::BaseInViscosityFormula);
    mtdlg::BindDouble(this, m_concentration.Edit(),
                      &CMTDensityFeedbackKiv::ConcentrationInViscosityFormula,
                      &CMTDensityFeedbackKiv::ConcentrationInViscosityFormula);
    CZoSEDlgBase::Initialize();
}

void CMTDensityFeedbackDlg::SetData() {
    CZoSEDlgBase::SetData();
    const CMTDensityFeedbackKiv* f = Feedback();
    if (!f)
        return;
    const bool on = f->IncludeDensityFeedback();
    {
        const QSignalBlocker block(m_include);
        m_include->setChecked(on);
    }
    for (mtdlg::NumberRow* row : {&m_density, &m_base, &m_concentration}) {
        row->ShowUnit();
        row->SetEnabled(on);
    }
}
