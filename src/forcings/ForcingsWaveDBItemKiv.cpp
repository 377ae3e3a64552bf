#include "ForcingsWaveDBItemKiv.h"

#include "ForcingsWaveDBFile.h"

CForcingsWaveDBItemKiv::CForcingsWaveDBItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Wave Database Item %d", "", parent), m_file(new CForcingsWaveDBFile(this)) {
    AddChild(m_file);
}

void CForcingsWaveDBItemKiv::SetDefault() { m_file->SetDefault(); }
