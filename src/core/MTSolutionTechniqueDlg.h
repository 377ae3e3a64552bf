#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTSolutionTechniqueKiv;
class QComboBox;

// The time-integration and space-discretization schemes; the vertical scheme follows the
// horizontal one whenever the dialog shows or stores them.
class CMTSolutionTechniqueDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSolutionTechniqueDlg(QWidget* parent = nullptr);
    void SetData() override;

    QComboBox* TimeIntegrationBox() const { return m_time; }
    QComboBox* SpaceDiscretizationBox() const { return m_space; }

private:
    CMTSolutionTechniqueKiv* Technique() const;
    void Store();

    QComboBox* m_time;
    QComboBox* m_space;
};
