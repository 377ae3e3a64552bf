// The outputs of the module: the result files the simulation writes.
#pragma once

#include "MTOutputItemMainKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

class CMTOutputKiv : public CZoSEKivListBase<CMTOutputItemMainKiv> {
public:
    explicit CMTOutputKiv(CZoSEKivBase* parent);
    ~CMTOutputKiv() override;

    // Outputs still under their placeholder title ("OUTPUTXXX...") are named "Output n"
    // after their position; true when any was.
    bool NameNewOutputs();

    void WriteData(void* h) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;

protected:
    const char* CountKeyword() const override { return "number_of_outputs"; }
};
