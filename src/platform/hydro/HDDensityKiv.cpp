#include "HDDensityKiv.h"

#include "paramfile/Kiv.h"

CHDDensityKiv::CHDDensityKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Density", "HYDRODYNAMIC_DENSITY", parent) {
    GetRoot()->RegisterImportantNode(this, "HDDensity");
}

CHDDensityKiv::~CHDDensityKiv() { GetRoot()->UnregisterImportantNode("HDDensity"); }

void CHDDensityKiv::WriteData(void* h) { kivPutParam(h, "density_mode", m_mode); }
void CHDDensityKiv::ReadData(void* h) { kivGetParam(h, "density_mode", &m_mode, 1, 1); }

CHDDensityKiv* HDDensity(const CZoSEKivBase* node) {
    return GetImportant<CHDDensityKiv>(node, "HDDensity");
}
