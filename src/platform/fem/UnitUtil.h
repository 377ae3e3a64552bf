// The unit system: each quantity (unit type or unit group code) is stored in its first
// registered unit and shown in the unit the user chose for it.
#pragma once

#include "common/Platform.h"

#include <vector>

struct UnitInfo {
    int id;             // unique unit code
    const char* name;   // "m/s"
    double toBase;      // value in this unit × toBase = value in the quantity's base unit
};

struct QuantityInfo {
    long code;                  // unit type / unit group code
    const char* name;           // "Settling velocity"
    std::vector<UnitInfo> units;  // the first is the first registered unit
};

class CUnitUtil {
public:
    static int GetFirstRegisteredUnit(long type);
    static int GetUserUnit(long type);
    // Chooses the unit shown for a quantity; false when the unit does not belong to it.
    static bool SetUserUnit(long type, int unit);
    static void ResetUserUnits();
    static CString GetItemToolTip(long type);  // "Settling velocity [m/s]"
    static CString GetUnitName(int unit);
    static const QuantityInfo* FindQuantity(long type);  // null for unknown codes
    static const std::vector<QuantityInfo>& Quantities();
};

// value × factor + offset converts from one unit to another; unknown or unrelated units
// convert as identity.
class CZoUnitConverter {
public:
    CZoUnitConverter(int from, int to);
    double Convert(double value) const { return value * m_factor + m_offset; }
    double Factor() const { return m_factor; }
    double Offset() const { return m_offset; }

private:
    double m_factor = 1.0;
    double m_offset = 0.0;
};

// Shorthands for the common case of stored (first registered) <-> shown (user) units.
double ToUserUnit(long type, double stored);
double FromUserUnit(long type, double shown);
