#pragma once

#include "setupeditor/ZoSEKivBase.h"

// One axis of the wave database: a regular series of start, increment and number of values.
// The three axes differ in their names, defaults and what they accept.
class CForcingsWaveDBAxisKiv : public CZoSEKivBase {
public:
    struct Layout {
        const char* title;
        const char* section;
        const char* startKeyword;
        const char* incrementKeyword;
        const char* countKeyword;
        double start;
        double increment;
        int count;
        bool startMayBeNegative;
        bool incrementMayBeZero;
        long unitType;
        const char* quantity;  // "wind speed"
    };

    CForcingsWaveDBAxisKiv(const Layout& layout, CZoSEKivBase* parent);

    double Start() const { return m_start; }
    void Start(double v) { m_start = v; }
    double Increment() const { return m_increment; }
    void Increment(double v) { m_increment = v; }
    int Count() const { return m_count; }
    void Count(int n) { m_count = n; }

    // The number of values the axis spans: a zero increment collapses it to one value, a
    // negative count to none.
    int EffectiveCount() const;
    // The value at a 0-based index.
    double Value(int index) const { return m_start + index * m_increment; }
    // Whether start, increment and count lie in what the axis accepts.
    bool IsValid() const;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    // "Values out of range" when IsValid fails.
    int ValidateData() override;
    bool IsDlgUsedInSetup() override { return true; }
    void SetDefault() override;

private:
    struct FieldTable;
    FieldTable Fields() const;

    const Layout& m_layout;
    double m_start = 0.0;
    double m_increment = 0.0;
    int m_count = 0;
};

class CForcingsWaveDBWindSpeedKiv : public CForcingsWaveDBAxisKiv {
public:
    explicit CForcingsWaveDBWindSpeedKiv(CZoSEKivBase* parent);
};

class CForcingsWaveDBWindDirectionKiv : public CForcingsWaveDBAxisKiv {
public:
    explicit CForcingsWaveDBWindDirectionKiv(CZoSEKivBase* parent);
};

class CForcingsWaveDBWaterLevelKiv : public CForcingsWaveDBAxisKiv {
public:
    explicit CForcingsWaveDBWaterLevelKiv(CZoSEKivBase* parent);
};
