#pragma once

#include "widgets/ZoSEDlgBase.h"

class CSubFormCollection;
class QComboBox;
class QPushButton;

// What a source brings of one fraction: the type of component and its value.
class CMTSourceItemSubDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSourceItemSubDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QComboBox* TypeBox() const { return m_type; }
    QPushButton* ViewLocationButton() const { return m_viewLocation; }
    CSubFormCollection* SubForms() const { return m_subForms; }

private:
    void OnTypeChosen(int index);
    void OnViewLocation();

    CSubFormCollection* m_subForms;
    QComboBox* m_type;
    QPushButton* m_viewLocation;
};
