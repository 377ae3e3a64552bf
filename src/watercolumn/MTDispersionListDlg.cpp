#include "MTDispersionListDlg.h"

#include "MTDispersionGrid.h"
#include "MTDispersionKiv.h"
#include "MTWaterColumnDlgSupport.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDispersionListDlg)

CMTDispersionListDlg::CMTDispersionListDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTDispersionGrid(this)) {
    HelpID(5024);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CMTDispersionListDlg::Initialize() {
    if (auto* list = Section<CMTDispersionListKiv>()) {
        m_grid->Initialize(this, list);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CMTDispersionListDlg::SetData() {
    CZoSEDlgBase::SetData();
    mtdlg::RefreshGrid(m_grid);
}
