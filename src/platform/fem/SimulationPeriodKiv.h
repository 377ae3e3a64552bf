#pragma once

#include "setupeditor/ZoSEKivBase.h"

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

    void WriteData(void* h) override;
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
