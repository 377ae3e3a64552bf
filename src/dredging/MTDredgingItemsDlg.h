#pragma once

#include "widgets/ZoSEDlgBase.h"

#include <array>

class CMTDredgingFractionGrid;
class CMTDredgingItemsKiv;
class CMTDredgingMapDlg;
class CZoNumberEdit;
class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QVBoxLayout;

// One dredger: where its spill is released, its load, the split over the fractions, the
// projection of its track and the time series that gives track, rate and spill.
class CMTDredgingItemsDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    static constexpr const char* kSelectorFilter =
        "timeseries (*.qrd0) |*.qrd0|All files (*.*) |*.*||";

    explicit CMTDredgingItemsDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QComboBox* SpillBox() const { return m_spill; }
    QLabel* SpillLabel() const { return m_spillLabel; }
    QCheckBox* UpdateDredgerBox() const { return m_updateDredger; }
    CZoNumberEdit* InitialMassEdit() const { return m_initialMass; }
    CZoNumberEdit* MaximumMassEdit() const { return m_maximumMass; }
    CMTDredgingFractionGrid* FractionGrid() const { return m_fractions; }
    QComboBox* ProjectionBox() const { return m_projection; }
    QLineEdit* FileNameEdit() const { return m_fileName; }
    QLineEdit* ItemEdit(int index) const { return m_items[static_cast<std::size_t>(index)]; }
    QPushButton* SelectButton() const { return m_select; }
    QPushButton* ViewButton() const { return m_view; }
    CMTDredgingMapDlg* MapPage() const { return m_map; }

    void OnSelect();
    void OnView();

private:
    CMTDredgingItemsKiv* Dredger() const;
    void StoreProjection();
    void ShowItems();

    QLabel* m_spillLabel;
    QComboBox* m_spill;
    QCheckBox* m_updateDredger;
    CZoNumberEdit* m_initialMass;
    CZoNumberEdit* m_maximumMass;
    QLabel* m_initialUnit;
    QLabel* m_maximumUnit;
    CMTDredgingFractionGrid* m_fractions;
    QComboBox* m_projection;
    QLineEdit* m_fileName;
    std::array<QLineEdit*, 4> m_items;
    QPushButton* m_select;
    QPushButton* m_view;
    CMTDredgingMapDlg* m_map = nullptr;
    QVBoxLayout* m_layout;
};
