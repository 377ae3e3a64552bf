#include "SimulationPeriodKiv.h"

#include "datafile/ZoFileSelector.h"
#include "setupeditor/KivFields.h"

#include <cmath>

struct PeriodFields {
    using F = KivField<CSimulationPeriodKiv>;
    using K = CSimulationPeriodKiv;
    static inline const F kFields[] = {
        F::String("start_time", &K::m_start, "2000-01-01 00:00:00").Doc("Start of the simulation (yyyy-MM-dd HH:mm:ss)"),
        F::Int("number_of_time_steps", &K::m_timeSteps, 0).Range(">= 0").Doc("Number of time steps of the simulation"),
        F::Double("time_step_interval", &K::m_interval, 30.0).Unit(100290).Range("> 0").Doc("Length of a time step"),
    };
};

CSimulationPeriodKiv::CSimulationPeriodKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Simulation Period", "SIMULATION_PERIOD", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, "Period");
}

CSimulationPeriodKiv::~CSimulationPeriodKiv() { GetRoot()->UnregisterImportantNode("Period"); }

void CSimulationPeriodKiv::WriteData(void* h) { WriteFields(h, *this, PeriodFields::kFields); }
void CSimulationPeriodKiv::ReadData(void* h) { ReadFields(h, *this, PeriodFields::kFields); }
void CSimulationPeriodKiv::SetDefault() { DefaultFields(*this, PeriodFields::kFields); }

int CSimulationPeriodKiv::ValidateData() {
    if (m_timeSteps < 0 || !(m_interval > 0)) {
        AddError("The simulation period needs a non-negative number of time steps and a "
                 "positive time step interval");
        return 0;
    }
    if (!StartSeconds()) {
        AddError("The start of the simulation period \"" + m_start +
                 "\" is not a date and time (yyyy-MM-dd HH:mm:ss)");
        return 0;
    }
    return 1;
}

std::optional<std::int64_t> CSimulationPeriodKiv::StartSeconds() const {
    return datafile::ParseDateTime(m_start);
}

void CSimulationPeriodKiv::SetUpQrdValidation_SimulationPeriod(CZoFileSelector& selector) const {
    const auto start = StartSeconds();
    if (!start || m_timeSteps < 0 || !(m_interval > 0) || !std::isfinite(m_interval))
        return;
    selector.SetTimeValidation(*start, m_timeSteps, m_interval);
}

CSimulationPeriodKiv* SimulationPeriod(const CZoSEKivBase* node) {
    return GetImportant<CSimulationPeriodKiv>(node, "Period");
}

void CSimulationPeriodKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, PeriodFields::kFields); }
