// The form of one boundary value: its boundary type and, for specified values, a constant or
// a data file, the soft start and the interpolation. Every change is stored at once.
#pragma once

#include "ZoSEDlgBase.h"

class CBoundaryConditionsComponentItemKiv;
class CZoNumberEdit;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QToolButton;

class CBoundaryConditionsComponentItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CBoundaryConditionsComponentItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QComboBox* TypeBox() const { return m_type; }
    QComboBox* FormatBox() const { return m_format; }
    CZoNumberEdit* ConstantEdit() const { return m_constant; }
    QLineEdit* FileNameEdit() const { return m_fileName; }
    QToolButton* BrowseButton() const { return m_browse; }
    QLineEdit* ItemNumbersEdit() const { return m_items; }
    QPushButton* SelectButton() const { return m_select; }
    QPushButton* ViewButton() const { return m_view; }
    CZoNumberEdit* SoftTimeEdit() const { return m_softTime; }
    CZoNumberEdit* SoftReferenceEdit() const { return m_refSoft; }
    QComboBox* SoftTypeBox() const { return m_typeSoft; }
    QComboBox* TimeInterpolationBox() const { return m_typeTI; }
    QComboBox* SpaceInterpolationBox() const { return m_typeSI; }

private:
    CBoundaryConditionsComponentItemKiv* BoundaryItem() const;
    void Changed();
    void OnFileNameEdited();
    void OnBrowse();
    void OnItemNumbersEdited();
    void OnSelect();
    void OnView();

    QComboBox* m_type;
    QComboBox* m_format;
    CZoNumberEdit* m_constant;
    QLabel* m_constantUnit;
    QLineEdit* m_fileName;
    QToolButton* m_browse;
    QLineEdit* m_items;
    QPushButton* m_select;
    QPushButton* m_view;
    CZoNumberEdit* m_softTime;
    QLabel* m_softTimeUnit;
    CZoNumberEdit* m_refSoft;
    QLabel* m_refSoftUnit;
    QComboBox* m_typeSoft;
    QComboBox* m_typeTI;
    QComboBox* m_typeSI;
    std::vector<QWidget*> m_specifiedOnly;
};
