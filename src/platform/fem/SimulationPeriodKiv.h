#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <cstdint>
#include <optional>

class CZoFileSelector;

// The simulation period ("Period").
class CSimulationPeriodKiv : public CZoSEKivBase {
public:
    explicit CSimulationPeriodKiv(CZoSEKivBase* parent);
    ~CSimulationPeriodKiv() override;

    int TimeStepCount() const { return m_timeSteps; }
    void TimeStepCount(int n) { m_timeSteps = n; }
    double TimeStepInterval() const { return m_interval; }
    void TimeStepInterval(double seconds) { m_interval = seconds; }
    const CString& StartTime() const { return m_start; }
    void StartTime(const CString& start) { m_start = start; }

    // The start as seconds since 1970-01-01 00:00:00 UTC; none when it is not a date and time.
    std::optional<std::int64_t> StartSeconds() const;
    // Data files checked by the selector must cover the period: from the start over the
    // number of time steps of the interval. A period without a valid start or interval sets
    // nothing (its own validation reports it).
    void SetUpQrdValidation_SimulationPeriod(CZoFileSelector& selector) const;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override;

private:
    friend struct PeriodFields;
    int m_timeSteps = 0;
    double m_interval = 0;
    CString m_start;
};

CSimulationPeriodKiv* SimulationPeriod(const CZoSEKivBase* node);
