// The quantities of a 2D or 3D output: the basic and the additional variables that the
// domain's dimension and the output's type offer, each with its check box.
#pragma once

#include "widgets/ZoSEDlgBase.h"

#include <vector>

class CMTOutputItemSubKiv;
class QListWidget;
class QListWidgetItem;

class CMTOutputItemSubDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTOutputItemSubDlg(QWidget* parent = nullptr);
    void SetData() override;

    QListWidget* BasicList() const { return m_basic; }
    QListWidget* AdditionalList() const { return m_additional; }

private:
    void Fill(QListWidget* list, int which);
    void OnChanged();

    QListWidget* m_basic;
    QListWidget* m_additional;
};
