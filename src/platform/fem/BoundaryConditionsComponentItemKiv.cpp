#include "BoundaryConditionsComponentItemKiv.h"

#include <algorithm>

#include "SimulationPeriodKiv.h"
#include "datafile/ZoFileSelector.h"
#include "paramfile/Kiv.h"
#include "setupeditor/KivFields.h"
#include "setupeditor/MessageTable.h"

namespace {
// Concentrations cannot be negative; other quantities (water levels) can.
constexpr long kConcentrationType = 100403;
constexpr unsigned kMsgFileNotValid = 4112;

const std::shared_ptr<const std::vector<CString>>& NoTexts() {
    static const auto texts = std::make_shared<const std::vector<CString>>();
    return texts;
}
}  // namespace

struct BoundaryItemFields {
    using F = KivField<CBoundaryConditionsComponentItemKiv>;
    using K = CBoundaryConditionsComponentItemKiv;
    // The file's keywords sit between the constant and the soft start.
    static inline const F kHead[] = {
        F::Int("type", &K::m_type, 0).Doc("Kind of boundary value"),
        F::Int("format", &K::m_format, 0).Choices("0 constant, 1 varying in time").Doc("Whether the boundary value is a constant or a time series"),
        F::Double("constant_value", &K::m_constant, 0.0).Doc("Boundary value when it is constant"),
    };
    static inline const F kTail[] = {
        F::Double("soft_start_time", &K::m_softTime, 0.0).Unit(100290).Range(">= 0").Doc("Time over which the boundary value is brought in"),
        F::Double("soft_start_reference", &K::m_refSoft, 0.0).Doc("Value the soft start begins from"),
        F::Int("soft_start_type", &K::m_typeSoft, 0).Doc("Shape of the soft start"),
        F::Int("time_interpolation", &K::m_typeTI, 0).Doc("Interpolation of the boundary value in time"),
        F::Int("space_interpolation", &K::m_typeSI, 0).Doc("Interpolation of the boundary value along the boundary"),
    };
};

CBoundaryConditionsComponentItemKiv::CBoundaryConditionsComponentItemKiv(
    const CString& title, const CString& sectionName, CZoSEKivBase* parent)
    : CZoSEKivBase(title, sectionName, parent), m_typeTexts(NoTexts()) {}

void CBoundaryConditionsComponentItemKiv::TypeTextArr(
    std::shared_ptr<const std::vector<CString>> texts) {
    m_typeTexts = texts ? std::move(texts) : NoTexts();
}

CString CBoundaryConditionsComponentItemKiv::TypeText() const {
    if (m_type >= 0 && m_type < static_cast<int>(m_typeTexts->size()))
        return (*m_typeTexts)[static_cast<size_t>(m_type)];
    return FormatString("Type %d", m_type);
}

CString CBoundaryConditionsComponentItemKiv::FormatName(int format) {
    switch (format) {
    case 0: return "Constant";
    case 1: return "Varying in time";
    case 2: return "Varying along the boundary";
    case 3: return "Varying in time and along the boundary";
    default: return FormatString("Format %d", format);
    }
}

CString CBoundaryConditionsComponentItemKiv::SoftStartName(int type) {
    switch (type) {
    case 0: return "None";
    case 1: return "Linear";
    case 2: return "Sinusoidal";
    default: return FormatString("Soft start %d", type);
    }
}

CString CBoundaryConditionsComponentItemKiv::InterpolationName(int type, bool inSpace) {
    switch (type) {
    case 0: return inSpace ? "Nearest point" : "Piecewise constant";
    case 1: return "Linear";
    default: return FormatString("Interpolation %d", type);
    }
}

void CBoundaryConditionsComponentItemKiv::WriteData(void* h) {
    WriteFields(h, *this, BoundaryItemFields::kHead);
    kivPutParamFilename(h, "file_name", m_file.FileName());
    kivAddKeyword(h, "item_numbers");
    for (int n : m_file.ItemNumbers())
        kivAddInt(h, n);
    kivPutParam(h, "item_name", m_file.ItemName());
    WriteFields(h, *this, BoundaryItemFields::kTail);
}

