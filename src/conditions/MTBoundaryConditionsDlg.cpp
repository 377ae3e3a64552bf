#include "MTBoundaryConditionsDlg.h"

#include "MTBoundaryConditionsGridDlg.h"

#include <QHeaderView>
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

// Columns to their contents (the grid samples a bounded number of rows); rows keep the one
// height of the font, so that ten thousand boundaries open at once.
void CMTBoundaryConditionsDlg::FitGrid() {
    m_grid->resizeColumnsToContents();
    m_grid->verticalHeader()->resizeSection(0, m_grid->verticalHeader()->defaultSectionSize());
    m_grid->SizeToDialog();
}

void CMTBoundaryConditionsDlg::SetData() {
    CZoSEDlgBase::SetData();
    const int before = m_grid->GetRowCount();
    m_grid->Redraw();
    if (m_grid->GetRowCount() != before)
        FitGrid();
}
