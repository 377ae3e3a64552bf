#include "ZoFileSelectorDlg.h"

#include "FemBase.h"
#include "ZoPrompts.h"
#include "setupeditor/ZoSEQrdSelection.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileInfo>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QTableWidget>
#include <QTreeWidget>
#include <QVBoxLayout>

#include <algorithm>

namespace {

QString Q(const CString& s) { return QString::fromStdString(s); }

ZoFileSelectorHook& Hook() {
    static ZoFileSelectorHook hook;
    return hook;
}

const char* const kAnyDataFile =
    "Data files (*.qrd0 *.qrd1 *.qrd2 *.qrdu *.kx0 *.kx2);;All files (*)";

QString ItemText(const datafile::Item& item, int number) {
    return QString("%1: %2 [%3]").arg(number).arg(Q(item.name), Q(item.unit));
}

}  // namespace

CZoFileSelectorDlg::CZoFileSelectorDlg(const CString& fileName, const CString& filter,
                                       const CString& defaultExt, QWidget* parent)
    : QDialog(parent) {
    SetFileName(fileName);
    SetFilter(filter);
    SetDefaultExt(defaultExt);
    setWindowTitle(tr("Select Data File"));
}

CZoFileSelectorDlg::~CZoFileSelectorDlg() = default;

void CZoFileSelectorDlg::Prepare() {
    if (m_prepared)
        return;
    m_prepared = true;
    m_items = SelectedItems();
    if (RequestCount() > 0)
        m_items.resize(static_cast<std::size_t>(RequestCount()), 0);

    auto* layout = new QVBoxLayout(this);
    auto* fileRow = new QHBoxLayout;
    fileRow->addWidget(new QLabel(tr("File name"), this));
    m_name = new QLineEdit(Q(FileName()), this);
    m_name->setObjectName("fileName");
    fileRow->addWidget(m_name, 1);
    m_browse = new QPushButton(tr("Browse..."), this);
    m_browse->setObjectName("browse");
    fileRow->addWidget(m_browse);
    layout->addLayout(fileRow);

    m_summary = new QLabel(this);
    m_summary->setObjectName("summary");
    m_summary->setWordWrap(true);
    layout->addWidget(m_summary);

    layout->addWidget(new QLabel(tr("Items in the file"), this));
    m_itemList = new QTreeWidget(this);
    m_itemList->setObjectName("items");
    m_itemList->setRootIsDecorated(false);
    m_itemList->setHeaderLabels({tr("No."), tr("Item"), tr("Quantity"), tr("Unit")});
    layout->addWidget(m_itemList, 1);

    m_requestTable = new QTableWidget(this);
    m_requestTable->setObjectName("requests");
    m_assign = new QPushButton(tr("Assign"), this);
    m_assign->setObjectName("assign");
    m_assign->setToolTip(tr("Assign the selected item of the file to the selected request"));
    if (RequestCount() > 0) {
        auto* requestRow = new QHBoxLayout;
        requestRow->addWidget(new QLabel(tr("Items requested"), this));
        requestRow->addStretch(1);
        requestRow->addWidget(m_assign);
        layout->addLayout(requestRow);
        m_requestTable->setColumnCount(3);
        m_requestTable->setHorizontalHeaderLabels({tr("Request"), tr("Accepts"), tr("Item")});
        m_requestTable->setRowCount(RequestCount());
        m_requestTable->verticalHeader()->hide();
        m_requestTable->setSelectionBehavior(QAbstractItemView::SelectRows);
        m_requestTable->setSelectionMode(QAbstractItemView::SingleSelection);
        m_requestTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
        m_requestTable->horizontalHeader()->setStretchLastSection(true);
        for (int r = 0; r < RequestCount(); ++r) {
            m_requestTable->setItem(r, 0, new QTableWidgetItem(Q(Request(r).Description())));
            m_requestTable->setItem(r, 1, new QTableWidgetItem(Q(Request(r).AcceptedText())));
            auto* box = new QComboBox(m_requestTable);
            box->setObjectName(QString("request%1").arg(r + 1));
            m_requestTable->setCellWidget(r, 2, box);
            connect(box, &QComboBox::activated, this, [this, r, box](int index) {
                AssignItem(r, box->itemData(index).toInt());
            });
        }
        m_requestTable->resizeColumnsToContents();
        m_requestTable->selectRow(0);
        layout->addWidget(m_requestTable);
        if (GetMinNoItems() > RequestCount())
            layout->addWidget(new QLabel(
                tr("At least %1 items are needed.").arg(GetMinNoItems()), this));
    } else {
        m_requestTable->hide();
        m_assign->hide();
        if (GetMinNoItems() > 0)
            layout->addWidget(new QLabel(tr("Tick at least %1 items.").arg(GetMinNoItems()), this));
    }

    m_status = new QLabel(this);
    m_status->setObjectName("status");
    m_status->setWordWrap(true);
    m_status->setTextInteractionFlags(Qt::TextSelectableByMouse);
    layout->addWidget(m_status);

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    m_ok = buttons->button(QDialogButtonBox::Ok);
    m_ok->setObjectName("ok");
    buttons->button(QDialogButtonBox::Cancel)->setObjectName("cancel");
    m_view = buttons->addButton(tr("View ..."), QDialogButtonBox::ActionRole);
    m_view->setObjectName("view");
    layout->addWidget(buttons);
    connect(buttons, &QDialogButtonBox::accepted, this, &CZoFileSelectorDlg::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &CZoFileSelectorDlg::reject);
    connect(m_view, &QPushButton::clicked, this, &CZoFileSelectorDlg::OnView);
    connect(m_browse, &QPushButton::clicked, this, &CZoFileSelectorDlg::OnBrowse);
    connect(m_assign, &QPushButton::clicked, this, &CZoFileSelectorDlg::OnAssign);
    connect(m_name, &QLineEdit::editingFinished, this, [this] {
        if (m_name->text().trimmed().toStdString() != m_shownName)
            ChooseFile(m_name->text().toStdString());
    });
    connect(m_itemList, &QTreeWidget::itemChanged, this, &CZoFileSelectorDlg::OnItemChanged);
    connect(m_itemList, &QTreeWidget::itemDoubleClicked, this, [this] { OnAssign(); });
    resize(560, 480);
    Refresh();
}

