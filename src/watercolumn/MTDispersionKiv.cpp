#include "MTDispersionKiv.h"

#include "MTReadChecks.h"
#include "fem/DomainKiv.h"
#include "setupeditor/KivFields.h"

namespace {

bool ModelIs3D(const CZoSEKivBase* node) {
    const CDomainKiv* domain = Domain(node);
    return domain && domain->Is3D();
}

int EddyViscosityFormatCode(const CZoSEKivBase* node) { return ModelIs3D(node) ? 3 : 2; }

// A value's section: the constant goes under its own keyword, as a float.
void WriteValue(void* h, const char* section, const char* constantKeyword,
                const CFemInDataKiv& value) {
    const CFemInDataFile& file = *value.QrdData();
    kivAddSection(h, section);
    kivPutParam(h, "format", value.Format());
    kivPutParam(h, constantKeyword, ToFileFloat(value.Constant()));
    kivPutParamFilename(h, "file_name", file.FileName());
    kivAddKeyword(h, "item_number");
    if (file.ItemNumbers().empty())
        kivAddInt(h, 1);
    for (int n : file.ItemNumbers())
        kivAddInt(h, n);
    kivPutParam(h, "item_name", file.ItemString());
    kivEndSection(h);
}

// Every keyword of a present section is stored, a missing one as the preset below; an
// absent section leaves the value as it was.
void ReadValue(void* h, const char* section, const char* constantKeyword, int missingFormat,
               CFemInDataKiv& value) {
    void* s = kivSectionByNameNum(h, section, 1);
    if (!s)
        return;
    int format = missingFormat;
    // A constant the file holds but cannot be used keeps the value's own.
    double constant = kivKeywordByNameNum(s, constantKeyword, 1) ? value.Constant() : 0.0;
    CString fileName;
    std::vector<int> items;
    CString itemName;
    kivGetParam(s, "format", &format, 1, 1);
    ReadFileFloat(s, constantKeyword, &constant);
    kivGetParamFilename(s, "file_name", &fileName, 1, 1);
    const int count = kivParamCount(kivKeywordByNameNum(s, "item_number", 1));
    for (int i = 1; i <= count; ++i) {
        int item = 1;
        kivGetParam(s, "item_number", &item, 1, i);
        items.push_back(item);
    }
    if (items.empty())
        items.push_back(1);
    kivGetParam(s, "item_name", &itemName, 1, 1);
    value.Format(format);
    value.Constant(constant);
    CFemInDataFile& file = *value.QrdData();
    file.FileName(fileName);
    file.ItemNumbers(std::move(items));
    // The name written for an item without one is its numbers; that is no name.
    file.ItemName("");
    if (itemName != file.ItemString())
        file.ItemName(itemName);
    value.WarnUnlessFormatAllowed(s);
}

}  // namespace

struct DispersionItemFields {
    using F = KivField<CMTDispersionItemKiv>;
    using K = CMTDispersionItemKiv;
    static inline const F kFields[] = {
        F::Int("type", &K::m_type, CMTDispersionItemKiv::kScaledEddyViscosity).Choices("0 No dispersion, 1 Dispersion coefficient formulation, 2 Scaled eddy viscosity formulation").Doc("How the dispersion of the fraction is given"),
    };
};

CMTDispersionItemKiv::CMTDispersionItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Fraction %d", "SSC_FRACTION_%d", parent),
      m_eddyViscosity(std::make_unique<CFemInDataKiv>(
          "SCALED_EDDY_VISCOSITY", "Scaled eddy viscosity formulation",
          EddyViscosityFormatCode(parent), false, false, 1.0, -1, this)),
      m_coefficient(std::make_unique<CFemInDataKiv>("DISPERSION_COEFFICIENT",
                                                    "Dispersion coefficient formulation", 2,
                                                    false, false, 0.01, 100153, this)) {
    m_eddyViscosity->QrdData()->ItemNumbers({1});
    m_coefficient->QrdData()->ItemNumbers({1});
    m_eddyViscosity->ConstantIsFloat(true);
    m_coefficient->ConstantIsFloat(true);
}

CMTDispersionItemKiv::~CMTDispersionItemKiv() = default;

