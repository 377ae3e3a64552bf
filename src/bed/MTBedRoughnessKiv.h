#pragma once

#include "fem/FemInDataKiv.h"

// ROUGHNESS: the roughness of the bed, a constant or a data file.
class CMTBedRoughnessKiv : public CZoSEKivBase {
public:
    explicit CMTBedRoughnessKiv(CZoSEKivBase* parent);

    // Its keywords go straight into ROUGHNESS.
    CFemInDataKiv* Roughness() const { return m_roughness; }

    // The constant must not be negative, whichever format is selected.
    int ValidateData() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    CFemInDataKiv* m_roughness;
};
