#pragma once

#include "MTWaterColumnDlgSupport.h"
#include "widgets/ZoSEDlgBase.h"

class CMTDensityFeedbackKiv;
class QCheckBox;

// Whether the suspended mud feeds back on the flow's density, with the sediment density and
// the coefficients of the viscosity formula.
class CMTDensityFeedbackDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDensityFeedbackDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

private:
    CMTDensityFeedbackKiv* Feedback() const;

    QCheckBox* m_include;
    mtdlg::NumberRow m_density;
    mtdlg::NumberRow m_base;
    mtdlg::NumberRow m_concentration;
};
