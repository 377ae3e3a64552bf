#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTSettlingItemKiv;
class CSubFormCollection;
class QGroupBox;

// One fraction's settling value: the constant velocity without flocculation, the
// coefficient with it.
class CMTSettlingItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSettlingItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CSubFormCollection* SubForms() const { return m_subForms; }

private:
    CMTSettlingItemKiv* Item() const;

    QGroupBox* m_frame;
    CSubFormCollection* m_subForms;
};
