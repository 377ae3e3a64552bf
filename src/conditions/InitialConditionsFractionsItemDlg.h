#pragma once

#include "widgets/ZoSEDlgBase.h"

class CSubFormCollection;

// The initial concentration of one fraction: a constant or a data file.
class CInitialConditionsFractionsItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CInitialConditionsFractionsItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CSubFormCollection* SubForms() const { return m_subForms; }

private:
    CSubFormCollection* m_subForms;
};
