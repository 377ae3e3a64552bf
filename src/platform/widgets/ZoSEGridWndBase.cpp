#include "ZoSEGridWndBase.h"

#include "ZoSEDlgBase.h"

#include <QKeyEvent>
#include <QPointer>

namespace {
bool IsRowKey(int key) {
    return key == Qt::Key_Delete || key == Qt::Key_Insert || key == Qt::Key_Up ||
           key == Qt::Key_Down;
}
}  // namespace

CZoSEGridWndCore::CZoSEGridWndCore(QWidget* parent) : CZoSEGridWndBaseInterface(parent) {}

void CZoSEGridWndCore::Initialize(CZoSEDlgBase* dialog, CZoSEKivListBaseInterface* list) {
    SetDialog(dialog);
    m_list = list;
    Redraw();
}

void CZoSEGridWndCore::SetColumnHeadings(const std::vector<CString>& headings) {
    m_headings = headings;
    SetColCount(headings.empty() ? 0 : static_cast<int>(headings.size()) - 1);
}

int CZoSEGridWndCore::RowCountFromData() const { return m_list ? m_list->GetItemCount() : 0; }

CZoSEKivBase* CZoSEGridWndCore::ItemNodeOfRow(int row) const {
    return m_list ? m_list->GetItemNode(row) : nullptr;
}

void CZoSEGridWndCore::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row == 0) {
        if (col >= 0 && col < static_cast<int>(m_headings.size()))
            style.SetStatic(m_headings[col]);
        return;
    }
    if (col == 0) {
        if (CZoSEKivBase* item = ItemNodeOfRow(row))
            style.SetStatic(item->GetTitle());
        return;
    }
    GetItemCellStyle(row, col, style);
}

int CZoSEGridWndCore::StoreStyleRowCol(int row, int col, const CGridCellValue& value) {
    if (row < 1 || col < 1)
        return 0;
    return StoreItemCell(row, col, value);
}

void CZoSEGridWndCore::GetItemCellStyle(int, int, CGridCellStyle&) {}

int CZoSEGridWndCore::StoreItemCell(int, int, const CGridCellValue&) { return 0; }

void CZoSEGridWndCore::OnClickedButtonRowCol(int row, int) {
    if (Dialog())
        Dialog()->SelectTreeItem(ItemNodeOfRow(row));
}

void CZoSEGridWndCore::InsertItems() {
    if (!m_list || GetColCount() == 0)
        return;
    const std::vector<RowRange> ranges = GetSelectedRowRanges();
    int top = 0;
    if (!ranges.empty()) {
        // All at the selection's top, so that the new items stand where it began.
        top = ranges.front().top;
        for (int row = ranges.front().top; row <= ranges.front().bottom; ++row)
            m_list->Insert(top, 1);
    } else {
        m_list->SetItemCount(m_list->GetItemCount() + 1, 1);
    }
    Redraw();
    QPointer<CZoSEGridWndCore> self(this);
    UpdateDoc(kHintItemsAdded);
    if (self && top == 1)
        UpdateDoc(kHintItemsReordered);
}

void CZoSEGridWndCore::DeleteItems() {
    if (!m_list)
        return;
    const std::vector<RowRange> ranges = GetSelectedRowRanges();
    if (ranges.size() == 1) {
        // Always at the top: the rows below move up as each item goes.
        for (int row = ranges.front().top; row <= ranges.front().bottom; ++row)
            m_list->Delete(ranges.front().top, 1);
        ClearSelection();
    }
    Redraw();
    UpdateDoc(kHintItemsDeleted);
}

void CZoSEGridWndCore::MoveItemsUp() {
    if (!m_list)
        return;
    const std::vector<RowRange> ranges = GetSelectedRowRanges();
    if (!ranges.empty() && ranges.front().top > 1) {
        const RowRange r = ranges.front();
        for (int row = r.top; row <= r.bottom; ++row)
            m_list->MoveUp(row, 1);
        Redraw();
        ClearSelection();
        SetCurrentCell(r.top - 1, 1);
        SelectRows(r.top - 1, r.bottom - 1);
    }
    UpdateDoc(kHintItemsReordered);
}

void CZoSEGridWndCore::MoveItemsDown() {
    if (!m_list)
        return;
    const std::vector<RowRange> ranges = GetSelectedRowRanges();
    if (!ranges.empty() && ranges.front().bottom < m_list->GetItemCount()) {
        const RowRange r = ranges.front();
        for (int row = r.bottom; row >= r.top; --row)
            m_list->MoveDown(row, 1);
        Redraw();
        ClearSelection();
        SetCurrentCell(r.top + 1, 1);
        SelectRows(r.top + 1, r.bottom + 1);
    }
    UpdateDoc(kHintItemsReordered);
}

void CZoSEGridWndCore::keyPressEvent(QKeyEvent* event) {
    if (m_keyboardRowOperations && (event->modifiers() & Qt::ControlModifier) &&
        IsRowKey(event->key())) {
        // Acted on when the key is released.
        m_pendingKey = event->key();
        event->accept();
        return;
    }
    CZoSEGridWndBaseInterface::keyPressEvent(event);
}

void CZoSEGridWndCore::keyReleaseEvent(QKeyEvent* event) {
    if (m_keyboardRowOperations && (event->modifiers() & Qt::ControlModifier) &&
        IsRowKey(event->key())) {
        event->accept();
        if (!event->isAutoRepeat() && event->key() == m_pendingKey) {
            m_pendingKey = 0;
            KeyRowOperation(event->key());
        }
        return;
    }
    CZoSEGridWndBaseInterface::keyReleaseEvent(event);
}

void CZoSEGridWndCore::KeyRowOperation(int key) {
    int row = 0;
    int col = 0;
    if (!m_list || !GetCurrentCell(row, col))
        return;
    switch (key) {
    case Qt::Key_Delete:
        m_list->Delete(row, 1);
        Redraw();
        UpdateDoc(kHintItemsDeleted);
        break;
    case Qt::Key_Insert:
        m_list->Insert(row, 1);
        Redraw();
        UpdateDoc(kHintItemsAdded);
        break;
    case Qt::Key_Up:
        if (m_list->MoveUp(row, 1)) {
            Redraw();
            SetCurrentCell(row - 1, col);
            UpdateDoc(kHintItemsReordered);
        }
        break;
    case Qt::Key_Down:
        if (m_list->MoveDown(row, 1)) {
            Redraw();
            SetCurrentCell(row + 1, col);
            UpdateDoc(kHintItemsReordered);
        }
        break;
    default:
        break;
    }
}
