#include "MTDredgingDlg.h"

#include "MTDredgingGrid.h"
#include "MTDredgingKiv.h"
#include "MTDredgingMapDlg.h"
#include "widgets/ZoSEGridToolbar.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QPointer>
#include <QPushButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDredgingDlg)

CMTDredgingDlg::CMTDredgingDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_grid(new CMTDredgingGrid(this)),
      m_toolbar(new CZoSEGridToolbar(m_grid, this)),
      m_new(new QPushButton("New dredger", this)), m_delete(new QPushButton("Delete dredger", this)),
      m_updateBed(new QCheckBox("Include update of the bed", this)) {
    HelpID(5048);
    m_grid->setObjectName("grid");
    m_toolbar->setObjectName("toolbar");
    m_new->setObjectName("newDredger");
    m_delete->setObjectName("deleteDredger");
    m_updateBed->setObjectName("updateBed");
    m_grid->setToolTip("Select whole rows by their numbers to delete or move dredgers; "
                       "\"Go to...\" opens a dredger's page");
    m_new->setToolTip("Append a dredger");
    m_delete->setToolTip("Delete the dredgers of the rows selected by their numbers");
    m_updateBed->setToolTip("Whether the bed is updated by the mass the dredgers remove");

    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_new);
    buttons->addWidget(m_delete);
    buttons->addStretch(1);
    m_layout = new QVBoxLayout(this);
    m_layout->addWidget(m_toolbar);
    m_layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    m_layout->addLayout(buttons);
    m_layout->addWidget(m_updateBed);

    connect(m_new, &QPushButton::clicked, this, &CMTDredgingDlg::OnNewDredger);
    connect(m_delete, &QPushButton::clicked, this, &CMTDredgingDlg::OnDeleteDredger);
    connect(m_updateBed, &QCheckBox::clicked, this, [this](bool on) {
        if (!List())
            return;
        List()->UpdateBed(on);
        UpdateDoc(kHintValueChanged);
    });
}

CMTDredgingKiv* CMTDredgingDlg::List() const { return Section<CMTDredgingKiv>(); }

void CMTDredgingDlg::Initialize() {
    if (CMTDredgingKiv* list = List()) {
        m_grid->Initialize(this, list);
        // A click on a track selects its row.
        m_map = new CMTDredgingMapDlg;
        m_map->setParent(this);
        m_map->setObjectName("map");
        m_map->setMinimumHeight(320);
        m_map->Attach(list, Host());
        m_map->Initialize();
        m_layout->addWidget(m_map, 1);
        connect(m_map, &CGisNavigationDlg::featureSelected, this, [this](int overlay, int number) {
            if (overlay == m_map->TrackOverlay()) {
                m_grid->ClearSelection();
                m_grid->SelectRows(number, number);
            }
        });
    } else {
        m_layout->addStretch(1);
    }
    CZoSEDlgBase::Initialize();
}

void CMTDredgingDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTDredgingKiv* list = List();
    if (!list)
        return;
    m_grid->Refresh();
    if (m_map)
        m_map->SetData();
    const QSignalBlocker block(m_updateBed);
    m_updateBed->setChecked(list->UpdateBed());
}

void CMTDredgingDlg::OnNewDredger() {
    CMTDredgingKiv* list = List();
    if (!list)
        return;
    list->Append();
    m_grid->Refresh();
    QPointer<CMTDredgingDlg> self(this);
    UpdateDoc(kHintItemsAdded);
    if (self)
        UpdateDoc(kHintItemsReordered);
}

void CMTDredgingDlg::OnDeleteDredger() {
    CMTDredgingKiv* list = List();
    if (!list)
        return;
    // Only one run of whole rows: each deletion at its top, as the rows below move up.
    const std::vector<CZoGridWnd::RowRange> ranges = m_grid->GetSelectedRowRanges();
    if (ranges.size() != 1)
        return;
    for (int row = ranges.front().top; row <= ranges.front().bottom; ++row)
        list->Delete(ranges.front().top, 1);
    m_grid->ClearSelection();
    m_grid->Refresh();
    UpdateDoc(kHintItemsDeleted);
}
