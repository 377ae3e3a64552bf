#include "MTErosionItemKiv.h"

#include "MTLayerItem.h"
#include "setupeditor/KivFields.h"

namespace {
struct LayerDefaults {
    bool softMud;
    double criticalShearStress;
    double power;
};

// The top layer is soft mud; the layers below it harden with depth.
LayerDefaults DefaultsFor(int layer) {
    if (layer <= 1)
        return {true, 0.1, CMTErosionItemKiv::kSoftMudPower};
    if (layer == 2)
        return {false, 0.25, CMTErosionItemKiv::kHardMudPower};
    return {false, 0.4, CMTErosionItemKiv::kHardMudPower};
}

constexpr double kErosionCoefficient = 0.00005;
}  // namespace

struct ErosionItemFields {
    using F = KivField<CMTErosionItemKiv>;
    // The default of "description" depends on the layer: SetDefault sets it.
    static inline const F kFields[] = {
        F::Flag("description", &CMTErosionItemKiv::m_softMud, false).Choices("0 hard bed, 1 soft mud").Doc("Whether the layer erodes as soft mud"),
    };
};

CMTErosionItemKiv::CMTErosionItemKiv(CZoSEKivListBaseInterface* list)
    : CZoSEKivBase("", "LAYER_%d", list), m_layer(LayerNumberAtCreation(list)) {
    SetTitle(FormatString("Layer %d", m_layer));
    const LayerDefaults d = DefaultsFor(m_layer);
    m_softMud = d.softMud;
    m_coefficient = new CFemInDataKiv("EROSION_COEFFICIENT", "Erosion coefficient", 2, false,
                                      false, kErosionCoefficient, 100429, this);
    m_shearStress = new CFemInDataKiv("CRITICAL_SHEARSTRESS_FOR_EROSION",
                                      "Critical shear stress", 2, false, false,
                                      d.criticalShearStress, 100152, this);
    m_power = new CFemInDataKiv("POWER_OF_EROSION", "Power of erosion", 2, false, false,
                                d.power, 999, this);
    AddChild(m_coefficient);
    AddChild(m_shearStress);
    AddChild(m_power);
}

void CMTErosionItemKiv::SoftMud(bool soft) {
    if (soft == m_softMud)
        return;
    m_softMud = soft;
    m_power->Constant(soft ? kSoftMudPower : kHardMudPower);
}

CString CMTErosionItemKiv::DescriptionText() const { return m_softMud ? "Soft mud" : "Hard mud"; }

void CMTErosionItemKiv::WriteData(void* h) { WriteFields(h, *this, ErosionItemFields::kFields); }

void CMTErosionItemKiv::ReadData(void* h) { ReadFields(h, *this, ErosionItemFields::kFields); }

void CMTErosionItemKiv::SetDefault() {
    m_softMud = DefaultsFor(m_layer).softMud;
    m_coefficient->SetDefault();
    m_shearStress->SetDefault();
    m_power->SetDefault();
}

const char* CMTErosionItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTErosionItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTErosionItemKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, ErosionItemFields::kFields); }
