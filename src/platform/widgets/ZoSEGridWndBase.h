// Grids over item lists: one row per item, row operations (insert, delete, move up, move
// down) from the selection, the toolbar or the Ctrl keys, and "Go to..." links to the items.
//
// A section grid derives from CFemGridWnd<T> (overview grids: the keys stay with the plain
// grid) or CFemGridEditWnd<T> (cells edited in place, keyboard row operations), gives its
// column headings and answers GetItemStyle / StoreItem:
//
//   class CMyGrid : public CFemGridWnd<CMyItemKiv> {
//   public:
//       void Initialize(CZoSEDlgBase* dialog, CMyListKiv* list) {
//           CFemGridWnd::Initialize(dialog, list);
//           SetColumnHeadings({"Fraction", "Include", "Velocity"});
//       }
//   protected:
//       void GetItemStyle(CMyItemKiv* item, int row, int col, CGridCellStyle& s) override;
//       int StoreItem(CMyItemKiv* item, int row, int col, const CGridCellValue& v) override;
//   };
#pragma once

#include "ZoGridWnd.h"
#include "setupeditor/ZoSEKivListBase.h"

#include <vector>

// What the toolbar drives.
class CZoSEGridWndBaseInterface : public CZoGridWnd {
public:
    using CZoGridWnd::CZoGridWnd;
    virtual void InsertItems() = 0;
    virtual void DeleteItems() = 0;
    virtual void MoveItemsUp() = 0;
    virtual void MoveItemsDown() = 0;
};

// The machinery of every list grid, on the list's untyped interface. Row r shows item r.
class CZoSEGridWndCore : public CZoSEGridWndBaseInterface {
public:
    explicit CZoSEGridWndCore(QWidget* parent = nullptr);

    // Binds the grid to its dialog (hints, fitting) and list; the rows follow the list.
    void Initialize(CZoSEDlgBase* dialog, CZoSEKivListBaseInterface* list);
    CZoSEKivListBaseInterface* ListInterface() const { return m_list; }

    // Headings of columns 0 (the row headings' column, shown in the corner) to n; sets the
    // number of columns to n.
    void SetColumnHeadings(const std::vector<CString>& headings);

    // Row operations on the whole rows selected by their headings; each ends with its hint.
    void InsertItems() override;
    void DeleteItems() override;
    void MoveItemsUp() override;
    void MoveItemsDown() override;

    // Ctrl+Delete / Insert / Up / Down on the current row, when the key is released.
    void SetKeyboardRowOperations(bool on) { m_keyboardRowOperations = on; }
    bool KeyboardRowOperations() const { return m_keyboardRowOperations; }

    // Headings and item titles here; item cells from GetItemCellStyle.
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    int StoreStyleRowCol(int row, int col, const CGridCellValue& value) override;
    // "Go to...": selects the row's item in the editor's tree.
    void OnClickedButtonRowCol(int row, int col) override;

    // The item node a row shows.
    virtual CZoSEKivBase* ItemNodeOfRow(int row) const;

protected:
    int RowCountFromData() const override;
    virtual void GetItemCellStyle(int row, int col, CGridCellStyle& style);
    virtual int StoreItemCell(int row, int col, const CGridCellValue& value);
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;

private:
    void KeyRowOperation(int key);

    CZoSEKivListBaseInterface* m_list = nullptr;
    std::vector<CString> m_headings;
    bool m_keyboardRowOperations = true;
    int m_pendingKey = 0;
};

template <class T>
class CZoSEGridWndBase : public CZoSEGridWndCore {
public:
    using CZoSEGridWndCore::CZoSEGridWndCore;

    void Initialize(CZoSEDlgBase* dialog, CZoSEKivAbstractListBase<T>* list) {
        m_typedList = list;
        CZoSEGridWndCore::Initialize(dialog, list);
    }
    CZoSEKivAbstractListBase<T>* GetList() const { return m_typedList; }
    T* GetItem(int row) const { return dynamic_cast<T*>(ItemNodeOfRow(row)); }

protected:
    // A section grid's cells; the item is never null.
    virtual void GetItemStyle(T* item, int row, int col, CGridCellStyle& style) = 0;
    // Returns the update hint, 0 when nothing was stored.
    virtual int StoreItem(T*, int, int, const CGridCellValue&) { return 0; }

private:
    void GetItemCellStyle(int row, int col, CGridCellStyle& style) final {
        if (T* item = GetItem(row))
            GetItemStyle(item, row, col, style);
    }
    int StoreItemCell(int row, int col, const CGridCellValue& value) final {
        T* item = GetItem(row);
        return item ? StoreItem(item, row, col, value) : 0;
    }

    CZoSEKivAbstractListBase<T>* m_typedList = nullptr;
};

// Overview grids: items shown and linked; keys go to the plain grid.
template <class T>
class CFemGridWnd : public CZoSEGridWndBase<T> {
public:
    explicit CFemGridWnd(QWidget* parent = nullptr) : CZoSEGridWndBase<T>(parent) {
        this->SetKeyboardRowOperations(false);
    }
};

// Grids edited in place, with keyboard row operations.
template <class T>
class CFemGridEditWnd : public CZoSEGridWndBase<T> {
public:
    explicit CFemGridEditWnd(QWidget* parent = nullptr) : CZoSEGridWndBase<T>(parent) {
        this->SetKeyboardRowOperations(true);
    }
};
