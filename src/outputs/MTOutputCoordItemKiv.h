// One row of the coordinate table that the output pages edit: a point, a corner or an end
// of a line. Not stored in the setup.
#pragma once

#include "setupeditor/ZoSEKivBase.h"

class CMTOutputCoordItemKiv : public CZoSEKivBase {
public:
    explicit CMTOutputCoordItemKiv(CZoSEKivBase* parent);

    double X() const { return m_x; }
    void X(double v) { m_x = v; }
    double Y() const { return m_y; }
    void Y(double v) { m_y = v; }
    double Z() const { return m_z; }
    void Z(double v) { m_z = v; }
    int Layer() const { return m_layer; }
    void Layer(int v) { m_layer = v; }
    const CString& Name() const { return m_name; }
    void Name(const CString& v) { m_name = v; }

private:
    double m_x = 0, m_y = 0, m_z = 0;
    int m_layer = 1;
    CString m_name;
};
