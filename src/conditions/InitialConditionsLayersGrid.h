#pragma once

#include "InitialConditionsFractionsGrid.h"

class CInitialConditionsLayersGrid
    : public CInitialConditionsValueGrid<CInitialConditionsLayersItemKiv> {
public:
    explicit CInitialConditionsLayersGrid(QWidget* parent = nullptr)
        : CInitialConditionsValueGrid("Layer", parent) {
        setObjectName("layersGrid");
    }
};