int CZoFileSelectorDlg::DoModal() {
    Prepare();
    return exec();
}

CString CZoFileSelectorDlg::ChosenFileName() const {
    return m_name ? m_name->text().trimmed().toStdString() : FileName();
}

void CZoFileSelectorDlg::ChooseFile(const CString& name) {
    Prepare();
    QString text = Q(name).trimmed();
    // A name typed without extension takes the default one when that file exists.
    if (!text.isEmpty() && !DefaultExt().empty() && QFileInfo(text).suffix().isEmpty()) {
        const QString withExt = text + "." + Q(DefaultExt());
        if (QFileInfo::exists(Q(AbsolutePath(withExt.toStdString()))))
            text = withExt;
    }
    m_name->setText(text);
    Refresh();
}

void CZoFileSelectorDlg::OnBrowse() {
    const CString current = ChosenFileName();
    const QString start = current.empty() ? Q(BaseFolder()) : Q(AbsolutePath(current));
    const CString filter = ZoQtFilter(Filter());
    const QString chosen = ZoGetOpenFileName(this, tr("Select Data File"), start,
                                             filter.empty() ? QString(kAnyDataFile) : Q(filter));
    if (!chosen.isEmpty())
        ChooseFile(StoredName(chosen.toStdString()));
}

bool CZoFileSelectorDlg::AssignItem(int request, int itemNumber) {
    Prepare();
    if (request < 0 || request >= RequestCount())
        return false;
    if (itemNumber != 0) {
        CString why;
        if (!m_header || !m_header->header) {
            m_refusal = "there is no data file to take items from";
            RefreshStatus();
            return false;
        }
        if (!CanAssign(*m_header->header, request, itemNumber, &why)) {
            m_refusal = why;
            Refresh();
            return false;
        }
    }
    m_items[static_cast<std::size_t>(request)] = itemNumber;
    m_refusal.clear();
    Refresh();
    return true;
}

void CZoFileSelectorDlg::CheckItems(const std::vector<int>& itemNumbers) {
    Prepare();
    if (RequestCount() > 0)
        return;
    m_items = itemNumbers;
    Refresh();
}

void CZoFileSelectorDlg::OnAssign() {
    if (RequestCount() == 0)
        return;
    QTreeWidgetItem* item = m_itemList->currentItem();
    const int request = m_requestTable->currentRow();
    if (!item || request < 0)
        return;
    if (AssignItem(request, item->data(0, Qt::UserRole).toInt()) && request + 1 < RequestCount())
        m_requestTable->selectRow(request + 1);
}

void CZoFileSelectorDlg::OnItemChanged(QTreeWidgetItem* item) {
    if (m_filling || RequestCount() > 0)
        return;
    const int number = item->data(0, Qt::UserRole).toInt();
    const bool on = item->checkState(0) == Qt::Checked;
    const auto it = std::find(m_items.begin(), m_items.end(), number);
    if (on && it == m_items.end())
        m_items.push_back(number);
    else if (!on && it != m_items.end())
        m_items.erase(it);
    RefreshStatus();
}

void CZoFileSelectorDlg::OnView() {
    std::vector<int> items;
    for (int n : m_items)
        if (n > 0)
            items.push_back(n);
    CFemBase::OpenDataFile(AbsolutePath(ChosenFileName()), items, this);
}

