#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTDispersionGrid;
class CMTDispersionListKiv;

// The formulations of every fraction in one direction.
class CMTDispersionListDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDispersionListDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTDispersionGrid* Grid() const { return m_grid; }

private:
    CMTDispersionGrid* m_grid;
};
