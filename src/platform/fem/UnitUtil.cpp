#include "UnitUtil.h"

#include <map>

namespace {

// Unit ids are unique across quantities so that a converter needs only the two ids.
std::vector<QuantityInfo> BuildTable() {
    int next = 1000;
    auto q = [&](long code, const char* name,
                 std::initializer_list<std::pair<const char*, double>> units) {
        QuantityInfo info{code, name, {}};
        for (const auto& [unitName, toBase] : units)
            info.units.push_back({next++, unitName, toBase});
        return info;
    };
    const double ft = 0.3048;
    return {
        q(-1, "No unit", {{"", 1.0}}),
        q(999, "Undefined", {{"()", 1.0}}),
        q(100000, "Water level", {{"m", 1.0}, {"cm", 0.01}, {"ft", ft}}),
        q(100003, "Wind direction", {{"degree", 1.0}, {"radian", 57.29577951308232}}),
        q(100013, "Fraction", {{"()", 1.0}, {"%", 0.01}}),
        q(100017, "Density", {{"kg/m^3", 1.0}, {"g/cm^3", 1000.0}, {"lb/ft^3", 16.018463373960138}}),
        q(100076, "Mass", {{"kg", 1.0}, {"t", 1000.0}, {"g", 0.001}, {"lb", 0.45359237}}),
        q(100084, "Wave height", {{"m", 1.0}, {"cm", 0.01}, {"ft", ft}}),
        q(100085, "Wave period", {{"s", 1.0}}),
        q(100095, "Wave direction", {{"degree", 1.0}, {"radian", 57.29577951308232}}),
        q(100097, "Significant wave height", {{"m", 1.0}, {"cm", 0.01}, {"ft", ft}}),
        q(100128, "Settling velocity",
          {{"m/s", 1.0}, {"mm/s", 0.001}, {"cm/s", 0.01}, {"m/day", 1.0 / 86400.0}, {"ft/s", ft}}),
        q(100137, "Roughness", {{"m", 1.0}, {"mm", 0.001}, {"cm", 0.01}, {"ft", ft}}),
        q(100144, "Base in viscosity formula", {{"()", 1.0}}),
        q(100152, "Bed shear stress", {{"N/m^2", 1.0}, {"Pa", 1.0}, {"dyn/cm^2", 0.1}}),
        q(100153, "Dispersion coefficient", {{"m^2/s", 1.0}, {"ft^2/s", ft * ft}}),
        q(100157, "Geographical coordinate", {{"degree", 1.0}, {"radian", 57.29577951308232}}),
        q(100183, "Map projection coordinate", {{"m", 1.0}, {"km", 1000.0}, {"ft", ft}}),
        q(100195, "Mass rate", {{"kg/s", 1.0}, {"t/s", 1000.0}, {"t/h", 1000.0 / 3600.0}}),
        q(100272, "Layer thickness", {{"m", 1.0}, {"mm", 0.001}, {"cm", 0.01}, {"ft", ft}}),
        q(100274, "Wind speed", {{"m/s", 1.0}, {"km/h", 1.0 / 3.6}, {"knot", 1852.0 / 3600.0}}),
        q(100280, "Elevation", {{"m", 1.0}, {"cm", 0.01}, {"ft", ft}}),
        q(100290, "Time interval", {{"s", 1.0}, {"min", 60.0}, {"h", 3600.0}, {"day", 86400.0}}),
        q(100324, "Mass per area", {{"kg/m^2", 1.0}, {"g/m^2", 0.001}, {"t/m^2", 1000.0}}),
        q(100370, "Count", {{"()", 1.0}}),
        q(100403, "Concentration",
          {{"kg/m^3", 1.0}, {"g/m^3", 0.001}, {"mg/l", 0.001}, {"g/l", 1.0}}),
        q(100407, "Direction", {{"degree", 1.0}, {"radian", 57.29577951308232}}),
        q(100424, "Transition rate", {{"1/s", 1.0}, {"1/day", 1.0 / 86400.0}}),
        q(100428, "Settling velocity coefficient", {{"()", 1.0}}),
        q(100429, "Erosion coefficient",
          {{"kg/m^2/s", 1.0}, {"g/m^2/s", 0.001}, {"kg/m^2/day", 1.0 / 86400.0}}),
        q(100504, "Mass flux", {{"kg/s", 1.0}, {"t/s", 1000.0}, {"t/h", 1000.0 / 3600.0}}),
        q(100505, "Spill rate", {{"kg/s", 1.0}, {"t/s", 1000.0}, {"t/h", 1000.0 / 3600.0}}),
    };
}

const std::vector<QuantityInfo>& Table() {
    static const std::vector<QuantityInfo> table = BuildTable();
    return table;
}

std::map<long, int>& UserUnits() {
    static std::map<long, int> chosen;
    return chosen;
}

const UnitInfo* FindUnit(int id, const QuantityInfo** owner = nullptr) {
    for (const QuantityInfo& q : Table())
        for (const UnitInfo& u : q.units)
            if (u.id == id) {
                if (owner)
                    *owner = &q;
                return &u;
            }
    return nullptr;
}

}  // namespace

const std::vector<QuantityInfo>& CUnitUtil::Quantities() { return Table(); }

const QuantityInfo* CUnitUtil::FindQuantity(long type) {
    for (const QuantityInfo& q : Table())
        if (q.code == type)
            return &q;
    return nullptr;
}

int CUnitUtil::GetFirstRegisteredUnit(long type) {
    const QuantityInfo* q = FindQuantity(type);
    return q ? q->units.front().id : 0;
}

int CUnitUtil::GetUserUnit(long type) {
    auto it = UserUnits().find(type);
    return it != UserUnits().end() ? it->second : GetFirstRegisteredUnit(type);
}

bool CUnitUtil::SetUserUnit(long type, int unit) {
    const QuantityInfo* q = FindQuantity(type);
    if (!q)
        return false;
    for (const UnitInfo& u : q->units)
        if (u.id == unit) {
            UserUnits()[type] = unit;
            return true;
        }
    return false;
}

void CUnitUtil::ResetUserUnits() { UserUnits().clear(); }

CString CUnitUtil::GetUnitName(int unit) {
    const UnitInfo* u = FindUnit(unit);
    return u ? u->name : "";
}

CString CUnitUtil::GetItemToolTip(long type) {
    const QuantityInfo* q = FindQuantity(type);
    if (!q)
        return "";
    const CString unit = GetUnitName(GetUserUnit(type));
    return unit.empty() ? CString(q->name) : CString(q->name) + " [" + unit + "]";
}

CZoUnitConverter::CZoUnitConverter(int from, int to) {
    const QuantityInfo* qFrom = nullptr;
    const QuantityInfo* qTo = nullptr;
    const UnitInfo* uFrom = FindUnit(from, &qFrom);
    const UnitInfo* uTo = FindUnit(to, &qTo);
    if (!uFrom || !uTo || from == to || qFrom != qTo)
        return;
    m_factor = uFrom->toBase / uTo->toBase;
}

double ToUserUnit(long type, double stored) {
    return CZoUnitConverter(CUnitUtil::GetFirstRegisteredUnit(type), CUnitUtil::GetUserUnit(type))
        .Convert(stored);
}

double FromUserUnit(long type, double shown) {
    return CZoUnitConverter(CUnitUtil::GetUserUnit(type), CUnitUtil::GetFirstRegisteredUnit(type))
        .Convert(shown);
}
