#include "MTSandFractionListKiv.h"

#include "MTReadChecks.h"
#include "fem/UnitUtil.h"
#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "MT Sand Fractions";
constexpr long kSettlingVelocityUnit = 100128;
}  // namespace

struct SandFractionItemFields {
    using F = KivField<CMTSandFractionItemKiv>;
    using K = CMTSandFractionItemKiv;
    static inline const F kFields[] = {
        F::Bool("include_sand", &K::m_includeSand, true).Doc("Whether the fraction is sand"),
        F::DoubleAsFloat("mean_settling_velocity", &K::m_meanSettlingVelocity, 0.001).Unit(100128).Doc("Mean settling velocity of the sand fraction"),
    };
};

struct SandFractionListFields {
    using F = KivField<CMTSandFractionListKiv>;
    using K = CMTSandFractionListKiv;
    static inline const F kFields[] = {
        F::Flag("sand_fraction_description", &K::m_includeSandFractions, false).Choices("0 no sand fractions, 1 sand fractions").Doc("Whether fractions may be sand"),
    };
};

CMTSandFractionItemKiv::CMTSandFractionItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Fraction %d", "FRACTION_%d", parent) {
    SetDefault();
}

double CMTSandFractionItemKiv::MeanSettlingVelocity() const {
    return ToUserUnit(kSettlingVelocityUnit, m_meanSettlingVelocity);
}

void CMTSandFractionItemKiv::MeanSettlingVelocity(double shown) {
    m_meanSettlingVelocity = FromUserUnit(kSettlingVelocityUnit, shown);
}

void CMTSandFractionItemKiv::WriteData(void* h) {
    WriteFields(h, *this, SandFractionItemFields::kFields);
}

void CMTSandFractionItemKiv::ReadData(void* h) {
    ReadFields(h, *this, SandFractionItemFields::kFields);
}

void CMTSandFractionItemKiv::SetDefault() { DefaultFields(*this, SandFractionItemFields::kFields); }

CMTSandFractionListKiv::CMTSandFractionListKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("Sand Fractions", "SAND_FRACTIONS", parent, MTCount::Fractions) {
    DefaultFields(*this, SandFractionListFields::kFields);
    GetRoot()->RegisterImportantNode(this, kKey);
}

CMTSandFractionListKiv::~CMTSandFractionListKiv() { GetRoot()->UnregisterImportantNode(kKey); }

bool CMTSandFractionListKiv::IsSand(int fraction) const {
    const CMTSandFractionItemKiv* item = GetItem(fraction);
    return m_includeSandFractions && item && item->IncludeSand();
}

void CMTSandFractionListKiv::WriteData(void* h) {
    WriteFields(h, *this, SandFractionListFields::kFields);
}

void CMTSandFractionListKiv::ReadData(void* h) {
    ReadFields(h, *this, SandFractionListFields::kFields);
    // Looked at, not read again: a value of the wrong type is reported once, by the read.
    if (void* k = kivKeywordByNameNum(h, "sand_fraction_description", 1))
        if (void* p = kivParamByNum(k, 1))
            WarnUnknownFlag(h, "sand_fraction_description", kivGetInt(p));
}

const char* CMTSandFractionListKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSandFractionListDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

void CMTSandFractionListKiv::SetDefault() { DefaultFields(*this, SandFractionListFields::kFields); }

CMTSandFractionListKiv* SandFractions(const CZoSEKivBase* node) {
    return GetImportant<CMTSandFractionListKiv>(node, kKey);
}

void CMTSandFractionItemKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, SandFractionItemFields::kFields); }

void CMTSandFractionListKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, SandFractionListFields::kFields); }
