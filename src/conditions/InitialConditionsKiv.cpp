#include "InitialConditionsKiv.h"

#include "MTFollowedCount.h"
#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "MT Initial Conditions";

const char* DialogOr(CZoSEKivBase* node, unsigned code, const char* dialog) {
    return code == kDlgRuntimeClassRequest ? dialog : node->CZoSEKivBase::GetDlgRuntimeClass(code);
}

// A negative constant is refused whatever the format: it is what the engine starts from
// wherever the file has no value.
int ValidateNotNegative(CZoSEKivBase* item, const CFemInDataKiv* value) {
    if (value->Constant() < 0.0) {
        item->AddError(4120);
        return 0;
    }
    return 1;
}
}  // namespace

struct DistributionElementFields {
    using F = KivField<CInitialConditionsFractionDistributionItemElementKiv>;
    using K = CInitialConditionsFractionDistributionItemElementKiv;
    static inline const F kFields[] = {
        F::Float("constant_value", &K::m_constant, 0.0f).Unit(100013).Doc("Share of the fraction in the layer at the start, as a constant"),
        F::FileName("file_name", &K::m_fileName, "").Doc("Data file of the share, where it varies over the domain"),
        F::Int("item_number", &K::m_itemNumber, 1).Doc("Item of the data file that holds the share"),
    };
};

// --- concentrations and thicknesses ------------------------------------------------------

CInitialConditionsFractionsItemKiv::CInitialConditionsFractionsItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Fraction %d", "SSC_FRACTION_%d", parent),
      m_value(new CFemInDataKiv("", "", 10, false, false, 0.0, 100403, this)) {
    AddChild(m_value);
}

int CInitialConditionsFractionsItemKiv::ValidateData() { return ValidateNotNegative(this, m_value); }

const char* CInitialConditionsFractionsItemKiv::GetDlgRuntimeClass(unsigned code) {
    return DialogOr(this, code, "CInitialConditionsFractionsItemDlg");
}

CInitialConditionsLayersItemKiv::CInitialConditionsLayersItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Layer %d", "BED_THICKNESS_LAYER_%d", parent),
      m_value(new CFemInDataKiv("", "", 8, false, false, 0.0, 100272, this)) {
    m_value->FurtherItemTypes().push_back(100324);
    AddChild(m_value);
}

int CInitialConditionsLayersItemKiv::ValidateData() { return ValidateNotNegative(this, m_value); }

const char* CInitialConditionsLayersItemKiv::GetDlgRuntimeClass(unsigned code) {
    return DialogOr(this, code, "CInitialConditionsLayersItemDlg");
}

// --- fraction distribution ---------------------------------------------------------------

CInitialConditionsFractionDistributionItemElementKiv::
    CInitialConditionsFractionDistributionItemElementKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("", "BED_DISTRIBUTION_FRACTION_%d", parent) {}

void CInitialConditionsFractionDistributionItemElementKiv::WriteData(void* h) {
    WriteFields(h, *this, DistributionElementFields::kFields);
}

void CInitialConditionsFractionDistributionItemElementKiv::ReadData(void* h) {
    ReadFields(h, *this, DistributionElementFields::kFields);
}

CInitialConditionsFractionDistributionItemKiv::CInitialConditionsFractionDistributionItemKiv(
    CZoSEKivBase* parent)
    : CMTCountListKiv("", "BED_DISTRIBUTION_LAYER_%d", parent, MTCount::Fractions) {
    // The list base sized the layer before this class could split it.
    EvenSplit();
}

float CInitialConditionsFractionDistributionItemKiv::Share(int fraction) const {
    const auto* element = GetItem(fraction);
    return element ? element->ConstantValue() : 0.0f;
}

void CInitialConditionsFractionDistributionItemKiv::SetItemCount(int count, int level) {
    if (level != 1) {
        CMTCountListKiv::SetItemCount(count, level);
        return;
    }
    if (std::max(count, 0) == GetItemCount())
        return;
    CMTCountListKiv::SetItemCount(count, level);
    EvenSplit();
}

void CInitialConditionsFractionDistributionItemKiv::EvenSplit() {
    const int k = GetItemCount();
    if (k < 1)
        return;
    const int share = 100 / k;
    for (int i = 1; i < k; ++i)
        GetItem(i)->ConstantValue(static_cast<float>(share));
    GetItem(k)->ConstantValue(static_cast<float>(100 - (k - 1) * share));
}

void CInitialConditionsFractionDistributionItemKiv::LoadSize(void* h) {
    CheckFollowedCount(h, GetItemCount(), "fraction", "fractions");
}

void CInitialConditionsFractionDistributionItemKiv::WriteData(void* h) {
    kivPutParam(h, "format", m_format);
}

void CInitialConditionsFractionDistributionItemKiv::ReadData(void* h) {
    kivGetParam(h, "format", &m_format, 1, 1);
}

int CInitialConditionsFractionDistributionItemKiv::ValidateData() {
    // Added as floats in element order and compared exactly, as the engine does.
    float sum = 0.0f;
    for (int i = 1; i <= GetItemCount(); ++i)
        sum += GetItem(i)->ConstantValue();
    if (GetItemCount() == 0 || sum != 100.0f) {
        AddError(4115);
        return 0;
    }
    return 1;
}

// --- the lists and the group -------------------------------------------------------------

CInitialConditionsFractionsKiv::CInitialConditionsFractionsKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("Fraction Concentration", "", parent, MTCount::Fractions) {}

const char* CInitialConditionsFractionsKiv::GetDlgRuntimeClass(unsigned code) {
    return DialogOr(this, code, "CInitialConditionsFractionsDlg");
}

CInitialConditionsLayersKiv::CInitialConditionsLayersKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("Layer Thickness", "", parent, MTCount::Layers) {}

const char* CInitialConditionsLayersKiv::GetDlgRuntimeClass(unsigned code) {
    return DialogOr(this, code, "CInitialConditionsLayersDlg");
}

CInitialConditionsFractionDistributionKiv::CInitialConditionsFractionDistributionKiv(
    CZoSEKivBase* parent)
    : CMTCountListKiv("Fraction Distribution", "", parent, MTCount::Layers) {}

const char* CInitialConditionsFractionDistributionKiv::GetDlgRuntimeClass(unsigned code) {
    return DialogOr(this, code, "CInitialConditionsFractionDistributionDlg");
}

CInitialConditionsKiv::CInitialConditionsKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Initial Conditions", "INITIAL_CONDITIONS", parent, 5004, "CMTGroupDlg") {
    GetRoot()->RegisterImportantNode(this, kKey);
    m_fractions = new CInitialConditionsFractionsKiv(this);
    AddChild(m_fractions);
    m_layers = new CInitialConditionsLayersKiv(this);
    AddChild(m_layers);
    m_distribution = new CInitialConditionsFractionDistributionKiv(this);
    AddChild(m_distribution);
}

CInitialConditionsKiv::~CInitialConditionsKiv() { GetRoot()->UnregisterImportantNode(kKey); }

CInitialConditionsKiv* InitialConditions(const CZoSEKivBase* node) {
    return GetImportant<CInitialConditionsKiv>(node, kKey);
}

void CInitialConditionsFractionDistributionItemElementKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, DistributionElementFields::kFields); }

void CInitialConditionsFractionDistributionItemKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kFormat{"format", KeywordType::Int, "0",
                                     "How the layer's shares of the fractions are given"};
    sink.Add(kFormat);
}
