// The quantities of a mass-budget output: the SSC of each fraction.
#pragma once

#include "fem/FemNotifier.h"
#include "fem/OutputItemsKiv.h"

class CMTOutputItemSubMassbudgetKiv : public COutputItemsKiv, public CFemListener {
public:
    explicit CMTOutputItemSubMassbudgetKiv(CZoSEKivBase* parent);

    void Rebuild();

    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void Notify(CFemNotifier* notifier, ENotifyMessage message) override;
};
