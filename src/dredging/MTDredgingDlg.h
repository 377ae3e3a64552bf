#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTDredgingGrid;
class CMTDredgingKiv;
class CMTDredgingMapDlg;
class CZoSEGridToolbar;
class QCheckBox;
class QPushButton;
class QVBoxLayout;

// The dredgers of the setup in a grid, and whether dredging updates the bed.
class CMTDredgingDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDredgingDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTDredgingGrid* Grid() const { return m_grid; }
    CZoSEGridToolbar* Toolbar() const { return m_toolbar; }
    QPushButton* NewButton() const { return m_new; }
    QPushButton* DeleteButton() const { return m_delete; }
    QCheckBox* UpdateBedBox() const { return m_updateBed; }
    CMTDredgingMapDlg* MapPage() const { return m_map; }

    void OnNewDredger();
    void OnDeleteDredger();

private:
    CMTDredgingKiv* List() const;

    CMTDredgingGrid* m_grid;
    CZoSEGridToolbar* m_toolbar;
    QPushButton* m_new;
    QPushButton* m_delete;
    QCheckBox* m_updateBed;
    CMTDredgingMapDlg* m_map = nullptr;
    QVBoxLayout* m_layout;
};
