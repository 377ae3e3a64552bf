#include "SourceDlg.h"

#include "MTSourceGrid.h"
#include "hydro/HDSourcesKiv.h"
#include "widgets/HDSourceGisPropSheet.h"

#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CSourceDlg)

CSourceDlg::CSourceDlg(QWidget* parent) : CZoSEDlgBase(parent), m_grid(new CMTSourceGrid(this)) {
    HelpID(5041);
    m_style.SetFormat("%20s");
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

void CSourceDlg::Initialize() {
    if (auto* list = Section<CMTSourceKiv>()) {
        m_grid->Initialize(this, list, true);
        // Opened for one source ("View location"): that source's row is selected.
        if (const int feature = CHDSourceGisPropSheet::GetInitialSelectedFeature(); feature > 0) {
            SetData();
            m_grid->SelectRows(feature, feature);
        }
    }
    CZoSEDlgBase::Initialize();
}

void CSourceDlg::SetData() {
    CZoSEDlgBase::SetData();
    const CHDSourcesKiv* sources = GetSection() ? HDSources(GetSection()) : nullptr;
    const int before = m_grid->GetRowCount();
    m_grid->SetSourceRows(sources ? sources->GetItemCount() : 0);
    if (m_grid->GetRowCount() != before)
        m_grid->SizeToDialog();
}
