#include "MTMorphologyDlg.h"

#include "MTMorphologyKiv.h"
#include "widgets/ZoNumberEdit.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTMorphologyDlg)

CMTMorphologyDlg::CMTMorphologyDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_include(new QCheckBox("Include Morphological calculations", this)),
      m_speedup(new QCheckBox("Apply speedup factor", this)),
      m_factorLabel(new QLabel("Speedup factor", this)), m_factor(new CZoNumberEdit(CZoEditStyle().SetFloatRange(), this)) {
    HelpID(5029);
    m_include->setObjectName("includeMorphologicalUpdate");
    m_speedup->setObjectName("applySpeedup");
    m_factorLabel->setObjectName("speedupFactorLabel");
    m_factor->setObjectName("speedupFactor");
    m_factorLabel->setBuddy(m_factor);

    // The check box heads the frame of what it switches on.
    auto* frame = new QGroupBox(this);
    auto* grid = new QGridLayout(frame);
    grid->addWidget(m_include, 0, 0, 1, 3);
    grid->addWidget(m_speedup, 1, 0, 1, 3);
    grid->addWidget(m_factorLabel, 2, 0);
    grid->addWidget(m_factor, 2, 1);
    grid->setColumnStretch(2, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame);
    layout->addStretch(1);

    connect(m_include, &QCheckBox::clicked, this, &CMTMorphologyDlg::Store);
    connect(m_speedup, &QCheckBox::clicked, this, &CMTMorphologyDlg::Store);
}

CMTMorphologyKiv* CMTMorphologyDlg::Morphology() const {
    return Section<CMTMorphologyKiv>();
}

void CMTMorphologyDlg::Initialize() {
    if (Morphology())
        m_factor->BindDouble(
            this, [this] { return Morphology()->SpeedupFactor(); },
            [this](double factor) { Morphology()->SpeedupFactor(factor); });
    CZoSEDlgBase::Initialize();
}

void CMTMorphologyDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTMorphologyKiv* m = Morphology();
    if (!m)
        return;
    {
        const QSignalBlocker blockInclude(m_include);
        const QSignalBlocker blockSpeedup(m_speedup);
        m_include->setChecked(m->IncludeMorphologicalUpdate());
        m_speedup->setChecked(m->IncludeSpeedup());
    }
    // Switched-off settings keep their values; they are only greyed.
    const bool update = m->IncludeMorphologicalUpdate();
    m_speedup->setEnabled(update);
    m_factorLabel->setEnabled(update && m->IncludeSpeedup());
    m_factor->setEnabled(update && m->IncludeSpeedup());
}

void CMTMorphologyDlg::Store() {
    CMTMorphologyKiv* m = Morphology();
    if (!m)
        return;
    m->IncludeMorphologicalUpdate(m_include->isChecked());
    m->IncludeSpeedup(m_speedup->isChecked());
    UpdateDoc(kHintValueChanged);
}
