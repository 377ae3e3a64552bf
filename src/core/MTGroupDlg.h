#pragma once

#include "widgets/ZoSEDlgBase.h"

// The page of a group (water column, bed, forcings): no controls; the group's help topic.
class CMTGroupDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTGroupDlg(QWidget* parent = nullptr);
    void Initialize() override;
};
