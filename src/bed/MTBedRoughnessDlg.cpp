#include "MTBedRoughnessDlg.h"

#include "MTBedRoughnessKiv.h"

IMPLEMENT_DYNCREATE_DLG(CMTBedRoughnessDlg)

CMTBedRoughnessDlg::CMTBedRoughnessDlg(QWidget* parent) : CMTBedValueDlg(5012, parent) {}

CFemInDataKiv* CMTBedRoughnessDlg::Value() const {
    auto* roughness = Section<CMTBedRoughnessKiv>();
    return roughness ? roughness->Roughness() : nullptr;
}
