#pragma once

#include "setupeditor/ZoSEKivBase.h"

// The host's choice of modules in use ("ModuleSelection"): the mud-transport mode (2 in
// use) and the modes of the other modules the mud-transport module asks about.
class CModuleSelection : public CZoSEKivBase {
public:
    explicit CModuleSelection(CZoSEKivBase* parent);
    ~CModuleSelection() override;

    int Mode() const { return m_mudTransportMode; }
    void Mode(int mode) { m_mudTransportMode = mode; }
    int SpectralWaveMode() const { return m_spectralWaveMode; }
    void SpectralWaveMode(int mode) { m_spectralWaveMode = mode; }
    // The flow is read from stored results instead of computed (the document's flag).
    bool DecoupledSimulation() const { return m_decoupled; }
    void DecoupledSimulation(bool decoupled) { m_decoupled = decoupled; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    void SetDefault() override;

private:
    friend struct ModuleSelectionFields;
    int m_mudTransportMode = 0;
    int m_spectralWaveMode = 0;
    bool m_decoupled = false;
};

CModuleSelection* ModuleSelection(const CZoSEKivBase* node);
