#pragma once

#include "common/Platform.h"

#include <QPointer>
#include <QWidget>

#include <array>

class CMTWaveFieldKiv;
class CZoNumberEdit;
class CZoSEDlgBase;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

// The wave field, a sub-form of the waves dialog: three constants, or a data file with the
// items for height, period and direction; the soft start.
class CMTWaveFieldDlg : public QWidget {
    Q_OBJECT
public:
    // owner receives the update hints.
    CMTWaveFieldDlg(CMTWaveFieldKiv* field, CZoSEDlgBase* owner, QWidget* parent = nullptr);

    CMTWaveFieldKiv* Field() const { return m_field; }
    // Fills the controls from the node and applies the enabling rules.
    void SetData();

    // The selector's default extension and filter for a list index and file name.
    struct FileChoice {
        CString defaultExt;
        CString filter;
    };
    static FileChoice FileChoiceFor(int listIndex, const CString& fileName);
    // List index 0, 1, 2 stands for format 0, 1, 3; a stored 2 shows as index 2.
    static int ListIndexOf(int format);

    QComboBox* FormatBox() const { return m_format; }
    CZoNumberEdit* HeightEdit() const { return m_height; }
    CZoNumberEdit* PeriodEdit() const { return m_period; }
    CZoNumberEdit* DirectionEdit() const { return m_direction; }
    QLineEdit* FileNameEdit() const { return m_fileName; }
    QLineEdit* ItemEdit(int index) const;  // 1 to 3
    QPushButton* SelectButton() const { return m_select; }
    QPushButton* ViewButton() const { return m_view; }
    CZoNumberEdit* SoftStartEdit() const { return m_softStart; }

private:
    void Changed();
    void OnFormatChosen(int index);
    void OnFileNameEdited();
    void OnSelect();
    void OnView();
    void RefreshControls();

    CMTWaveFieldKiv* m_field;
    QPointer<CZoSEDlgBase> m_owner;
    QComboBox* m_format;
    QLabel* m_heightLabel;
    CZoNumberEdit* m_height;
    QLabel* m_heightUnit;
    QLabel* m_periodLabel;
    CZoNumberEdit* m_period;
    QLabel* m_periodUnit;
    QLabel* m_directionLabel;
    CZoNumberEdit* m_direction;
    QLabel* m_directionUnit;
    QLabel* m_fileLabel;
    QLineEdit* m_fileName;
    std::array<QLineEdit*, 3> m_items{};
    QPushButton* m_select;
    QPushButton* m_view;
    QLabel* m_softStartLabel;
    CZoNumberEdit* m_softStart;
    QLabel* m_softStartUnit;
};