CString CMTDispersionItemKiv::FormulationText(int type) {
    switch (type) {
    case kNoDispersion: return "No dispersion";
    case kDispersionCoefficient: return "Dispersion coefficient formulation";
    case kScaledEddyViscosity: return "Scaled eddy viscosity formulation";
    default: return "";
    }
}

void CMTDispersionItemKiv::UpdateFormatCode() {
    // The domain may turn three-dimensional after the item was made (it is read later).
    m_eddyViscosity->FormatCode(EddyViscosityFormatCode(this));
}

CFemInDataKiv* CMTDispersionItemKiv::ScaledEddyViscosity() {
    UpdateFormatCode();
    return m_eddyViscosity.get();
}

void CMTDispersionItemKiv::UpdateValuesInUse() {
    m_eddyViscosity->Disable(m_type != kScaledEddyViscosity);
    m_coefficient->Disable(m_type != kDispersionCoefficient);
}

void CMTDispersionItemKiv::WriteData(void* h) {
    WriteFields(h, *this, DispersionItemFields::kFields);
    WriteValue(h, "SCALED_EDDY_VISCOSITY", "sigma", *m_eddyViscosity);
    WriteValue(h, "DISPERSION_COEFFICIENT", "constant_value", *m_coefficient);
}

void CMTDispersionItemKiv::ReadData(void* h) {
    UpdateFormatCode();
    ReadFields(h, *this, DispersionItemFields::kFields);
    WarnUnknownChoice(h, "type", m_type, kNoDispersion, kScaledEddyViscosity);
    ReadValue(h, "SCALED_EDDY_VISCOSITY", "sigma", 0, *m_eddyViscosity);
    ReadValue(h, "DISPERSION_COEFFICIENT", "constant_value", 1, *m_coefficient);
    UpdateFormatCode();
}

int CMTDispersionItemKiv::ValidateData() {
    UpdateValuesInUse();
    UpdateFormatCode();
    // Values of a list the model does not use (vertical, in two dimensions) are not checked.
    auto* list = dynamic_cast<CMTDispersionListKiv*>(GetParent());
    if (list && !list->IsDlgUsedInSetup())
        return 1;
    // The node walk does not reach the values, so the one in use is checked here: a data
    // file it needs but lacks would otherwise pass unnoticed.
    const int eddyViscosityValid = m_eddyViscosity->ValidateData();
    const int coefficientValid = m_coefficient->ValidateData();
    return eddyViscosityValid && coefficientValid ? 1 : 0;
}

const char* CMTDispersionItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDispersionItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTDispersionItemKiv::SetDefault() {
    DefaultFields(*this, DispersionItemFields::kFields);
    m_eddyViscosity->SetDefault();
    m_coefficient->SetDefault();
    m_eddyViscosity->QrdData()->ItemNumbers({1});
    m_coefficient->QrdData()->ItemNumbers({1});
}

CMTDispersionListKiv::CMTDispersionListKiv(bool horizontal, const CString& title,
                                           const CString& sectionName, CZoSEKivBase* parent)
    : CMTCountListKiv(title, sectionName, parent, MTCount::Fractions), m_horizontal(horizontal) {}

bool CMTDispersionListKiv::IsDlgUsedInSetup() { return m_horizontal || ModelIs3D(this); }

const char* CMTDispersionListKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDispersionListDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

CMTDispersionKiv::CMTDispersionKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Dispersion", "DISPERSION", parent, 5022, "CMTGroupDlg"),
      m_horizontal(new CMTDispersionListKiv(true, "Horizontal Dispersion",
                                            "HORIZONTAL_DISPERSION", this)),
      m_vertical(
          new CMTDispersionListKiv(false, "Vertical Dispersion", "VERTICAL_DISPERSION", this)) {
    AddChild(m_horizontal);
    AddChild(m_vertical);
}

void CMTDispersionItemKiv::DescribeKeywords(KeywordSink& sink) {
    DescribeFields(sink, DispersionItemFields::kFields);
    UpdateFormatCode();
    m_eddyViscosity->DescribeAt(sink, sink.Path() + "/SCALED_EDDY_VISCOSITY", "sigma", true,
                                "item_number");
    m_coefficient->DescribeAt(sink, sink.Path() + "/DISPERSION_COEFFICIENT", "constant_value",
                              true, "item_number");
}
