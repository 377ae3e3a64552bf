#include "MTOutputItemSubDlg.h"

#include "MTOutputItemSubKiv.h"

#include <QGroupBox>
#include <QHBoxLayout>
#include <QListWidget>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTOutputItemSubDlg)

namespace {
using List = CMTOutputItemSubKiv::List;

QListWidget* InGroup(const char* title, const char* name, QWidget* parent, QLayout* into) {
    auto* group = new QGroupBox(title, parent);
    auto* list = new QListWidget(group);
    list->setObjectName(name);
    auto* inner = new QVBoxLayout(group);
    inner->addWidget(list);
    into->addWidget(group);
    return list;
}
}  // namespace

CMTOutputItemSubDlg::CMTOutputItemSubDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5031);
    auto* layout = new QHBoxLayout(this);
    m_basic = InGroup("Basic variables", "basicVariables", this, layout);
    m_additional = InGroup("Additional variables", "additionalVariables", this, layout);
    for (QListWidget* list : {m_basic, m_additional})
        connect(list, &QListWidget::itemChanged, this, &CMTOutputItemSubDlg::OnChanged);
}

void CMTOutputItemSubDlg::Fill(QListWidget* list, int which) {
    const QSignalBlocker block(list);
    list->clear();
    auto* sub = Section<CMTOutputItemSubKiv>();
    if (!sub)
        return;
    const List l = static_cast<List>(which);
    for (int i = 0; i < sub->Count(l); ++i) {
        const CMTOutputItemSubKiv::_COutputItem item = sub->Item(l, i);
        // Quantities not offered keep their selection and are still written.
        if (!sub->IsOffered(item.itemClass))
            continue;
        auto* row = new QListWidgetItem(QString::fromStdString(item.label), list);
        row->setFlags(Qt::ItemIsEnabled | Qt::ItemIsUserCheckable);
        row->setCheckState(item.value ? Qt::Checked : Qt::Unchecked);
        row->setData(Qt::UserRole, i);
    }
}

void CMTOutputItemSubDlg::SetData() {
    CZoSEDlgBase::SetData();
    Fill(m_basic, static_cast<int>(List::Basic));
    Fill(m_additional, static_cast<int>(List::Additional));
}

void CMTOutputItemSubDlg::OnChanged() {
    auto* sub = Section<CMTOutputItemSubKiv>();
    if (!sub)
        return;
    for (auto [list, which] : {std::pair{m_basic, List::Basic}, std::pair{m_additional, List::Additional}})
        for (int r = 0; r < list->count(); ++r)
            sub->Value(which, list->item(r)->data(Qt::UserRole).toInt(),
                       list->item(r)->checkState() == Qt::Checked ? 1 : 0);
    UpdateDoc(kHintValueChanged);
}
