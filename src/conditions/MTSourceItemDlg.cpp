#include "MTSourceItemDlg.h"

#include "MTSourceItemGrid.h"
#include "watercolumn/MTWaterColumnDlgSupport.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSourceItemDlg)

CMTSourceItemDlg::CMTSourceItemDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTSourceItemGrid(this)) {
    HelpID(5040);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CMTSourceItemDlg::Initialize() {
    if (auto* source = Section<CMTSourceItemKiv>()) {
        m_grid->Initialize(this, source);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

// The grid is drawn from the source's components whenever they change.
void CMTSourceItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    mtdlg::RefreshGrid(m_grid);
}
