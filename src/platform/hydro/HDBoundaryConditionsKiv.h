#pragma once

#include "setupeditor/ZoSEKivListBase.h"

// The flow model's boundary conditions as the other modules see them ("BoundaryConditions"):
// one item per mesh boundary, titled like the boundary. It follows the boundary list and
// stores nothing of its own.
class CHDBoundaryConditionItemKiv : public CZoSEKivBase {
public:
    explicit CHDBoundaryConditionItemKiv(CZoSEKivBase* parent) : CZoSEKivBase("", "", parent) {}
    // The name of the boundary with the same number, asked for at every call.
    CString GetTitle() const override;
};

class CHDBoundaryConditionsKiv : public CZoSEKivListBase<CHDBoundaryConditionItemKiv> {
public:
    explicit CHDBoundaryConditionsKiv(CZoSEKivBase* parent);
    ~CHDBoundaryConditionsKiv() override;
};
