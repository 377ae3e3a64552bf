#pragma once

#include "widgets/ZoEditStyle.h"
#include "widgets/ZoSEDlgBase.h"

class CMTSourceGrid;

// The sources of the flow model, each linked to the sediment it brings in.
class CSourceDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CSourceDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTSourceGrid* Grid() const { return m_grid; }

private:
    CMTSourceGrid* m_grid;
    CZoEditStyle m_style;
};