void CZoFileSelectorDlg::Refresh() {
    m_filling = true;
    const CString name = ChosenFileName();
    m_shownName = name;
    m_header = name.empty() ? nullptr : Header(name);
    const datafile::Header* h = m_header && m_header->header ? &*m_header->header : nullptr;

    if (!h) {
        m_summary->setText(name.empty() ? tr("No file chosen.") : QString());
    } else {
        QString text = QString("%1: %2").arg(Q(datafile::KindName(h->kind)),
                                              Q(datafile::DescribeTimeAxis(h->time)));
        if (h->kind != datafile::Kind::TimeSeries)
            text += "; " + Q(datafile::DescribeLayout(*h));
        if (!h->title.empty())
            text = Q(h->title) + "\n" + text;
        m_summary->setText(text);
    }

    m_itemList->clear();
    const int count = h ? static_cast<int>(h->items.size()) : 0;
    for (int i = 0; i < count; ++i) {
        const datafile::Item& it = h->items[static_cast<std::size_t>(i)];
        auto* row = new QTreeWidgetItem(
            {QString::number(i + 1), Q(it.name), Q(datafile::DescribeUnitType(it.unitType)), Q(it.unit)});
        row->setData(0, Qt::UserRole, i + 1);
        if (RequestCount() == 0) {
            row->setFlags(row->flags() | Qt::ItemIsUserCheckable);
            const bool on = std::find(m_items.begin(), m_items.end(), i + 1) != m_items.end();
            row->setCheckState(0, on ? Qt::Checked : Qt::Unchecked);
        }
        m_itemList->addTopLevelItem(row);
    }
    for (int c = 0; c < 4; ++c)
        m_itemList->resizeColumnToContents(c);

    for (int r = 0; r < RequestCount(); ++r) {
        auto* box = qobject_cast<QComboBox*>(m_requestTable->cellWidget(r, 2));
        const QSignalBlocker block(box);
        box->clear();
        box->addItem(tr("(none)"), 0);
        const int current = m_items[static_cast<std::size_t>(r)];
        int select = 0;
        for (int i = 1; i <= count; ++i) {
            if (!CanAssign(*h, r, i, nullptr))
                continue;
            box->addItem(ItemText(h->items[static_cast<std::size_t>(i - 1)], i), i);
            if (i == current)
                select = box->count() - 1;
        }
        // A preselected number the file cannot give stays visible as it is.
        if (current != 0 && select == 0) {
            box->addItem(tr("%1 (not in this file, or of another quantity)").arg(current), current);
            select = box->count() - 1;
        }
        box->setCurrentIndex(select);
        box->setEnabled(h != nullptr);
    }
    m_assign->setEnabled(h != nullptr);
    m_filling = false;
    RefreshStatus();
}

void CZoFileSelectorDlg::RefreshStatus() {
    const CString name = ChosenFileName();
    CString error;
    bool valid = false;
    const auto unassigned = std::find(m_items.begin(), m_items.end(), 0);
    if (RequestCount() > 0 && unassigned != m_items.end() && m_header && m_header->header) {
        const int r = static_cast<int>(unassigned - m_items.begin());
        error = "no item is assigned to \"" + Request(r).Description() + "\"";
    } else {
        valid = IsQrdFileValid(name, m_items, &error);
    }
    QString text = valid ? tr("The file holds what is requested.") : Q(error);
    if (!m_refusal.empty())
        text = tr("Not assigned: %1").arg(Q(m_refusal)) + "\n" + text;
    m_status->setText(text);
    m_status->setStyleSheet(valid && m_refusal.empty() ? "" : "color: #b00000");
    m_ok->setEnabled(valid);
    m_view->setEnabled(m_header && m_header->header);
}

void CZoFileSelectorDlg::keyPressEvent(QKeyEvent* event) {
    if (m_name && m_name->hasFocus() &&
        (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)) {
        event->accept();
        return;
    }
    QDialog::keyPressEvent(event);
}

void CZoFileSelectorDlg::accept() {
    Prepare();
    if (!IsQrdFileValid(ChosenFileName(), m_items, nullptr))
        return;
    SetFileName(ChosenFileName());
    SetSelectedItems(m_items);
    QDialog::accept();
}

ZoFileSelectorHook ZoSetFileSelectorHook(ZoFileSelectorHook hook) {
    ZoFileSelectorHook previous = std::move(Hook());
    Hook() = std::move(hook);
    return previous;
}

int ZoRunFileSelector(CZoFileSelectorDlg& dialog) {
    return Hook() ? Hook()(dialog) : dialog.DoModal();
}

bool ZoSelectDataFile(ZoSEQrdSelection* node, const CString& filter, const CString& defaultExt,
                      QWidget* parent) {
    if (!node)
        return false;
    CZoFileSelectorDlg dialog(node->FileName(), filter, defaultExt, parent);
    dialog.SetBaseFolder(CZoFileSelector(node).BaseFolder());
    node->SetUpFileSelector(dialog);
    dialog.SetSelectedItems(node->ItemNumber());
    if (ZoRunFileSelector(dialog) != QDialog::Accepted)
        return false;
    node->FileName(dialog.FileName());
    node->ItemNumber(dialog.SelectedItems());
    return true;
}
