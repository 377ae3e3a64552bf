#pragma once

// Anything that stands for one boundary of the mesh answers its mesh boundary code.
class CBoundaryBaseInterface {
public:
    virtual ~CBoundaryBaseInterface() = default;
    virtual int BoundaryCode() = 0;
};
