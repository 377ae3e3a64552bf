// Small pieces shared by the water-column dialogs.
#pragma once

#include "widgets/ZoEditStyle.h"
#include "widgets/ZoGridWnd.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEDlgBase.h"

#include <QGridLayout>
#include <QLabel>
#include <QRadioButton>
#include <QSignalBlocker>

#include <initializer_list>

namespace mtdlg {

// Shows which of a set of exclusive choices is selected; null selects none, so that a stored
// value no choice stands for is not shown as one it is not.
inline void ShowChoice(std::initializer_list<QRadioButton*> choices, const QRadioButton* selected) {
    for (QRadioButton* choice : choices) {
        const QSignalBlocker block(choice);
        // An exclusive button cannot be unchecked while it is the checked one.
        choice->setAutoExclusive(false);
        choice->setChecked(choice == selected);
        choice->setAutoExclusive(true);
    }
}

// Binds a number field to a double of the dialog's node through its accessor pair.
template <class Node>
void BindDouble(CZoSEDlgBase* dialog, CZoNumberEdit* edit, double (Node::*get)() const,
                void (Node::*set)(double)) {
    edit->BindDouble(
        dialog,
        [dialog, get] {
            const Node* node = dialog->Section<Node>();
            return node ? (node->*get)() : 0.0;
        },
        [dialog, set](double value) {
            if (Node* node = dialog->Section<Node>())
                (node->*set)(value);
        });
}

// Draws a grid again from its list; rows that came or went since it was last drawn (the
// number of fractions changed, a fraction became sand) resize it in the dialog.
inline void RefreshGrid(CZoGridWnd* grid) {
    const int before = grid->GetRowCount();
    grid->Redraw();
    if (grid->GetRowCount() != before) {
        grid->FitColumns();
        grid->SizeToDialog();
    }
}

// A label, a number field and the user's unit of the field's quantity, on one row.
class NumberRow {
public:
    NumberRow() = default;
    NumberRow(QGridLayout* grid, int row, const QString& text, const CZoEditStyle& style,
              const char* name, QWidget* parent)
        : m_label(new QLabel(text, parent)), m_edit(new CZoNumberEdit(style, parent)),
          m_unit(new QLabel(parent)) {
        m_edit->setObjectName(name);
        m_label->setBuddy(m_edit);
        grid->addWidget(m_label, row, 0);
        grid->addWidget(m_edit, row, 1);
        grid->addWidget(m_unit, row, 2);
        ShowUnit();
    }

    QLabel* Label() const { return m_label; }
    CZoNumberEdit* Edit() const { return m_edit; }

    // The user may have chosen another unit since the row was built.
    void ShowUnit() {
        const CString unit = m_edit->Style().UnitName();
        m_unit->setText(unit == "()" ? QString() : QString::fromStdString(unit));
        m_edit->setToolTip(QString::fromStdString(m_edit->Style().ToolTip()));
    }
    void SetEnabled(bool on) {
        m_label->setEnabled(on);
        m_edit->setEnabled(on);
        m_unit->setEnabled(on);
    }

private:
    QLabel* m_label = nullptr;
    CZoNumberEdit* m_edit = nullptr;
    QLabel* m_unit = nullptr;
};

} // namespace mtdlg
