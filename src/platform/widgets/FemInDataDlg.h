// The sub-form of a data-input value: its format, the constant (in the user's unit of the
// value's item type) or the data file with its item numbers and item name. Every change is
// stored at once and reported to the owning dialog with UpdateDoc(1).
#pragma once

#include "ZoEditStyle.h"
#include "ZoSEDlgBase.h"

#include <QPointer>
#include <QStackedWidget>
#include <QWidget>

class CFemInDataKiv;
class CZoNumberEdit;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QToolButton;

class CFemInDataDlg : public QWidget {
    Q_OBJECT
public:
    CFemInDataDlg(CFemInDataKiv* data, CZoSEDlgBase* owner, QWidget* parent = nullptr);

    CFemInDataKiv* Data() const { return m_data; }
    // Range and format of the constant (the unit group is the value's item type).
    void SetConstantStyle(const CZoEditStyle& style);
    // Fills the controls from the value and applies the enabling rules.
    void SetData();
    // Switches the whole sub-form on or off (a value not in use is always off).
    void EnableControls(bool enable);

    QComboBox* FormatBox() const { return m_format; }
    CZoNumberEdit* ConstantEdit() const { return m_constant; }
    QLineEdit* FileNameEdit() const { return m_fileName; }
    QToolButton* BrowseButton() const { return m_browse; }
    QLineEdit* ItemNumbersEdit() const { return m_items; }
    QLineEdit* ItemNameEdit() const { return m_itemName; }
    QPushButton* SelectButton() const { return m_select; }
    QPushButton* ViewButton() const { return m_view; }

private:
    void Changed();
    void OnFormatChosen(int index);
    void OnFileNameEdited();
    void OnBrowse();
    void OnItemNumbersEdited();
    void OnItemNameEdited();
    void OnSelect();
    void OnView();

    CFemInDataKiv* m_data;
    QPointer<CZoSEDlgBase> m_owner;
    bool m_enabled = true;
    QComboBox* m_format;
    CZoNumberEdit* m_constant;
    QLabel* m_unit;
    QLineEdit* m_fileName;
    QToolButton* m_browse;
    QLineEdit* m_items;
    QLineEdit* m_itemName;
    QPushButton* m_select;
    QPushButton* m_view;
};

// The sub-forms of a dialog's data-input values, shown one at a time in the dialog's frame.
class CSubFormCollection : public QStackedWidget {
    Q_OBJECT
public:
    explicit CSubFormCollection(QWidget* parent = nullptr);

    // Takes the sub-form; returns its index.
    int CreateSubForm(CFemInDataDlg* subForm);
    // One sub-form per data-input value among the children of the dialog's node, in order.
    void CreateSubForms(CZoSEDlgBase* dialog);
    void ShowSubForm(int index);
    int ShownSubForm() const { return currentIndex(); }
    int Count() const { return count(); }
    CFemInDataDlg* SubForm(int index) const;
    void SetData();
    void EnableControls(bool enable);
};

// "1, 3, 5" <-> {1, 3, 5}; false when a part is not an integer of 1 or more.
QString ZoItemNumbersText(const std::vector<int>& items);
bool ZoParseItemNumbers(const QString& text, std::vector<int>& items);