void CBoundaryConditionsComponentItemKiv::ReadData(void* h) {
    ReadFields(h, *this, BoundaryItemFields::kHead);
    CString name = m_file.FileName();
    kivGetParamFilename(h, "file_name", &name, 1, 1);
    m_file.FileName(name);
    if (void* k = kivKeywordByNameNum(h, "item_numbers", 1)) {
        std::vector<int> items;
        const int n = kivParamCount(k);
        for (int i = 1; i <= n; ++i) {
            int item = 1;
            kivGetParam(h, "item_numbers", &item, 1, i);
            items.push_back(item);
        }
        m_file.ItemNumbers(std::move(items));
    }
    CString itemName = m_file.ItemName();
    kivGetParam(h, "item_name", &itemName, 1, 1);
    m_file.ItemName(itemName);
    ReadFields(h, *this, BoundaryItemFields::kTail);
}

int CBoundaryConditionsComponentItemKiv::ValidateData() {
    int ok = 1;
    auto fail = [&](const CString& text) {
        AddError(text);
        ok = 0;
    };
    if (m_type < 0 || m_type >= static_cast<int>(m_typeTexts->size()))
        fail(FormatString("Boundary type %d is not known", m_type));
    if (m_type != kTypeSpecified)
        return ok;
    if (m_format < 0 || m_format > kFormatLast) {
        fail(FormatString("Format %d is not known", m_format));
    } else if (m_format == 0) {
        if (m_ovuType == kConcentrationType && m_constant < 0.0)
            fail(LoadMessage(4120));
    } else if (m_file.FileName().empty()) {
        fail("No data file is given for the boundary values");
    } else if (m_file.ItemNumbers().empty()) {
        fail("No item of the data file is chosen for the boundary values");
    } else if (std::any_of(m_file.ItemNumbers().begin(), m_file.ItemNumbers().end(),
                           [](int n) { return n < 1; })) {
        for (int n : m_file.ItemNumbers())
            if (n < 1) {
                fail(FormatString("Item number %d of the data file is not valid", n));
                break;
            }
    } else if (CString why; !CheckFile(&why)) {
        AddError(kMsgFileNotValid, why);
        ok = 0;
    }
    if (m_softTime < 0.0)
        fail("The soft-start interval must not be negative");
    if (m_typeSoft < 0 || m_typeSoft > kTypeSoftLast || m_typeTI < 0 ||
        m_typeTI > kInterpolationLast || m_typeSI < 0 || m_typeSI > kInterpolationLast)
        fail(LoadMessage(4127));
    return ok;
}

bool CBoundaryConditionsComponentItemKiv::CheckFile(CString* why) const {
    if (m_type != kTypeSpecified || m_format < 1 || m_format > kFormatLast)
        return true;
    CZoFileSelector selector(this);
    CZoItemRequest& request = selector.AddRequest(GetTitle().empty() ? CString("Value") : GetTitle());
    if (m_ovuType != 0)
        request.SetOvuType(m_ovuType);
    selector.SetMinNoItems(1);
    // Values in time come from a time series; values along the boundary from a line series.
    selector.SetAcceptedKinds({m_format == 1 ? datafile::Kind::TimeSeries
                                             : datafile::Kind::LineSeries});
    if (m_format & 1)
        if (const CSimulationPeriodKiv* period = SimulationPeriod(this))
            period->SetUpQrdValidation_SimulationPeriod(selector);
    return selector.IsQrdFileValid(m_file.FileName(), m_file.ItemNumbers(), why);
}

void CBoundaryConditionsComponentItemKiv::RememberDefaults() {
    m_defaults = {m_type, m_format, m_constant, m_softTime, m_refSoft,
                  m_typeSoft, m_typeTI, m_typeSI};
}

void CBoundaryConditionsComponentItemKiv::SetDefault() {
    m_type = m_defaults.type;
    m_format = m_defaults.format;
    m_constant = m_defaults.constant;
    m_softTime = m_defaults.softTime;
    m_refSoft = m_defaults.refSoft;
    m_typeSoft = m_defaults.typeSoft;
    m_typeTI = m_defaults.typeTI;
    m_typeSI = m_defaults.typeSI;
    m_file = CBoundaryConditionsComponentItemFileKiv();
}

void CBoundaryConditionsComponentItemKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kFile[] = {
        {"file_name", KeywordType::FileName, "''", "Time series of the boundary value"},
        {"item_numbers", KeywordType::IntList, "1", "Items of the data file to read"},
        {"item_name", KeywordType::String, "\"\"", "Name of the data file's item"},
    };
    DescribeFields(sink, BoundaryItemFields::kHead);
    sink.Add(kFile);
    DescribeFields(sink, BoundaryItemFields::kTail);
}
