#include "MTSandFractionListDlg.h"

#include "MTSandFractionGrid.h"
#include "MTSandFractionListKiv.h"
#include "MTWaterColumnDlgSupport.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSandFractionListDlg)

CMTSandFractionListDlg::CMTSandFractionListDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5034);
    auto* frame = new QGroupBox(this);
    m_include = new QCheckBox("Include Sand Fractions", frame);
    m_include->setObjectName("includeSandFractions");
    m_grid = new CMTSandFractionGrid(frame);
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_include);
    inner->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    inner->addStretch(1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame, 1);
    connect(m_include, &QCheckBox::clicked, this, [this] { OnInclude(); });
}

CMTSandFractionListKiv* CMTSandFractionListDlg::List() const {
    return Section<CMTSandFractionListKiv>();
}

void CMTSandFractionListDlg::Initialize() {
    if (CMTSandFractionListKiv* list = List()) {
        m_grid->Initialize(this, list);
        m_grid->FitColumns();
        m_grid->SizeToDialog();
    }
    CZoSEDlgBase::Initialize();
}

void CMTSandFractionListDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTSandFractionListKiv* list = List();
    if (!list)
        return;
    {
        const QSignalBlocker block(m_include);
        m_include->setChecked(list->IncludeSandFractions());
    }
    mtdlg::RefreshGrid(m_grid);
}

void CMTSandFractionListDlg::OnInclude() {
    CMTSandFractionListKiv* list = List();
    if (!list)
        return;
    list->IncludeSandFractions(m_include->isChecked());
    m_grid->Redraw();
    UpdateDoc(kHintValueChanged);
}
