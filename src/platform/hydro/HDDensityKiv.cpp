#include "HDDensityKiv.h"

#include "setupeditor/Keywords.h"
#include "paramfile/Kiv.h"

CHDDensityKiv::CHDDensityKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Density", "HYDRODYNAMIC_DENSITY", parent) {
    GetRoot()->RegisterImportantNode(this, "HDDensity");
}

CHDDensityKiv::~CHDDensityKiv() { GetRoot()->UnregisterImportantNode("HDDensity"); }

const std::vector<CString>& CHDDensityKiv::DensityModeTexts() {
    static const std::vector<CString> texts = {
        "Barotropic", "Function of salinity", "Function of temperature",
        "Function of temperature and salinity"};
    return texts;
}

void CHDDensityKiv::WriteData(void* h) { kivPutParam(h, "density_mode", m_mode); }
void CHDDensityKiv::ReadData(void* h) { kivGetParam(h, "density_mode", &m_mode, 1, 1); }

int CHDDensityKiv::ValidateData() {
    if (m_mode < 0 || m_mode >= static_cast<int>(DensityModeTexts().size())) {
        AddError(FormatString("Density mode %d is not known", m_mode));
        return 0;
    }
    return 1;
}

CHDDensityKiv* HDDensity(const CZoSEKivBase* node) {
    return GetImportant<CHDDensityKiv>(node, "HDDensity");
}

void CHDDensityKiv::DescribeKeywords(KeywordSink& sink) {
    KeywordEntry e;
    e.path = sink.Path();
    e.keyword = "density_mode";
    e.type = KeywordType::Int;
    e.defaultValue = std::to_string(m_mode);
    const std::vector<CString>& texts = DensityModeTexts();
    for (size_t i = 0; i < texts.size(); ++i)
        e.choices += (i ? ", " : "") + std::to_string(i) + " " + texts[i];
    e.description = "What the flow model's density depends on";
    sink.Add(std::move(e));
}
