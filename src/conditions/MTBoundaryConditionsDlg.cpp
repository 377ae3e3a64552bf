#include "MTBoundaryConditionsDlg.h"

#include "MTBoundaryConditionsGridDlg.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTBoundaryConditionsDlg)

CMTBoundaryConditionsDlg::CMTBoundaryConditionsDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTBoundaryConditionsGridDlg(this)) {
    HelpID(5016);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CMTBoundaryConditionsDlg::Initialize() {
    if (auto* list = Section<CMTBoundaryConditionsKiv>()) {
        m_grid->Initialize(this, list);
        FitGrid();
    }
    CZoSEDlgBase::Initialize();
    HideCaption(1);
}

// Columns to their contents (the grid samples a bounded number of rows).
void CMTBoundaryConditionsDlg::FitGrid() { m_grid->FitToContents(); }

void CMTBoundaryConditionsDlg::SetData() {
    CZoSEDlgBase::SetData();
    const int before = m_grid->GetRowCount();
    m_grid->Redraw();
    if (m_grid->GetRowCount() != before)
        FitGrid();
}
