#include "FemInDataKiv.h"

#include "SimulationPeriodKiv.h"
#include "datafile/ZoFileSelector.h"
#include "UnitUtil.h"
#include "paramfile/Kiv.h"
#include "setupeditor/Keywords.h"

CString CFemInDataFile::ItemString() const {
    if (!m_itemName.empty())
        return m_itemName;
    CString s;
    for (int n : m_items) {
        if (!s.empty())
            s += ", ";
        s += std::to_string(n);
    }
    return s;
}

CFemInDataKiv::CFemInDataKiv(const CString& sectionName, const CString& title, int formatCode,
                             bool flag1, bool flag2, double defaultConstant, long itemType,
                             CZoSEKivBase* parent)
    : CZoSEKivBase(title, sectionName, parent), m_formatCode(formatCode), m_flag1(flag1),
      m_flag2(flag2), m_default(defaultConstant), m_constant(defaultConstant),
      m_itemType(itemType) {}

std::vector<int> CFemInDataKiv::AllowedFormats() const {
    std::vector<int> formats{0};
    // Every non-empty combination of the code's bits, in increasing order.
    for (int f = 1; f <= m_formatCode; ++f)
        if ((f & m_formatCode) == f)
            formats.push_back(f);
    return formats;
}

bool CFemInDataKiv::IsFormatAllowed(int format) const {
    return format == 0 || (format > 0 && (format & m_formatCode) == format);
}

namespace {
CString AllowedFormatNames(const CFemInDataKiv& value) {
    CString names;
    for (int f : value.AllowedFormats()) {
        if (!names.empty())
            names += ", ";
        names += CFemInDataKiv::FormatName(f);
    }
    return names;
}
}  // namespace

void CFemInDataKiv::WarnUnlessFormatAllowed(void* h) const {
    if (!IsFormatAllowed(m_format))
        kivWarn(h, "format",
                FormatString("format = %d is not a format of this value (%s); kept as read",
                             m_format, AllowedFormatNames(*this).c_str()));
}

CString CFemInDataKiv::FormatName(int format) {
    if (format == 0)
        return "Constant";
    CString parts;
    auto add = [&](const char* part) {
        if (!parts.empty())
            parts += " and ";
        parts += part;
    };
    if (format & 1)
        add("time");
    if (format & 2)
        add("domain");
    if (format & 8)
        add("vertical");
    if (parts.empty())
        return FormatString("Format %d", format);
    return "Varying in " + parts;
}

CString CFemInDataKiv::FormatText() const {
    if (m_format != 0)
        return FormatName(m_format) + ": " + (m_file.FileName().empty() ? CString("(no file)") : m_file.FileName());
    // The constant as the user sees it elsewhere: in the unit chosen for its quantity.
    CString text = FormatName(0) + " " + FormatString("%g", ToUserUnit(m_itemType, m_constant));
    if (CUnitUtil::FindQuantity(m_itemType)) {
        const CString unit = CUnitUtil::GetUnitName(CUnitUtil::GetUserUnit(m_itemType));
        if (!unit.empty() && unit != "()")
            text += " " + unit;
    }
    return text;
}

void CFemInDataKiv::WriteData(void* h) {
    kivPutParam(h, "format", m_format);
    kivPutParam(h, "constant_value", m_constant);
    kivPutParamFilename(h, "file_name", m_file.FileName());
    kivAddKeyword(h, "item_numbers");
    for (int n : m_file.ItemNumbers())
        kivAddInt(h, n);
    kivPutParam(h, "item_name", m_file.ItemName());
}

void CFemInDataKiv::ReadData(void* h) {
    kivGetParam(h, "format", &m_format, 1, 1);
    WarnUnlessFormatAllowed(h);
    kivGetParam(h, "constant_value", &m_constant, 1, 1);
    CString name = m_file.FileName();
    kivGetParamFilename(h, "file_name", &name, 1, 1);
    m_file.FileName(name);
    if (void* k = kivKeywordByNameNum(h, "item_numbers", 1)) {
        std::vector<int> items;
        const int n = kivParamCount(k);
        for (int i = 1; i <= n; ++i) {
            int item = m_file.ItemNumbers().empty() ? 1 : m_file.ItemNumbers().front();
            kivGetParam(h, "item_numbers", &item, 1, i);
            items.push_back(item);
        }
        m_file.ItemNumbers(std::move(items));
    }
    CString itemName = m_file.ItemName();
    kivGetParam(h, "item_name", &itemName, 1, 1);
    m_file.ItemName(itemName);
}

