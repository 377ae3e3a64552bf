#include "MTSettlingKiv.h"

#include "MTReadChecks.h"
#include "MTSandFractionListKiv.h"
#include "setupeditor/KivFields.h"

struct SettlingFields {
    using F = KivField<CMTSettlingKiv>;
    using K = CMTSettlingKiv;
    static inline const F kFields[] = {
        F::Int("flocculation_description", &K::m_flocculation, 1).Choices("0 constant settling velocity, 1 flocculation").Doc("Whether settling includes flocculation"),
        F::Int("hindered_settling_description", &K::m_hinderedSettling, 0).Choices("0 none, 1 Winterwerp, 2 Richardson and Zaki").Doc("Formulation of hindered settling"),
        F::Double("rho_sediment", &K::m_rhoSediment, 2650.0).Unit(100017).Doc("Density of the sediment"),
        F::Double("cfloc", &K::m_cfloc, 0.01).Unit(100403).Doc("Concentration above which flocculation sets in"),
        F::Double("cgel", &K::m_cgel, 50.0).Unit(100403).Doc("Gelling point"),
        F::Double("chinder", &K::m_chinder, 10.0).Unit(100403).Doc("Concentration above which settling is hindered"),
        F::Double("c1_salt", &K::m_c1Salt, 0.5).Doc("First coefficient of the salinity's effect on settling"),
        F::Double("c2_salt", &K::m_c2Salt, -0.33).Doc("Second coefficient of the salinity's effect on settling"),
    };
};

struct SettlingItemFields {
    using F = KivField<CMTSettlingItemKiv>;
    using K = CMTSettlingItemKiv;
    static inline const F kFields[] = {
        F::Double("gamma", &K::m_gamma, 1.0).Doc("Exponent gamma of the fraction's settling velocity"),
        F::Double("wsn", &K::m_wsn, 1.0).Doc("Exponent n of the fraction's settling velocity"),
    };
};

CMTSettlingItemKiv::CMTSettlingItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Fraction %d", "FRACTION_%d", parent),
      m_constantVelocity(new CFemInDataKiv("CONSTANT_SETTLING_VELOCITY", "Settling velocity", 2,
                                           false, false, 0.0005, 100128, this)),
      m_coefficient(new CFemInDataKiv("SETTLING_VELOCITY_COEFFICIENT",
                                      "Settling velocity coefficient", 2, false, false, 0.0005,
                                      100428, this)) {
    AddChild(m_constantVelocity);
    AddChild(m_coefficient);
    DefaultFields(*this, SettlingItemFields::kFields);
}

CMTSettlingKiv* CMTSettlingItemKiv::Section() const {
    return dynamic_cast<CMTSettlingKiv*>(GetParent());
}

void CMTSettlingItemKiv::UpdateValuesInUse() {
    const CMTSettlingKiv* section = Section();
    if (!section)
        return;
    const bool flocculation = section->Flocculation() > 0;
    m_constantVelocity->Disable(flocculation);
    m_coefficient->Disable(section->Flocculation() == 0);
}

void CMTSettlingItemKiv::WriteData(void* h) { WriteFields(h, *this, SettlingItemFields::kFields); }

void CMTSettlingItemKiv::ReadData(void* h) { ReadFields(h, *this, SettlingItemFields::kFields); }

int CMTSettlingItemKiv::ValidateData() {
    // Runs before the values validate themselves, so a value not in use is not checked.
    UpdateValuesInUse();
    return 1;
}

bool CMTSettlingItemKiv::IsDlgUsedInSetup() {
    const CMTSandFractionListKiv* sand = SandFractions(this);
    return !(sand && sand->IsSand(GetNumberWhatAmI()));
}

const char* CMTSettlingItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSettlingItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTSettlingItemKiv::SetDefault() {
    DefaultFields(*this, SettlingItemFields::kFields);
    m_constantVelocity->SetDefault();
    m_coefficient->SetDefault();
}

CMTSettlingKiv::CMTSettlingKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("Settling", "SETTLING_VELOCITY", parent, MTCount::Fractions) {
    DefaultFields(*this, SettlingFields::kFields);
}

int CMTSettlingKiv::ItemInUseCount() {
    int n = 0;
    for (CMTSettlingItemKiv* item : Items())
        n += item->IsDlgUsedInSetup() ? 1 : 0;
    return n;
}

CMTSettlingItemKiv* CMTSettlingKiv::GetItemInUse(int row) {
    if (row < 1)
        return nullptr;
    for (CMTSettlingItemKiv* item : Items())
        if (item->IsDlgUsedInSetup() && --row == 0)
            return item;
    return nullptr;
}

void CMTSettlingKiv::WriteData(void* h) { WriteFields(h, *this, SettlingFields::kFields); }

void CMTSettlingKiv::ReadData(void* h) {
    ReadFields(h, *this, SettlingFields::kFields);
    WarnUnknownChoice(h, "flocculation_description", m_flocculation, 0, 1);
    WarnUnknownChoice(h, "hindered_settling_description", m_hinderedSettling, 0, 2);
}

bool CMTSettlingKiv::IsDlgUsedInSetup() { return ItemInUseCount() > 0; }

const char* CMTSettlingKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSettlingDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

void CMTSettlingKiv::SetDefault() { DefaultFields(*this, SettlingFields::kFields); }

void CMTSettlingItemKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, SettlingItemFields::kFields); }

void CMTSettlingKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, SettlingFields::kFields); }
