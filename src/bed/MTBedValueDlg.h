// Dialogs of a bed node that holds a single data-input value (a layer's density, a
// transition, the bed roughness): the value's sub-form in a frame.
#pragma once

#include "widgets/ZoSEDlgBase.h"

class CFemInDataKiv;
class CSubFormCollection;

class CMTBedValueDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    void Initialize() override;
    void SetData() override;

    CSubFormCollection* SubForms() const { return m_forms; }

protected:
    CMTBedValueDlg(unsigned long helpId, QWidget* parent);
    // The value of the dialog's node; null when the node is of another kind.
    virtual CFemInDataKiv* Value() const = 0;

private:
    CSubFormCollection* m_forms;
};
