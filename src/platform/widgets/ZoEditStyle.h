// How a number field shows and accepts its value: the quantity's unit group (the field shows
// the user's unit of the group and stores the internal one), the display format and the range.
#pragma once

#include "common/Platform.h"

#include <QString>

enum class ZoNumberKind { Double, Float, Int };

class CZoEditStyle {
public:
    // The quantity's unit group (100403 concentrations, 100017 density...); 0 for none.
    CZoEditStyle& SetOvuUnitBaseGroup(long group);
    long GetOvuUnitBaseGroup() const { return m_group; }
    // A printf format of one floating conversion ("%.3f", "%.11g"); empty shows the shortest
    // text that reads back to the same value. Formats of another shape are ignored.
    CZoEditStyle& SetFormat(const CString& format);
    const CString& GetFormat() const { return m_format; }
    // Accepted values, inclusive, in the internal unit.
    CZoEditStyle& SetRange(double minimum, double maximum);
    CZoEditStyle& SetMinimum(double minimum);
    CZoEditStyle& SetMaximum(double maximum);
    // For a value saved as a float: the range is narrowed to what a float holds, so that a
    // number beyond it is refused rather than saved as an infinity.
    CZoEditStyle& SetFloatRange();
    bool HasMinimum() const { return m_hasMin; }
    bool HasMaximum() const { return m_hasMax; }
    double Minimum() const { return m_min; }
    double Maximum() const { return m_max; }

    // Internal unit <-> the unit shown to the user.
    double ToShown(double internal) const;
    double ToInternal(double shown) const;
    // The user's unit ("mm/s"); empty without a unit group.
    CString UnitName() const;
    // The quantity with its user unit ("Settling velocity [mm/s]"); empty without a group.
    CString ToolTip() const;

    // The text a field shows for a value held in the internal unit.
    QString Format(double internal, ZoNumberKind kind) const;
    // Reads a field's text into the internal unit. False with the message for the user when
    // the text is not a number of the kind or lies outside the range.
    bool Parse(const QString& text, ZoNumberKind kind, double& internal, QString& message) const;

private:
    long m_group = 0;
    CString m_format;
    bool m_hasMin = false;
    bool m_hasMax = false;
    double m_min = 0.0;
    double m_max = 0.0;
};

// The shortest text that reads back to the same double (or float).
QString ZoShortestText(double value);
QString ZoShortestText(float value);
