// The pages of one output: its map, its "Output specification" and the quantities of its kind.
#pragma once

#include "widgets/FemPropertySheetDlg.h"

class CMTOutputItemPropertySheet : public CFemPropertySheetDlg {
    Q_OBJECT
public:
    explicit CMTOutputItemPropertySheet(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    // The page open in every output's sheet (0 map, 1 "Output specification", 2 quantities).
    static int& ActivePage();

private:
    bool m_building = false;
    CZoSEKivBase* m_itemsNode = nullptr;
};
