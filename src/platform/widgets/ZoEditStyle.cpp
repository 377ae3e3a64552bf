#include "ZoEditStyle.h"

#include "fem/UnitUtil.h"

#include <cctype>
#include <charconv>
#include <climits>
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <limits>
#include <string>

namespace {

// One floating conversion with flags, width and precision, and literal text around it:
// anything else could read arguments that are not there.
bool IsSafeFormat(const CString& f) {
    int conversions = 0;
    for (size_t i = 0; i < f.size(); ++i) {
        if (f[i] != '%')
            continue;
        if (i + 1 < f.size() && f[i + 1] == '%') {
            ++i;
            continue;
        }
        ++i;
        while (i < f.size() && std::string("-+ #0").find(f[i]) != std::string::npos)
            ++i;
        size_t digits = 0;
        while (i < f.size() && std::isdigit(static_cast<unsigned char>(f[i])))
            ++i, ++digits;
        if (digits > 2)
            return false;
        if (i < f.size() && f[i] == '.') {
            ++i;
            digits = 0;
            while (i < f.size() && std::isdigit(static_cast<unsigned char>(f[i])))
                ++i, ++digits;
            if (digits > 2)
                return false;
        }
        if (i >= f.size() || std::string("eEfgG").find(f[i]) == std::string::npos)
            return false;
        ++conversions;
    }
    return conversions == 1;
}

std::string Trimmed(const QString& text) {
    std::string s = text.trimmed().toStdString();
    if (!s.empty() && s[0] == '+')
        s.erase(0, 1);
    return s;
}

bool ParseDouble(const QString& text, double& out) {
    const std::string s = Trimmed(text);
    if (s.empty())
        return false;
    const char* end = s.data() + s.size();
    auto [ptr, ec] = std::from_chars(s.data(), end, out, std::chars_format::general);
    return ec == std::errc() && ptr == end && std::isfinite(out);
}

bool ParseInt(const QString& text, long long& out) {
    const std::string s = Trimmed(text);
    if (s.empty())
        return false;
    const char* end = s.data() + s.size();
    auto [ptr, ec] = std::from_chars(s.data(), end, out);
    return ec == std::errc() && ptr == end;
}

}  // namespace

QString ZoShortestText(double value) {
    char buf[64];
    auto [ptr, ec] = std::to_chars(buf, buf + sizeof buf, value);
    return ec == std::errc() ? QString::fromLatin1(buf, ptr - buf) : QString();
}

QString ZoShortestText(float value) {
    char buf[64];
    auto [ptr, ec] = std::to_chars(buf, buf + sizeof buf, value);
    return ec == std::errc() ? QString::fromLatin1(buf, ptr - buf) : QString();
}

CZoEditStyle& CZoEditStyle::SetOvuUnitBaseGroup(long group) {
    m_group = group;
    return *this;
}

CZoEditStyle& CZoEditStyle::SetFormat(const CString& format) {
    m_format = IsSafeFormat(format) ? format : CString();
    return *this;
}

CZoEditStyle& CZoEditStyle::SetRange(double minimum, double maximum) {
    SetMinimum(minimum);
    return SetMaximum(maximum);
}

CZoEditStyle& CZoEditStyle::SetFloatRange() {
    constexpr double kMax = std::numeric_limits<float>::max();
    SetMinimum(m_hasMin ? std::max(m_min, -kMax) : -kMax);
    return SetMaximum(m_hasMax ? std::min(m_max, kMax) : kMax);
}

CZoEditStyle& CZoEditStyle::SetMinimum(double minimum) {
    m_hasMin = true;
    m_min = minimum;
    return *this;
}

CZoEditStyle& CZoEditStyle::SetMaximum(double maximum) {
    m_hasMax = true;
    m_max = maximum;
    return *this;
}

double CZoEditStyle::ToShown(double internal) const {
    return m_group ? ToUserUnit(m_group, internal) : internal;
}

double CZoEditStyle::ToInternal(double shown) const {
    return m_group ? FromUserUnit(m_group, shown) : shown;
}

CString CZoEditStyle::UnitName() const {
    return m_group ? CUnitUtil::GetUnitName(CUnitUtil::GetUserUnit(m_group)) : CString();
}

CString CZoEditStyle::ToolTip() const { return m_group ? CUnitUtil::GetItemToolTip(m_group) : CString(); }

QString CZoEditStyle::Format(double internal, ZoNumberKind kind) const {
    if (kind == ZoNumberKind::Int)
        return QString::number(static_cast<long long>(std::llround(internal)));
    const double shown = ToShown(internal);
    if (!m_format.empty() && std::isfinite(shown)) {
        char buf[512];
        std::snprintf(buf, sizeof buf, m_format.c_str(), shown);
        return QString::fromUtf8(buf);
    }
    return kind == ZoNumberKind::Float ? ZoShortestText(static_cast<float>(shown))
                                       : ZoShortestText(shown);
}

bool CZoEditStyle::Parse(const QString& text, ZoNumberKind kind, double& internal,
                         QString& message) const {
    const bool isInt = kind == ZoNumberKind::Int;
    double value = 0.0;
    if (isInt) {
        long long n = 0;
        if (!ParseInt(text, n)) {
            message = QStringLiteral("Please enter an integer.");
            return false;
        }
        value = static_cast<double>(n);
    } else {
        double shown = 0.0;
        if (!ParseDouble(text, shown)) {
            message = QStringLiteral("Please enter a number.");
            return false;
        }
        value = ToInternal(shown);
        if (kind == ZoNumberKind::Float &&
            std::fabs(value) > static_cast<double>(std::numeric_limits<float>::max())) {
            message = QStringLiteral("Please enter a smaller number.");
            return false;
        }
    }
    // An integer field holds a 32-bit integer whatever its own range says.
    const bool hasMin = m_hasMin || isInt;
    const bool hasMax = m_hasMax || isInt;
    const double minimum = isInt ? std::max(m_hasMin ? m_min : INT_MIN, double(INT_MIN)) : m_min;
    const double maximum = isInt ? std::min(m_hasMax ? m_max : INT_MAX, double(INT_MAX)) : m_max;
    const bool low = hasMin && value < minimum;
    const bool high = hasMax && value > maximum;
    if (low || high) {
        // Bounds are shown as the user reads them: in the user's unit.
        auto bound = [&](double b) {
            return isInt ? QString::number(static_cast<long long>(std::llround(b)))
                         : ZoShortestText(ToShown(b));
        };
        const QString what = isInt ? QStringLiteral("an integer") : QStringLiteral("a number");
        const QString unit = isInt || UnitName().empty() || UnitName() == "()"
                                 ? QString()
                                 : " " + QString::fromStdString(UnitName());
        if (hasMin && hasMax)
            message = QStringLiteral("Please enter %1 between %2 and %3%4.")
                          .arg(what, bound(minimum), bound(maximum), unit);
        else if (hasMin)
            message = QStringLiteral("Please enter %1 of at least %2%3.").arg(what, bound(minimum), unit);
        else
            message = QStringLiteral("Please enter %1 of at most %2%3.").arg(what, bound(maximum), unit);
        return false;
    }
    internal = value;
    return true;
}
