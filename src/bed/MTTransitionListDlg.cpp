#include "MTTransitionListDlg.h"

#include "MTTransitionGrid.h"
#include "MTTransitionListKiv.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTTransitionListDlg)

CMTTransitionListDlg::CMTTransitionListDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_include(new QCheckBox("Include", this)),
      m_grid(new CMTTransitionGrid(this)) {
    HelpID(5043);
    m_include->setObjectName("include");
    m_grid->setObjectName("grid");

    auto* frame = new QGroupBox(this);
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_include);
    inner->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame, 0, Qt::AlignTop);
    layout->addStretch(1);
    connect(m_include, &QCheckBox::clicked, this, &CMTTransitionListDlg::OnInclude);
}

CMTTransitionListKiv* CMTTransitionListDlg::List() const {
    return Section<CMTTransitionListKiv>();
}

void CMTTransitionListDlg::Initialize() {
    if (CMTTransitionListKiv* list = List())
        m_grid->Initialize(this, list);
    CZoSEDlgBase::Initialize();
}

void CMTTransitionListDlg::SetData() {
    CZoSEDlgBase::SetData();
    if (CMTTransitionListKiv* list = List()) {
        const QSignalBlocker block(m_include);
        m_include->setChecked(list->IncludeTransition());
    }
    m_grid->Refresh();
}

void CMTTransitionListDlg::OnInclude(bool checked) {
    CMTTransitionListKiv* list = List();
    if (!list)
        return;
    list->IncludeTransition(checked);
    // The grid greys or un-greys at once, before the document hears of it.
    m_grid->Redraw();
    m_grid->viewport()->repaint();
    UpdateDoc(kHintValueChanged);
}
