#pragma once

#include "widgets/ZoSEDlgBase.h"

class CParameterSelectionKiv;
class CZoNumberEdit;
class CZoSpinButton;
class QGroupBox;

// The numbers of fractions and layers. Each change is stored at once: the lists follow, and
// the document hears whether items were added (2), deleted (4) or nothing changed (1).
class CParameterSelectionDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CParameterSelectionDlg(QWidget* parent = nullptr);
    void Initialize() override;

    CZoNumberEdit* FractionsEdit() const { return m_fractions; }
    CZoNumberEdit* LayersEdit() const { return m_layers; }
    CZoSpinButton* FractionsSpin() const { return m_fractionsSpin; }
    CZoSpinButton* LayersSpin() const { return m_layersSpin; }

private:
    CParameterSelectionKiv* Model() const;
    void Stored(int before, int after);

    QGroupBox* m_frame;
    CZoNumberEdit* m_fractions;
    CZoNumberEdit* m_layers;
    CZoSpinButton* m_fractionsSpin;
    CZoSpinButton* m_layersSpin;
};
