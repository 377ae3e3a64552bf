// The model definition: the numbers of fractions and bed layers that shape the module.
#pragma once

#include "fem/FemNotifier.h"
#include "setupeditor/ZoSEKivBase.h"

// Sent after the number of fractions / of layers was set (or read).
constexpr ENotifyMessage kNotifyFractions = 1;
constexpr ENotifyMessage kNotifyLayers = 2;

// Counts read from a file beyond this are refused: every list follows them, and lists of
// lists (layers × fractions) would grow with their product.
constexpr int kMaxModelCount = 100;

class CParameterSelectionKiv : public CZoSEKivBase, public CFemNotifier {
public:
    explicit CParameterSelectionKiv(CZoSEKivBase* parent);
    ~CParameterSelectionKiv() override;

    int NumberOfFractions() const { return m_fractions; }
    void NumberOfFractions(int n);
    int NumberOfLayers() const { return m_layers; }
    void NumberOfLayers(int n);

    void Save(void* h) override;
    void Load(void* h) override;
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    int m_fractions = 1;
    int m_layers = 1;
};

// The model definition of the document that node belongs to.
CParameterSelectionKiv* ModelDefinition(const CZoSEKivBase* node);
