#pragma once

#include "fem/FemKivGroupBase.h"

// The module's root: MUD_TRANSPORT_MODULE with the whole section tree below it. It stores
// only the module mode, which lives in the host's "ModuleSelection" node.
class CMudTransportModuleKiv : public CFemKivGroupBase {
public:
    explicit CMudTransportModuleKiv(CZoSEKivBase* parent);
    ~CMudTransportModuleKiv() override;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override;  // the module is in use when its mode is 2
    const char* GetDlgRuntimeClass(unsigned code) override;
};
