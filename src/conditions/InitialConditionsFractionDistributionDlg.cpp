#include "InitialConditionsFractionDistributionDlg.h"

#include "InitialConditionsFractionDistributionGrid.h"
#include "watercolumn/MTWaterColumnDlgSupport.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CInitialConditionsFractionDistributionDlg)

CInitialConditionsFractionDistributionDlg::CInitialConditionsFractionDistributionDlg(
    QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CInitialConditionsFractionDistributionGrid(this)) {
    HelpID(5006);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CInitialConditionsFractionDistributionDlg::Initialize() {
    if (auto* list = Section<CInitialConditionsFractionDistributionKiv>()) {
        m_grid->Initialize(this, list);
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CInitialConditionsFractionDistributionDlg::SetData() {
    CZoSEDlgBase::SetData();
    const int columns = m_grid->GetColCount();
    m_grid->SetColumns();
    mtdlg::RefreshGrid(m_grid);
    if (m_grid->GetColCount() != columns)
        m_grid->SizeToDialog();
}
