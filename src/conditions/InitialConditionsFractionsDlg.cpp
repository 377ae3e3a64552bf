#include "InitialConditionsFractionsDlg.h"

#include "InitialConditionsFractionsGrid.h"
#include "watercolumn/MTWaterColumnDlgSupport.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CInitialConditionsFractionsDlg)

CInitialConditionsFractionsDlg::CInitialConditionsFractionsDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CInitialConditionsFractionsGrid(this)) {
    HelpID(5007);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CInitialConditionsFractionsDlg::Initialize() {
    if (auto* list = Section<CInitialConditionsFractionsKiv>()) {
        m_grid->Initialize(this, list);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CInitialConditionsFractionsDlg::SetData() {
    CZoSEDlgBase::SetData();
    mtdlg::RefreshGrid(m_grid);
}
