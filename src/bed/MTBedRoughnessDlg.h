#pragma once

#include "MTBedValueDlg.h"

// The roughness of the bed.
class CMTBedRoughnessDlg : public CMTBedValueDlg {
    Q_OBJECT
public:
    explicit CMTBedRoughnessDlg(QWidget* parent = nullptr);

protected:
    CFemInDataKiv* Value() const override;
};
