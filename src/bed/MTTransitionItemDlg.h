#pragma once

#include "MTBedValueDlg.h"

// The transition between two neighbouring layers.
class CMTTransitionItemDlg : public CMTBedValueDlg {
    Q_OBJECT
public:
    explicit CMTTransitionItemDlg(QWidget* parent = nullptr);

protected:
    CFemInDataKiv* Value() const override;
};
