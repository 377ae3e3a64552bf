#include "MTOutputDlg.h"

#include "MTOutputGrid.h"
#include "MTOutputKiv.h"

#include <QHBoxLayout>
#include <QPointer>
#include <QPushButton>
#include <QTimer>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTOutputDlg)

CMTOutputDlg::CMTOutputDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTOutputGrid(this)), m_new(new QPushButton("New output", this)),
      m_delete(new QPushButton("Delete output", this)) {
    HelpID(5033);
    m_grid->setObjectName("grid");
    m_new->setObjectName("newOutput");
    m_delete->setObjectName("deleteOutput");
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_new);
    buttons->addWidget(m_delete);
    buttons->addStretch(1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addLayout(buttons);
    layout->addStretch(1);
    connect(m_new, &QPushButton::clicked, this, &CMTOutputDlg::OnNew);
    connect(m_delete, &QPushButton::clicked, this, &CMTOutputDlg::OnDelete);
}

CMTOutputKiv* CMTOutputDlg::List() const { return Section<CMTOutputKiv>(); }

void CMTOutputDlg::Initialize() {
    if (CMTOutputKiv* list = List())
        m_grid->Initialize(this, list);
    CZoSEDlgBase::Initialize();
}

void CMTOutputDlg::SetData() {
    CZoSEDlgBase::SetData();
    // Outputs added by the grid's keys (or read under the placeholder title) are named here;
    // the title change reaches the document once this refresh is over, never from inside it.
    if (CMTOutputKiv* list = List(); list && list->NameNewOutputs() && !m_renamePending) {
        m_renamePending = true;
        QPointer<CMTOutputDlg> self(this);
        QTimer::singleShot(0, this, [self] {
            if (!self)
                return;
            self->m_renamePending = false;
            self->UpdateDoc(kHintTitleChanged);
        });
    }
    Refresh();
}

void CMTOutputDlg::Refresh() {
    m_grid->Redraw();
    m_grid->FitColumns();
    m_grid->SizeToDialog();
}

void CMTOutputDlg::OnNew() {
    CMTOutputKiv* list = List();
    if (!list)
        return;
    list->Append();
    // Named as it is appended, so that the grid shows the stored title.
    list->NameNewOutputs();
    Refresh();
    UpdateDoc(kHintItemsAdded);
    UpdateDoc(kHintItemsReordered);
}

void CMTOutputDlg::OnDelete() {
    CMTOutputKiv* list = List();
    const std::vector<CZoGridWnd::RowRange> ranges = m_grid->GetSelectedRowRanges();
    if (!list || ranges.size() != 1)
        return;
    for (int row = ranges[0].top; row <= ranges[0].bottom; ++row)
        list->Delete(ranges[0].top, 1);
    m_grid->ClearSelection();
    Refresh();
    UpdateDoc(kHintItemsDeleted);
}
