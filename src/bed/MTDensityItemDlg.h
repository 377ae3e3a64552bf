#pragma once

#include "MTBedValueDlg.h"

// The density of one bed layer.
class CMTDensityItemDlg : public CMTBedValueDlg {
    Q_OBJECT
public:
    explicit CMTDensityItemDlg(QWidget* parent = nullptr);

protected:
    CFemInDataKiv* Value() const override;
};
