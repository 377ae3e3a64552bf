#pragma once

#include "widgets/ZoSEDlgBase.h"

class CSubFormCollection;

// One fraction's critical shear stress for deposition.
class CMTDepositionItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDepositionItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CSubFormCollection* SubForms() const { return m_subForms; }

private:
    CSubFormCollection* m_subForms;
};
