#include "MTDensityListDlg.h"

#include "MTDensityGrid.h"
#include "MTDensityListKiv.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDensityListDlg)

CMTDensityListDlg::CMTDensityListDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTDensityGrid(this)) {
    HelpID(5018);
    m_grid->setObjectName("grid");
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CMTDensityListDlg::Initialize() {
    if (auto* list = Section<CMTDensityListKiv>())
        m_grid->Initialize(this, list);
    CZoSEDlgBase::Initialize();
}

void CMTDensityListDlg::SetData() {
    CZoSEDlgBase::SetData();
    m_grid->Refresh();
}
