#pragma once

#include "MTDredgingItemsKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

// DREDGING: the dredgers of the setup, and whether dredging updates the bed.
class CMTDredgingKiv : public CZoSEKivListBase<CMTDredgingItemsKiv> {
public:
    explicit CMTDredgingKiv(CZoSEKivBase* parent);
    ~CMTDredgingKiv() override;

    bool UpdateBed() const { return m_updateBed; }
    void UpdateBed(bool update) { m_updateBed = update; }

    void WriteData(void* h) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    void SetDefault() override { m_updateBed = true; }
    const char* GetDlgRuntimeClass(unsigned code) override;

protected:
    const char* CountKeyword() const override { return "number_of_dredgers"; }

private:
    bool m_updateBed = true;
};
