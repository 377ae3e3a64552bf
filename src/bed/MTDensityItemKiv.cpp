#include "MTDensityItemKiv.h"

#include "MTLayerItem.h"

double CMTDensityItemKiv::DefaultDensity(int layer) {
    if (layer <= 1)
        return 180.0;
    if (layer == 2)
        return 300.0;
    if (layer == 3)
        return 450.0;
    return 600.0;
}

CMTDensityItemKiv::CMTDensityItemKiv(CZoSEKivListBaseInterface* list)
    : CZoSEKivBase("", "LAYER_%d", list), m_layer(LayerNumberAtCreation(list)) {
    SetTitle(FormatString("Layer %d", m_layer));
    m_density = new CFemInDataKiv("", "", 2, false, false, DefaultDensity(m_layer), 100017, this);
    AddChild(m_density);
}

const char* CMTDensityItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDensityItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}
