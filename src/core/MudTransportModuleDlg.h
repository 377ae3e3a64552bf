#pragma once

#include "widgets/ZoSEDlgBase.h"

// The root's page: no controls of its own.
class CMudTransportModuleDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMudTransportModuleDlg(QWidget* parent = nullptr);
};