int CFemInDataKiv::ValidateData() {
    if (m_disabled || m_format == 0)
        return 1;
    const CString title = GetTitle();
    const CString what = title.empty() ? CString("the value") : FormatString("'%s'", title.c_str());
    if (!IsFormatAllowed(m_format)) {
        AddError(FormatString("Format %d is not one of the formats of %s (%s)", m_format,
                              what.c_str(), AllowedFormatNames(*this).c_str()));
        return 0;
    }
    if (m_file.FileName().empty()) {
        AddError("No data file is given for " + what);
        return 0;
    }
    if (m_file.ItemNumbers().empty()) {
        AddError("No item of the data file is chosen for " + what);
        return 0;
    }
    for (int n : m_file.ItemNumbers())
        if (n < 1) {
            AddError(FormatString("Item number %d of the data file for %s is not valid", n,
                                  what.c_str()));
            return 0;
        }
    CZoFileSelector selector(this);
    SetUpFileSelector(selector);
    CString error;
    if (!selector.IsQrdFileValid(m_file.FileName(), m_file.ItemNumbers(), &error)) {
        AddError("The data file for " + what + " is not valid: " + error);
        return 0;
    }
    return 1;
}

void CFemInDataKiv::SetUpFileSelector(CZoFileSelector& selector) const {
    const CString title = GetTitle();
    CZoItemRequest& request = selector.AddRequest(title.empty() ? CString("Value") : title);
    std::vector<long> types{m_itemType};
    types.insert(types.end(), m_furtherItemTypes.begin(), m_furtherItemTypes.end());
    request.SetMultiOvuType(types);
    selector.SetMinNoItems(1);
    // Values in time come from time series; values over the domain from grids or mesh data.
    if (m_format == 1)
        selector.SetAcceptedKinds({datafile::Kind::TimeSeries});
    else if (m_format & 2)
        selector.SetAcceptedKinds({datafile::Kind::Grid, datafile::Kind::MeshData});
    if (m_format & 1)
        if (const CSimulationPeriodKiv* period = SimulationPeriod(this))
            period->SetUpQrdValidation_SimulationPeriod(selector);
}

void CFemInDataKiv::SetDefault() {
    m_format = 0;
    m_constant = m_default;
    m_file = CFemInDataFile();
}

void CFemInDataKiv::DescribeAt(KeywordSink& sink, const std::string& path,
                               const char* constantKeyword, bool constantIsFloat,
                               const char* itemKeyword) const {
    const CString title = GetTitle().empty() ? CString("the value") : GetTitle();
    auto entry = [&](const char* keyword, KeywordType type, std::string def, std::string text) {
        KeywordEntry e;
        e.path = path;
        e.keyword = keyword;
        e.type = type;
        e.defaultValue = std::move(def);
        e.description = std::move(text);
        return e;
    };
    KeywordEntry format = entry("format", KeywordType::Int, "0", title + ": constant or from a data file");
    for (int f : AllowedFormats())
        format.choices += (format.choices.empty() ? "" : ", ") + std::to_string(f) + " " + FormatName(f);
    sink.Add(std::move(format));
    KeywordEntry constant =
        entry(constantKeyword, constantIsFloat ? KeywordType::Float : KeywordType::Double,
              constantIsFloat ? KeywordFloatText(static_cast<float>(m_default))
                              : KeywordNumberText(m_default),
              title + ": the constant");
    constant.unitType = m_itemType > 0 ? m_itemType : 0;
    sink.Add(std::move(constant));
    sink.Add(entry("file_name", KeywordType::FileName, "''", title + ": data file"));
    sink.Add(entry(itemKeyword, KeywordType::IntList, "1", title + ": items of the data file to read"));
    sink.Add(entry("item_name", KeywordType::String, "\"\"", title + ": name of the data file's item"));
}

void CFemInDataKiv::DescribeKeywords(KeywordSink& sink) {
    DescribeAt(sink, sink.Path(), "constant_value", false, "item_numbers");
}
