#pragma once

#include "widgets/ZoSEDlgBase.h"

class CSubFormCollection;

// The initial thickness of one bed layer: a constant or a data file.
class CInitialConditionsLayersItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CInitialConditionsLayersItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CSubFormCollection* SubForms() const { return m_subForms; }

private:
    CSubFormCollection* m_subForms;
};
