#include "MTOutputItemSubKiv.h"

#include "setupeditor/Keywords.h"
#include "MTOutputItemMainKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/DomainKiv.h"
#include "paramfile/Kiv.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace {

using Table = CMTOutputItemSubKiv::Table;
using Quantity = CMTOutputItemSubKiv::Quantity;

// Where each quantity of a new table was in the old one (-1: new). Every output rebuilds
// from the same old table to the same new one, so the map is made once for all of them.
struct Remap {
    std::shared_ptr<const Table> from, to;
    std::vector<int> basic, additional;
};

std::vector<int> IndexOf(const std::vector<Quantity>& from, const std::vector<Quantity>& to) {
    std::unordered_map<std::string_view, int> at;
    at.reserve(from.size());
    for (size_t i = 0; i < from.size(); ++i)
        at.emplace(from[i].keyword, static_cast<int>(i));
    std::vector<int> out(to.size(), -1);
    for (size_t i = 0; i < to.size(); ++i) {
        auto it = at.find(to[i].keyword);
        if (it != at.end())
            out[i] = it->second;
    }
    return out;
}

const Remap& RemapOf(const std::shared_ptr<const Table>& from, const std::shared_ptr<const Table>& to) {
    // The 2D and 3D selections of every output rebuild in turn: a few recent maps serve both.
    static Remap recent[4];
    static size_t next = 0;
    for (const Remap& r : recent)
        if (r.from == from && r.to == to && r.to)
            return r;
    Remap& r = recent[next];
    next = (next + 1) % std::size(recent);
    r.from = from;
    r.to = to;
    r.basic = from ? IndexOf(from->basic, to->basic) : std::vector<int>(to->basic.size(), -1);
    r.additional = from ? IndexOf(from->additional, to->additional)
                        : std::vector<int>(to->additional.size(), -1);
    return r;
}

std::vector<int> Carry(const std::vector<int>& old, const std::vector<int>& index, int fallback) {
    std::vector<int> out(index.size(), fallback);
    for (size_t i = 0; i < index.size(); ++i)
        if (index[i] >= 0 && static_cast<size_t>(index[i]) < old.size())
            out[i] = old[static_cast<size_t>(index[i])];
    return out;
}

// Tables by their counts, made once.
template <class Make>
std::shared_ptr<const Table> Cached(std::map<std::pair<int, int>, std::shared_ptr<const Table>>& cache,
                                    int fractions, int layers, Make make) {
    auto& slot = cache[{fractions, layers}];
    if (!slot) {
        auto t = std::make_shared<Table>();
        t->fractions = fractions;
        t->layers = layers;
        make(*t);
        slot = std::move(t);
    }
    return slot;
}

void PerFraction(std::vector<Quantity>& out, int fractions, const char* keyword, const char* label,
                 int cls) {
    for (int f = 1; f <= fractions; ++f)
        out.push_back({FormatString(label, f), FormatString(keyword, f), cls});
}

}  // namespace

CMTOutputItemSubKiv::CMTOutputItemSubKiv(const CString& sectionName, CZoSEKivBase* parent)
    : CZoSEKivBase("Parameters", sectionName, parent) {
    if (CParameterSelectionKiv* model = ModelDefinition(this))
        Listen(model);
}

CMTOutputItemSubKiv::~CMTOutputItemSubKiv() = default;

int CMTOutputItemSubKiv::Count(List list) const {
    return static_cast<int>(list == List::Basic ? m_basic.size() : m_additional.size());
}

CMTOutputItemSubKiv::_COutputItem CMTOutputItemSubKiv::Item(List list, int index) const {
    const bool basic = list == List::Basic;
    const Quantity& q = (basic ? m_table->basic : m_table->additional).at(static_cast<size_t>(index));
    const int value = (basic ? m_basic : m_additional).at(static_cast<size_t>(index));
    return {q.label, q.keyword, q.itemClass, value};
}

void CMTOutputItemSubKiv::Value(List list, int index, int value) {
    std::vector<int>& values = list == List::Basic ? m_basic : m_additional;
    if (index >= 0 && static_cast<size_t>(index) < values.size())
        values[static_cast<size_t>(index)] = value;
}

CMTOutputItemMainKiv* CMTOutputItemSubKiv::Output() const {
    return dynamic_cast<CMTOutputItemMainKiv*>(GetParent());
}

bool CMTOutputItemSubKiv::IsOffered(int itemClass) const {
    const CDomainKiv* domain = Domain(this);
    if (!domain || !domain->ThreeD())
        return true;
    const int type = Output() ? Output()->Type() : 1;
    if (itemClass == 2)
        return type == 1;
    if (itemClass == 3)
        return type == 2;
    return false;
}

void CMTOutputItemSubKiv::Rebuild() {
    const CParameterSelectionKiv* model = ModelDefinition(this);
    const int fractions = model ? std::max(model->NumberOfFractions(), 0) : 0;
    const int layers = model ? std::max(model->NumberOfLayers(), 0) : 0;
    std::shared_ptr<const Table> table = MakeTable(fractions, layers);
    if (table == m_table)
        return;
    const Remap& remap = RemapOf(m_table, table);
    m_basic = Carry(m_basic, remap.basic, 1);
    m_additional = Carry(m_additional, remap.additional, 0);
    m_table = std::move(table);
}

void CMTOutputItemSubKiv::WriteData(void* h) {
    for (size_t i = 0; i < m_basic.size(); ++i)
        kivPutParam(h, m_table->basic[i].keyword.c_str(), m_basic[i]);
    for (size_t i = 0; i < m_additional.size(); ++i)
        kivPutParam(h, m_table->additional[i].keyword.c_str(), m_additional[i]);
}

