#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <vector>

// The wind forcing of the flow model ("FemInDataWind"): whether wind is included and how
// it is given (0 constant, 1 varying in time, 2 varying in time and over the domain).
class CHDWindForcingKiv : public CZoSEKivBase {
public:
    explicit CHDWindForcingKiv(CZoSEKivBase* parent);
    ~CHDWindForcingKiv() override;

    int Include() const { return m_include ? 1 : 0; }
    void Include(bool include) { m_include = include; }
    int WindType() const { return m_type; }
    void WindType(int type) { m_type = type; }
    // Display texts of the wind types, by value.
    static const std::vector<CString>& WindTypeTexts();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override;

private:
    friend struct WindFields;
    bool m_include = false;
    int m_type = 0;
};

CHDWindForcingKiv* WindForcing(const CZoSEKivBase* node);
