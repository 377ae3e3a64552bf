// The quantities of a discharge output: the SSC of each fraction (the discharges themselves
// are always written) and the kind of discharge.
#pragma once

#include "widgets/ZoSEDlgBase.h"

class QComboBox;
class QListWidget;

class CMTOutputDischargeDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTOutputDischargeDlg(QWidget* parent = nullptr);
    void SetData() override;

    QListWidget* List() const { return m_list; }
    QComboBox* TypeBox() const { return m_type; }

private:
    void OnChecked();
    void OnType(int index);

    QListWidget* m_list;
    QComboBox* m_type;
};
