// The page of the outputs: the list of outputs with "New output" and "Delete output".
#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTOutputGrid;
class CMTOutputKiv;
class QPushButton;

class CMTOutputDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTOutputDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;
    CMTOutputGrid* Grid() const { return m_grid; }

private:
    CMTOutputKiv* List() const;
    void Refresh();
    void OnNew();
    void OnDelete();

    CMTOutputGrid* m_grid;
    QPushButton* m_new;
    QPushButton* m_delete;
    bool m_renamePending = false;
};
