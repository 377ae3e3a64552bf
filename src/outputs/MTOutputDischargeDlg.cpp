#include "MTOutputDischargeDlg.h"

#include "MTOutputItemSubDischargeKiv.h"

#include <QComboBox>
#include <QGroupBox>
#include <QListWidget>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTOutputDischargeDlg)

CMTOutputDischargeDlg::CMTOutputDischargeDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_list(new QListWidget(this)), m_type(new QComboBox(this)) {
    HelpID(5031);
    m_list->setObjectName("variables");
    m_type->setObjectName("dischargeType");
    m_type->addItem("Basic", 1);
    m_type->addItem("Extended", 2);
    auto* group = new QGroupBox("Basic variables", this);
    auto* inner = new QVBoxLayout(group);
    inner->addWidget(m_list);
    inner->addWidget(m_type);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(group);
    connect(m_list, &QListWidget::itemChanged, this, &CMTOutputDischargeDlg::OnChecked);
    connect(m_type, &QComboBox::activated, this, &CMTOutputDischargeDlg::OnType);
}

void CMTOutputDischargeDlg::SetData() {
    CZoSEDlgBase::SetData();
    auto* sub = Section<CMTOutputItemSubDischargeKiv>();
    const QSignalBlocker block(m_list);
    m_list->clear();
    if (!sub)
        return;
    for (int i = 0; i < sub->NumBasicItems(); ++i) {
        CString label, keyword;
        int type = 0;
        bool selected = false;
        sub->GetBasicItem(i, label, keyword, type, selected);
        // The discharges have no label: they are always written.
        if (label.empty())
            continue;
        auto* row = new QListWidgetItem(QString::fromStdString(label), m_list);
        row->setFlags(Qt::ItemIsEnabled | Qt::ItemIsUserCheckable);
        row->setCheckState(selected ? Qt::Checked : Qt::Unchecked);
        row->setData(Qt::UserRole, i);
    }
    m_type->setCurrentIndex(m_type->findData(sub->Type()));
}

void CMTOutputDischargeDlg::OnChecked() {
    auto* sub = Section<CMTOutputItemSubDischargeKiv>();
    if (!sub)
        return;
    for (int r = 0; r < m_list->count(); ++r)
        sub->SetBasicItemSelected(m_list->item(r)->data(Qt::UserRole).toInt(),
                                  m_list->item(r)->checkState() == Qt::Checked);
    // Stored without a hint in the old pages; the document must still learn of the change.
    UpdateDoc(kHintValueChanged);
}

void CMTOutputDischargeDlg::OnType(int index) {
    auto* sub = Section<CMTOutputItemSubDischargeKiv>();
    if (!sub || index < 0)
        return;
    sub->Type(m_type->itemData(index).toInt());
    UpdateDoc(kHintValueChanged);
}
