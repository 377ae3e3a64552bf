#include "ForcingsWaveDBAxisKiv.h"

#include "setupeditor/KivFields.h"

#include <cmath>

namespace {
constexpr unsigned kMsgValuesOutOfRange = 4127;

const CForcingsWaveDBAxisKiv::Layout kWindSpeed = {
    "Waves Database Wind Speed", "WIND_SPEED", "starting_value_of_wind_speed",
    "increment_value_of_wind_speed", "number_of_wind_speeds", 5.0, 5.0, 1, false, false, 100274, "wind speed"};
const CForcingsWaveDBAxisKiv::Layout kWindDirection = {
    "Waves Database Wind Direction", "WIND_DIRECTION", "starting_value_of_wind_direction",
    "increment_value_of_wind_direction", "number_of_wind_directions", 90.0, 90.0, 1, false, true, 100003, "wind direction"};
const CForcingsWaveDBAxisKiv::Layout kWaterLevel = {
    "Waves Database Water Level", "WATER_LEVEL", "starting_value_of_water_level",
    "increment_value_of_water_level", "number_of_water_levels", 0.0, 1.0, 1, true, true, 100000, "water level"};
}  // namespace

CForcingsWaveDBAxisKiv::CForcingsWaveDBAxisKiv(const Layout& layout, CZoSEKivBase* parent)
    : CZoSEKivBase(layout.title, layout.section, parent), m_layout(layout) {
    SetDefault();
}

int CForcingsWaveDBAxisKiv::EffectiveCount() const {
    if (m_count < 0)
        return 0;
    if (m_increment == 0.0 && m_count >= 1)
        return 1;
    return m_count;
}

bool CForcingsWaveDBAxisKiv::IsValid() const {
    // Not-a-number and infinite values fail every test.
    if (!std::isfinite(m_start) || !std::isfinite(m_increment) || m_count < 0)
        return false;
    if (!m_layout.startMayBeNegative && m_start < 0.0)
        return false;
    return m_layout.incrementMayBeZero ? m_increment >= 0.0 : m_increment > 0.0;
}

// The keywords are the axis's own, so the table is made for it.
struct CForcingsWaveDBAxisKiv::FieldTable {
    KivField<CForcingsWaveDBAxisKiv> fields[3];
};

CForcingsWaveDBAxisKiv::FieldTable CForcingsWaveDBAxisKiv::Fields() const {
    using F = KivField<CForcingsWaveDBAxisKiv>;
    using K = CForcingsWaveDBAxisKiv;
    return {{F::DoubleAsFloat(m_layout.startKeyword, &K::m_start, m_layout.start),
             F::DoubleAsFloat(m_layout.incrementKeyword, &K::m_increment, m_layout.increment),
             F::Int(m_layout.countKeyword, &K::m_count, m_layout.count)}};
}

void CForcingsWaveDBAxisKiv::WriteData(void* h) { WriteFields(h, *this, Fields().fields); }
void CForcingsWaveDBAxisKiv::ReadData(void* h) { ReadFields(h, *this, Fields().fields); }

int CForcingsWaveDBAxisKiv::ValidateData() {
    if (IsValid())
        return 1;
    AddError(kMsgValuesOutOfRange);
    return 0;
}

void CForcingsWaveDBAxisKiv::SetDefault() { DefaultFields(*this, Fields().fields); }

CForcingsWaveDBWindSpeedKiv::CForcingsWaveDBWindSpeedKiv(CZoSEKivBase* parent)
    : CForcingsWaveDBAxisKiv(kWindSpeed, parent) {}
CForcingsWaveDBWindDirectionKiv::CForcingsWaveDBWindDirectionKiv(CZoSEKivBase* parent)
    : CForcingsWaveDBAxisKiv(kWindDirection, parent) {}
CForcingsWaveDBWaterLevelKiv::CForcingsWaveDBWaterLevelKiv(CZoSEKivBase* parent)
    : CForcingsWaveDBAxisKiv(kWaterLevel, parent) {}

void CForcingsWaveDBAxisKiv::DescribeKeywords(KeywordSink& sink) {
    // The table gives types and defaults; the axis adds its quantity and the ranges that
    // IsValid checks.
    KeywordSink fields;
    fields.Begin(sink.Path(), sink.Outer());
    DescribeFields(fields, Fields().fields);
    const std::string what = m_layout.quantity;
    const char* ranges[] = {m_layout.startMayBeNegative ? "" : ">= 0",
                            m_layout.incrementMayBeZero ? ">= 0" : "> 0", ">= 0"};
    const std::string texts[] = {"First " + what + " of the database",
                                 "Step between the " + what + "s of the database",
                                 "Number of " + what + "s in the database"};
    for (size_t i = 0; i < fields.Entries().size(); ++i) {
        KeywordEntry e = fields.Entries()[i];
        e.unitType = i < 2 ? m_layout.unitType : 0;
        e.range = ranges[i];
        e.description = texts[i];
        sink.Add(std::move(e));
    }
}
