// The quantities of a discharge output: the four discharges, always selected, and the SSC of
// each fraction; and whether the basic or the extended discharge is written.
#pragma once

#include "fem/FemNotifier.h"
#include "fem/OutputItemsKiv.h"

class CMTOutputItemMainKiv;

class CMTOutputItemSubDischargeKiv : public COutputItemsKiv, public CFemListener {
public:
    explicit CMTOutputItemSubDischargeKiv(CZoSEKivBase* parent);

    int Type() const { return m_type; }  // 1 basic, 2 extended
    void Type(int type) { m_type = type; }
    void Rebuild();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void Notify(CFemNotifier* notifier, ENotifyMessage message) override;
    void SetDefault() override { m_type = 1; }

private:
    int m_type = 1;
};
