#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTMorphologyKiv;
class CZoNumberEdit;
class QCheckBox;
class QLabel;

// Whether the bed is updated morphologically, and the speed-up of that update.
class CMTMorphologyDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTMorphologyDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QCheckBox* IncludeBox() const { return m_include; }
    QCheckBox* SpeedupBox() const { return m_speedup; }
    QLabel* FactorLabel() const { return m_factorLabel; }
    CZoNumberEdit* FactorEdit() const { return m_factor; }

private:
    CMTMorphologyKiv* Morphology() const;
    void Store();

    QCheckBox* m_include;
    QCheckBox* m_speedup;
    QLabel* m_factorLabel;
    CZoNumberEdit* m_factor;
};
