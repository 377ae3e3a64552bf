#include "MudTransportModuleDlg.h"

IMPLEMENT_DYNCREATE_DLG(CMudTransportModuleDlg)

CMudTransportModuleDlg::CMudTransportModuleDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5001);
}