void CMTOutputItemSubKiv::ReadData(void* h) {
    for (size_t i = 0; i < m_basic.size(); ++i) {
        m_basic[i] = 1;
        kivGetParam(h, m_table->basic[i].keyword.c_str(), &m_basic[i], 1, 1);
    }
    for (size_t i = 0; i < m_additional.size(); ++i) {
        m_additional[i] = 0;
        kivGetParam(h, m_table->additional[i].keyword.c_str(), &m_additional[i], 1, 1);
    }
}

const char* CMTOutputItemSubKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTOutputItemSubDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTOutputItemSubKiv::Notify(CFemNotifier* notifier, ENotifyMessage message) {
    if (message == 0)
        CFemListener::Notify(notifier, message);
    else if (message == kNotifyFractions || message == kNotifyLayers)
        Rebuild();
}

// --- 2D ----------------------------------------------------------------------------------

CMTOutputItemSub2DKiv::CMTOutputItemSub2DKiv(CZoSEKivBase* parent)
    : CMTOutputItemSubKiv("PARAMETERS_2D", parent) {
    Rebuild();
}

bool CMTOutputItemSub2DKiv::IsDlgUsedInSetup() { return Output() && Output()->Type() == 1; }

std::shared_ptr<const CMTOutputItemSubKiv::Table> CMTOutputItemSub2DKiv::MakeTable(int F, int L) const {
    static std::map<std::pair<int, int>, std::shared_ptr<const Table>> cache;
    return Cached(cache, F, L, [F, L](Table& t) {
        PerFraction(t.basic, F, "SSC_FRACTION_%d", "SSC - fraction %d", 3);
        for (int l = 1; l <= L; ++l)
            t.basic.push_back({FormatString("Bed thickness - layer %d", l),
                               FormatString("BED_THICKNESS_LAYER_%d", l), 2});
        for (int l = 1; l <= L; ++l)
            for (int f = 1; f <= F; ++f)
                t.basic.push_back({FormatString("Bed mass - layer %d, fraction %d", l, f),
                                   FormatString("BED_MASS_LAYER_%d_FRACTION_%d", l, f), 2});
        auto& a = t.additional;
        PerFraction(a, F, "SETTLING_VELOCITY_FRACTION_%d", "Settling velocity - fraction %d", 3);
        a.push_back({"Bed shearstress", "BED_SHEARSTRESS", 2});
        a.push_back({"Total SSC", "TOTAL_SSC", 3});
        a.push_back({"Total bed thickness change", "TOTAL_BED_THICKNESS_CHANGE", 2});
        a.push_back({"Total bed mass change", "TOTAL_BED_MASS_CHANGE", 2});
        a.push_back({"Bed level", "BED_LEVEL", 2});
        PerFraction(a, F, "EROSION_FRACTION_%d", "Erosion - fraction %d", 2);
        PerFraction(a, F, "DEPOSITION_FRACTION_%d", "Deposition - fraction %d", 2);
        PerFraction(a, F, "NET_DEPOSITION_FRACTION_%d", "Net deposition - fraction %d", 2);
        PerFraction(a, F, "NET_DEPOSITION_ACCUMULATED_FRACTION_%d",
                    "Net deposition accum. - fraction %d", 2);
        a.push_back({"Total net deposition accum.", "TOTAL_NET_DEPOSITION_ACCUMULATED", 2});
        a.push_back({"Wave height", "WAVE_HEIGHT", 2});
        a.push_back({"Wave period", "WAVE_PERIOD", 2});
        a.push_back({"Wave direction", "WAVE_DIRECTION", 2});
        a.push_back({"U Velocity", "U_VELOCITY", 3});
        a.push_back({"V Velocity", "V_VELOCITY", 3});
        a.push_back({"CFL number", "CFL_NUMBER", 3});
    });
}

// --- 3D ----------------------------------------------------------------------------------

CMTOutputItemSub3DKiv::CMTOutputItemSub3DKiv(CZoSEKivBase* parent)
    : CMTOutputItemSubKiv("PARAMETERS_3D", parent) {
    Rebuild();
}

bool CMTOutputItemSub3DKiv::IsDlgUsedInSetup() { return Output() && Output()->Type() == 2; }

std::shared_ptr<const CMTOutputItemSubKiv::Table> CMTOutputItemSub3DKiv::MakeTable(int F, int L) const {
    static std::map<std::pair<int, int>, std::shared_ptr<const Table>> cache;
    return Cached(cache, F, L, [F](Table& t) {
        PerFraction(t.basic, F, "SSC_FRACTION_%d", "SSC - fraction %d", 3);
        auto& a = t.additional;
        PerFraction(a, F, "SETTLING_VELOCITY_FRACTION_%d", "Settling velocity - fraction %d", 3);
        a.push_back({"Total SSC", "TOTAL_SSC", 3});
        a.push_back({"U Velocity", "U_VELOCITY", 3});
        a.push_back({"V Velocity", "V_VELOCITY", 3});
        a.push_back({"W Velocity", "W_VELOCITY", 3});
        a.push_back({"CFL number", "CFL_NUMBER", 3});
    });
}

void CMTOutputItemSubKiv::DescribeKeywords(KeywordSink& sink) {
    auto add = [&](const Quantity& q, const char* kind) {
        KeywordEntry e;
        e.path = sink.Path();
        e.keyword = q.keyword;
        e.type = KeywordType::Int;
        e.choices = "0 not written, 1 written";
        e.description = std::string("Whether the output writes ") + kind + q.label;
        sink.Add(std::move(e));
    };
    for (size_t i = 0; i < m_table->basic.size(); ++i)
        add(m_table->basic[i], "");
    for (size_t i = 0; i < m_table->additional.size(); ++i)
        add(m_table->additional[i], "the additional quantity ");
}
