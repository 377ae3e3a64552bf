#include "MTGroupDlg.h"

IMPLEMENT_DYNCREATE_DLG(CMTGroupDlg)

CMTGroupDlg::CMTGroupDlg(QWidget* parent) : CZoSEDlgBase(parent) {}

void CMTGroupDlg::Initialize() {
    if (const auto* help = dynamic_cast<const CFemHelpBase*>(GetSection()))
        HelpID(help->GetHelpID());
    CZoSEDlgBase::Initialize();
}
