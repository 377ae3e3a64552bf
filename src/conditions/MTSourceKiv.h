// SOURCES: the sediment that every point source of the flow model brings in, one item per
// hydrodynamic source ("HDSources"), in its order, each with one component per fraction.
#pragma once

#include "MTSpareItems.h"
#include "core/MTCountListKiv.h"
#include "fem/FemHelpListBase.h"
#include "fem/FemInDataKiv.h"

class CHDSourceItemKiv;

// What one source brings of one fraction ("SSC_FRACTION_%d").
class CMTSourceItemSubKiv : public CZoSEKivGroupBase {
public:
    enum ComponentType { kSpecifiedConcentration = 0, kExcessConcentration = 1 };

    explicit CMTSourceItemSubKiv(CZoSEKivBase* parent);

    int TypeOfComponent() const { return m_type; }
    void TypeOfComponent(int type) { m_type = type; }
    CFemInDataKiv* Value() const { return m_value; }
    static CString TypeText(int type);

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;
    // As it was made for the given place among its source's components.
    void Renew(int number);

private:
    int m_type = kSpecifiedConcentration;
    CFemInDataKiv* m_value;
};

// One source ("SOURCE_%d"): named, and in use, as the hydrodynamic source at its place.
class CMTSourceItemKiv : public CMTCountListKiv<CMTSourceItemSubKiv> {
public:
    explicit CMTSourceItemKiv(CZoSEKivBase* parent);

    // The hydrodynamic source with this item's number; null when there is none.
    const CHDSourceItemKiv* HDSource() const;

    CString GetTitle() const override;
    bool IsDlgUsedInSetup() override;
    CMTSourceItemSubKiv* Create() override;
    void LoadSize(void* h) override;
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;

protected:
    void DiscardItem(CMTSourceItemSubKiv* item) override { m_spares.Keep(item); }

private:
    CMTSpareItems<CMTSourceItemSubKiv> m_spares;
};

class CMTSourceKiv : public CZoSEKivListBase<CMTSourceItemKiv>, public CFemHelpListBase {
public:
    explicit CMTSourceKiv(CZoSEKivBase* parent);
    ~CMTSourceKiv() override;

    void LoadSize(void* h) override;
    int ValidateData() override { return 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;
};

CMTSourceKiv* MTSources(const CZoSEKivBase* node);
