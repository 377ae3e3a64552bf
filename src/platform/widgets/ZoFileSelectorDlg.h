// The file selector: the data file's name (typed or browsed), the items the file holds with
// their quantities and units, and the item requests of the caller, to which the user
// assigns items. An item whose unit type a request does not accept cannot be assigned. OK is
// offered only while the file will do (CZoFileSelector::IsQrdFileValid); afterwards
// FileName() and SelectedItems() hold the choice, and nothing changes on Cancel.
#pragma once

#include "datafile/ZoFileSelector.h"

#include <QDialog>

#include <functional>
#include <memory>
#include <vector>

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QTableWidget;
class QTreeWidget;
class QTreeWidgetItem;
class ZoSEQrdSelection;
class CZoSEDlgBase;

class CZoFileSelectorDlg : public QDialog, public CZoFileSelector {
    Q_OBJECT
public:
    // filter in the "Text|*.a;*.b|...||" form; defaultExt without the dot.
    CZoFileSelectorDlg(const CString& fileName, const CString& filter, const CString& defaultExt,
                       QWidget* parent = nullptr);
    ~CZoFileSelectorDlg() override;

    // Builds the controls from the requests and the preselected items; DoModal calls it,
    // tests may call it to drive the dialog without a modal loop.
    void Prepare();
    // Prepare, then the modal loop: QDialog::Accepted or QDialog::Rejected.
    int DoModal();

    // The choice being made (FileName() and SelectedItems() change only on OK).
    CString ChosenFileName() const;
    const std::vector<int>& ChosenItems() const { return m_items; }
    // Assigns item itemNumber (0: none) to a request (0-based); false, with the reason in
    // the status line, when the item's unit type does not fit.
    bool AssignItem(int request, int itemNumber);
    // Without requests the user ticks items; this sets the ticked ones.
    void CheckItems(const std::vector<int>& itemNumbers);
    // Chooses another file as if typed.
    void ChooseFile(const CString& name);

    QLineEdit* FileNameEdit() const { return m_name; }
    QTreeWidget* ItemList() const { return m_itemList; }
    QTableWidget* RequestTable() const { return m_requestTable; }
    QPushButton* OkButton() const { return m_ok; }
    QPushButton* ViewButton() const { return m_view; }
    QLabel* StatusLabel() const { return m_status; }
    QLabel* SummaryLabel() const { return m_summary; }

    void accept() override;

protected:
    // Return in the file-name field takes the name; it does not close the dialog.
    void keyPressEvent(QKeyEvent* event) override;

private:
    void OnBrowse();
    void OnAssign();
    void OnItemChanged(QTreeWidgetItem* item);
    void OnView();
    void Refresh();
    void RefreshStatus();

    bool m_prepared = false;
    bool m_filling = false;
    std::vector<int> m_items;
    std::shared_ptr<const datafile::HeaderResult> m_header;
    QLineEdit* m_name = nullptr;
    QPushButton* m_browse = nullptr;
    QLabel* m_summary = nullptr;
    QTreeWidget* m_itemList = nullptr;
    QTableWidget* m_requestTable = nullptr;
    QPushButton* m_assign = nullptr;
    QLabel* m_status = nullptr;
    QPushButton* m_ok = nullptr;
    QPushButton* m_view = nullptr;
    CString m_refusal;
    CString m_shownName;  // the name whose header the controls show
};

// The same selector under the name the sections' "Select ..." buttons use.
class CZoCustomFileSelectorDlg : public CZoFileSelectorDlg {
    Q_OBJECT
public:
    using CZoFileSelectorDlg::CZoFileSelectorDlg;
};

// The usual "Select ..." of a data-file selection node: a selector set up by the node
// (requests, base folder), with its file and items preselected; on OK the node takes the
// file name and item numbers. True when the user chose OK.
bool ZoSelectDataFile(ZoSEQrdSelection* node, const CString& filter, const CString& defaultExt,
                      QWidget* parent);

// Shows a prepared selector modally (or hands it to the hook below): QDialog::Accepted or
// QDialog::Rejected.
int ZoRunFileSelector(CZoFileSelectorDlg& dialog);

// Selector dialogs shown by ZoSelectDataFile and ZoRunFileSelector go through this hook while it is set, so that
// tests drive them without a modal loop: it returns what DoModal would.
using ZoFileSelectorHook = std::function<int(CZoFileSelectorDlg& dialog)>;
ZoFileSelectorHook ZoSetFileSelectorHook(ZoFileSelectorHook hook);
