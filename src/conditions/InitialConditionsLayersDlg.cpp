#include "InitialConditionsLayersDlg.h"

#include "InitialConditionsLayersGrid.h"
#include "watercolumn/MTWaterColumnDlgSupport.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CInitialConditionsLayersDlg)

CInitialConditionsLayersDlg::CInitialConditionsLayersDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CInitialConditionsLayersGrid(this)) {
    HelpID(5009);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CInitialConditionsLayersDlg::Initialize() {
    if (auto* list = Section<CInitialConditionsLayersKiv>()) {
        m_grid->Initialize(this, list);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CInitialConditionsLayersDlg::SetData() {
    CZoSEDlgBase::SetData();
    mtdlg::RefreshGrid(m_grid);
}
