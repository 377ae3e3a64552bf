// SAND_FRACTIONS: which suspended fractions are sand, and their mean settling velocity.
#pragma once

#include "core/MTCountListKiv.h"

class CMTSandFractionItemKiv : public CZoSEKivBase {
public:
    explicit CMTSandFractionItemKiv(CZoSEKivBase* parent);

    bool IncludeSand() const { return m_includeSand; }
    void IncludeSand(bool include) { m_includeSand = include; }
    // In the user's unit of settling velocities (what the grid shows and takes).
    double MeanSettlingVelocity() const;
    void MeanSettlingVelocity(double shown);
    // In the file's unit: the value is held in it, so a change of the user's unit while a
    // setup is open changes only what is shown.
    double StoredMeanSettlingVelocity() const { return m_meanSettlingVelocity; }
    void StoredMeanSettlingVelocity(double stored) { m_meanSettlingVelocity = stored; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    // Items are edited in the list's grid.
    bool IsDlgUsedInSetup() override { return false; }
    void SetDefault() override;

private:
    friend struct SandFractionItemFields;
    bool m_includeSand = true;
    double m_meanSettlingVelocity = 0.0;
};

class CMTSandFractionListKiv : public CMTCountListKiv<CMTSandFractionItemKiv> {
public:
    explicit CMTSandFractionListKiv(CZoSEKivBase* parent);
    ~CMTSandFractionListKiv() override;

    bool IncludeSandFractions() const { return m_includeSandFractions; }
    void IncludeSandFractions(bool include) { m_includeSandFractions = include; }
    // Fraction (1-based) is treated as sand: the switch is on and its item is marked.
    bool IsSand(int fraction) const;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return GetItemCount() >= 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct SandFractionListFields;
    bool m_includeSandFractions = false;
};

// The sand-fraction list of the document node belongs to, or null.
CMTSandFractionListKiv* SandFractions(const CZoSEKivBase* node);
