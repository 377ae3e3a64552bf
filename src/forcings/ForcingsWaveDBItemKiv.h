#pragma once

#include "setupeditor/ZoSEKivBase.h"

class CForcingsWaveDBFile;

// One point of the wave database (a wind speed, direction and water level) with its file.
// Titled with the point's number, so that a message names the point it is about.
class CForcingsWaveDBItemKiv : public CZoSEKivBase {
public:
    explicit CForcingsWaveDBItemKiv(CZoSEKivBase* parent);
    CForcingsWaveDBFile* File() const { return m_file; }
    int ValidateData() override { return 1; }
    void SetDefault() override;

private:
    CForcingsWaveDBFile* m_file;
};
