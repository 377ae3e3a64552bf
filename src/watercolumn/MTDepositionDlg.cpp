#include "MTDepositionDlg.h"

#include "MTDepositionGrid.h"
#include "MTDepositionKiv.h"
#include "MTWaterColumnDlgSupport.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QRadioButton>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDepositionDlg)

namespace {
enum Profile { kRouse = 0, kTeeter = 1 };
}

CMTDepositionDlg::CMTDepositionDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5051);

    auto* parameters = new QGroupBox("Deposition Parameters", this);
    m_rouse = new QRadioButton("Apply Rouse Profile", parameters);
    m_rouse->setObjectName("rouseProfile");
    m_teeter = new QRadioButton("Apply Teeter Profile", parameters);
    m_teeter->setObjectName("teeterProfile");
    m_centroidLabel = new QLabel("Relative centroid height", parameters);
    m_centroidHeight = new CZoNumberEdit(parameters);
    m_centroidHeight->setObjectName("centroidHeight");
    m_centroidLabel->setBuddy(m_centroidHeight);
    auto* grid = new QGridLayout(parameters);
    grid->addWidget(m_rouse, 0, 0, 1, 2);
    grid->addWidget(m_teeter, 1, 0, 1, 2);
    grid->addWidget(m_centroidLabel, 2, 0);
    grid->addWidget(m_centroidHeight, 2, 1);
    grid->setColumnStretch(2, 1);

    auto* stresses = new QGroupBox("Critical  Shear Stress for Deposition", this);
    m_grid = new CMTDepositionGrid(stresses);
    auto* inner = new QVBoxLayout(stresses);
    inner->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    inner->addStretch(1);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(parameters);
    layout->addWidget(stresses, 1);

    connect(m_rouse, &QRadioButton::clicked, this, [this] { Store(); });
    connect(m_teeter, &QRadioButton::clicked, this, [this] { Store(); });
}

CMTDepositionKiv* CMTDepositionDlg::Deposition() const {
    return Section<CMTDepositionKiv>();
}

void CMTDepositionDlg::Initialize() {
    if (CMTDepositionKiv* d = Deposition()) {
        // A plain number: the height is relative to the water depth.
        mtdlg::BindDouble(this, m_centroidHeight, &CMTDepositionKiv::CentroidHeight,
                          &CMTDepositionKiv::CentroidHeight);
        m_grid->Initialize(this, d);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CMTDepositionDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTDepositionKiv* d = Deposition();
    if (!d)
        return;
    const int profile = d->ConcentrationProfile();
    mtdlg::ShowChoice({m_rouse, m_teeter}, profile == kRouse    ? m_rouse
                                           : profile == kTeeter ? m_teeter
                                                                : nullptr);
    const bool rouse = profile == kRouse;
    m_centroidLabel->setEnabled(rouse);
    m_centroidHeight->setEnabled(rouse);
    mtdlg::RefreshGrid(m_grid);
}

void CMTDepositionDlg::Store() {
    CMTDepositionKiv* d = Deposition();
    if (!d)
        return;
    if (m_rouse->isChecked())
        d->ConcentrationProfile(kRouse);
    else if (m_teeter->isChecked())
        d->ConcentrationProfile(kTeeter);
    UpdateDoc(kHintValueChanged);
}
