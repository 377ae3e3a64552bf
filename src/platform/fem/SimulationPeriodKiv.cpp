#include "SimulationPeriodKiv.h"

#include "setupeditor/KivFields.h"

struct PeriodFields {
    using F = KivField<CSimulationPeriodKiv>;
    using K = CSimulationPeriodKiv;
    static inline const F kFields[] = {
        F::String("start_time", &K::m_start, "2000-01-01 00:00:00"),
        F::Int("number_of_time_steps", &K::m_timeSteps, 0),
        F::Double("time_step_interval", &K::m_interval, 30.0),
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
    return 1;
}

CSimulationPeriodKiv* SimulationPeriod(const CZoSEKivBase* node) {
    return GetImportant<CSimulationPeriodKiv>(node, "Period");
}
