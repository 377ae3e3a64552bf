#include "MTBedRoughnessKiv.h"

CMTBedRoughnessKiv::CMTBedRoughnessKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Bed Roughness", "ROUGHNESS", parent) {
    m_roughness = new CFemInDataKiv("", "", 2, false, false, 0.001, 100137, this);
    AddChild(m_roughness);
}

int CMTBedRoughnessKiv::ValidateData() {
    // Written so that a constant read as nan fails too: it is not larger than or equal to 0.
    if (!(m_roughness->Constant() >= 0.0)) {
        AddError(4120);
        return 0;
    }
    return 1;
}

const char* CMTBedRoughnessKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTBedRoughnessDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}
