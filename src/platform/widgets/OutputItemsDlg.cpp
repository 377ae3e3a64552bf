#include "OutputItemsDlg.h"

#include "fem/OutputItemsKiv.h"

#include <QGroupBox>
#include <QListWidget>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(COutputItemsDlg)

COutputItemsDlg::COutputItemsDlg(QWidget* parent) : CZoSEDlgBase(parent), m_items(new QListWidget(this)) {
    HelpID(5031);
    m_items->setObjectName("items");
    auto* group = new QGroupBox("Output items", this);
    auto* inner = new QVBoxLayout(group);
    inner->addWidget(m_items);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(group);
    connect(m_items, &QListWidget::itemChanged, this, &COutputItemsDlg::OnItemChanged);
}

void COutputItemsDlg::SetData() {
    CZoSEDlgBase::SetData();
    const QSignalBlocker block(m_items);
    m_items->clear();
    auto* section = Section<COutputItemsKiv>();
    for (int i = 0; section && i < section->NumBasicItems(); ++i) {
        CString label, keyword;
        int type = 0;
        bool selected = false;
        section->GetBasicItem(i, label, keyword, type, selected);
        auto* row = new QListWidgetItem(QString::fromStdString(label.empty() ? keyword : label), m_items);
        row->setFlags(Qt::ItemIsEnabled | Qt::ItemIsUserCheckable);
        row->setCheckState(selected ? Qt::Checked : Qt::Unchecked);
        row->setData(Qt::UserRole, i);
    }
}

void COutputItemsDlg::OnItemChanged(QListWidgetItem* row) {
    auto* section = Section<COutputItemsKiv>();
    if (!section || !row)
        return;
    section->SetBasicItemSelected(row->data(Qt::UserRole).toInt(), row->checkState() == Qt::Checked);
    UpdateDoc(kHintValueChanged);
}
