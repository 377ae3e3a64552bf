// INITIAL_CONDITIONS: the state at the start: the suspended concentration of every fraction,
// the thickness of every bed layer and, per layer, its sediment's shares of the fractions.
#pragma once

#include "core/MTCountListKiv.h"
#include "core/MTGroupKiv.h"
#include "fem/FemInDataKiv.h"

// The initial concentration of one fraction ("SSC_FRACTION_%d").
class CInitialConditionsFractionsItemKiv : public CZoSEKivBase {
public:
    explicit CInitialConditionsFractionsItemKiv(CZoSEKivBase* parent);
    CFemInDataKiv* Value() const { return m_value; }
    int ValidateData() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override { m_value->SetDefault(); }

private:
    CFemInDataKiv* m_value;
};

// The initial thickness of one bed layer ("BED_THICKNESS_LAYER_%d").
class CInitialConditionsLayersItemKiv : public CZoSEKivBase {
public:
    explicit CInitialConditionsLayersItemKiv(CZoSEKivBase* parent);
    CFemInDataKiv* Value() const { return m_value; }
    int ValidateData() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override { m_value->SetDefault(); }

private:
    CFemInDataKiv* m_value;
};

// The share of one fraction in one layer, in percent ("BED_DISTRIBUTION_FRACTION_%d").
class CInitialConditionsFractionDistributionItemElementKiv : public CZoSEKivBase {
public:
    explicit CInitialConditionsFractionDistributionItemElementKiv(CZoSEKivBase* parent);

    float ConstantValue() const { return m_constant; }
    void ConstantValue(float value) { m_constant = value; }
    const CString& FileName() const { return m_fileName; }
    void FileName(const CString& name) { m_fileName = name; }
    int ItemNumber() const { return m_itemNumber; }
    void ItemNumber(int n) { m_itemNumber = n; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;

private:
    friend struct DistributionElementFields;
    float m_constant = 0.0f;
    CString m_fileName;
    int m_itemNumber = 1;
};

// How one layer's sediment is shared out among the fractions ("BED_DISTRIBUTION_LAYER_%d");
// its shares must add up to 100.
class CInitialConditionsFractionDistributionItemKiv
    : public CMTCountListKiv<CInitialConditionsFractionDistributionItemElementKiv> {
public:
    explicit CInitialConditionsFractionDistributionItemKiv(CZoSEKivBase* parent);

    int Format() const { return m_format; }
    void Format(int format) { m_format = format; }
    // The shares in element order, as the file holds them.
    float Share(int fraction) const;

    // A new number of fractions shares the layer out evenly again: 100 div k each, the last
    // taking what is left, so that the shares add up to exactly 100.
    void SetItemCount(int count, int level) override;
    void LoadSize(void* h) override;
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;

private:
    void EvenSplit();
    int m_format = 0;
};

class CInitialConditionsFractionsKiv : public CMTCountListKiv<CInitialConditionsFractionsItemKiv> {
public:
    explicit CInitialConditionsFractionsKiv(CZoSEKivBase* parent);
    const char* GetDlgRuntimeClass(unsigned code) override;
};

class CInitialConditionsLayersKiv : public CMTCountListKiv<CInitialConditionsLayersItemKiv> {
public:
    explicit CInitialConditionsLayersKiv(CZoSEKivBase* parent);
    const char* GetDlgRuntimeClass(unsigned code) override;
};

class CInitialConditionsFractionDistributionKiv
    : public CMTCountListKiv<CInitialConditionsFractionDistributionItemKiv> {
public:
    explicit CInitialConditionsFractionDistributionKiv(CZoSEKivBase* parent);
    const char* GetDlgRuntimeClass(unsigned code) override;
};

class CInitialConditionsKiv : public CMTGroupKiv {
public:
    explicit CInitialConditionsKiv(CZoSEKivBase* parent);
    ~CInitialConditionsKiv() override;

    CInitialConditionsFractionsKiv* Fractions() const { return m_fractions; }
    CInitialConditionsLayersKiv* Layers() const { return m_layers; }
    CInitialConditionsFractionDistributionKiv* FractionDistribution() const {
        return m_distribution;
    }

private:
    CInitialConditionsFractionsKiv* m_fractions;
    CInitialConditionsLayersKiv* m_layers;
    CInitialConditionsFractionDistributionKiv* m_distribution;
};

CInitialConditionsKiv* InitialConditions(const CZoSEKivBase* node);
