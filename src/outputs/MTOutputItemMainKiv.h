// One output definition: the result file, the kind of result and its geometry (points, a
// line, a polygon with a layer range), the time steps and the quantities. Defaults come from
// the domain's mesh; the output follows the domain's changes of dimension and layers.
#pragma once

#include "fem/FemNotifier.h"
#include "setupeditor/ZoSEKivBase.h"

#include <vector>

class CMTOutputCoordListKiv;
class CMTOutputItemSub2DKiv;
class CMTOutputItemSub3DKiv;
class CMTOutputItemSubDischargeKiv;
class CMTOutputItemSubMassbudgetKiv;

struct MTOutputPoint {
    double x = 0, y = 0, z = 0;
    int layer = 1;
    CString name;
};

struct MTOutputLine {
    int npoints = 3;
    double xFirst = 0, yFirst = 0, zFirst = 0;
    double xLast = 0, yLast = 0, zLast = 0;
};

struct MTOutputCorner {
    double x = 0, y = 0;
};

// Counts of points read beyond this are refused (a corrupt count would exhaust memory).
constexpr int kMaxOutputPoints = 10000000;

class CMTOutputItemMainKiv : public CZoSEKivBase, public CFemListener {
public:
    // Values of type.
    enum { kType2D = 1, kType3D = 2, kTypeMassBudget = 3, kTypeDischarge = 4 };

    explicit CMTOutputItemMainKiv(CZoSEKivBase* parent);
    ~CMTOutputItemMainKiv() override;

    const CString& Title() const { return m_title; }
    void Title(const CString& t) { m_title = t; }
    const CString& FileName() const { return m_fileName; }
    void FileName(const CString& f) { m_fileName = f; }
    int Type() const { return m_type; }
    void Type(int t) { m_type = t; }
    int Format() const { return m_format; }
    void Format(int f) { m_format = f; }
    int FloodAndDry() const { return m_floodAndDry; }
    void FloodAndDry(int v) { m_floodAndDry = v; }
    const CString& CoordinateType() const { return m_coordinateType; }
    void CoordinateType(const CString& c) { m_coordinateType = c; }
    const CString& InputFileName() const { return m_inputFileName; }
    void InputFileName(const CString& f) { m_inputFileName = f; }
    int InputFormat() const { return m_inputFormat; }
    void InputFormat(int v) { m_inputFormat = v; }
    int InterpolationType() const { return m_interpolationType; }
    void InterpolationType(int v) { m_interpolationType = v; }
    int FirstTimeStep() const { return m_firstTimeStep; }
    void FirstTimeStep(int v) { m_firstTimeStep = v; }
    int LastTimeStep() const { return m_lastTimeStep; }
    void LastTimeStep(int v) { m_lastTimeStep = v; }
    int TimeStepFrequency() const { return m_timeStepFrequency; }
    void TimeStepFrequency(int v) { m_timeStepFrequency = v; }
    int Include() const { return m_include; }
    void Include(int v) { m_include = v; }
    int NumberOfPointsOnLine() const { return m_line.npoints; }
    void NumberOfPointsOnLine(int n) { m_line.npoints = n; }
    int LayerMin() const { return m_layerMin; }
    void LayerMin(int v) { m_layerMin = v; }
    int LayerMax() const { return m_layerMax; }
    void LayerMax(int v) { m_layerMax = v; }

    std::vector<MTOutputPoint>& Points() { return m_points; }
    const std::vector<MTOutputPoint>& Points() const { return m_points; }
    MTOutputLine& Line() { return m_line; }
    const MTOutputLine& Line() const { return m_line; }
    std::vector<MTOutputCorner>& Polygon() { return m_polygon; }
    const std::vector<MTOutputCorner>& Polygon() const { return m_polygon; }
    CMTOutputCoordListKiv* CoordList() const { return m_coordList; }

    CMTOutputItemSub2DKiv* Parameters2D() const { return m_sub2D; }
    CMTOutputItemSub3DKiv* Parameters3D() const { return m_sub3D; }
    CMTOutputItemSubDischargeKiv* Discharge() const { return m_discharge; }
    CMTOutputItemSubMassbudgetKiv* Massbudget() const { return m_massbudget; }

    // Which geometry the output is taken over.
    bool UsesLine() const { return m_format == 1 || m_type == kTypeDischarge; }
    bool UsesPoints() const { return m_format == 0 && (m_type == kType2D || m_type == kType3D); }
    bool UsesPolygon() const { return !UsesLine() && !UsesPoints(); }
    // The result file's extension for the format (".qrd0", ".qrd1", ".qrdu").
    static const char* ExtensionOfFormat(int format);

    // The coordinate table from the geometry in use. Without resize the geometry first takes
    // the table's length (points new and zero; a polygon of at least three corners).
    void GeometryToCoordList(bool resize);
    // The geometry in use from the coordinate table. A polygon keeps at least three corners
    // (those beyond the rows keep their values) unless the table is empty.
    void CoordListToGeometry();

    // The checks of validation; messages are added only when report is true.
    bool CheckData(bool report);
    // Adds the points of an xyz file to the geometry in use: corners of a polygon, points of
    // a point series (layer: z truncated), the ends of a line from the first two points.
    // False, with the reason, when the file cannot be read.
    bool ImportXyz(const CString& path, CString* error);
    // A name relative to the setup's folder made absolute.
    CString AbsolutePath(const CString& name) const;

    CString GetTitle() const override { return m_title; }
    void SetTitle(const CString& title) override { m_title = title; }
    bool IsDlgUsedInSetup() override { return m_include != 0; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void WriteData(void* h) override;
    void ReadData(void* h) override;
    // CheckData, then the points against the mesh (too slow for CheckData's other callers).
    int ValidateData() override;
    void Notify(CFemNotifier* notifier, ENotifyMessage message) override;

private:
    // Every point of a point output in an element of the mesh (when the mesh can be read).
    bool CheckPointsInMesh();
    void ReadPoints(void* h);
    void ReadArea(void* h);

    CString m_title = "OUTPUTXXX";
    CString m_fileName;
    int m_type = 1;
    int m_format = 0;
    int m_floodAndDry = 2;
    CString m_coordinateType;
    CString m_inputFileName;
    int m_inputFormat = 1;
    int m_interpolationType = 2;
    int m_firstTimeStep = 0;
    int m_lastTimeStep = 0;
    int m_timeStepFrequency = 1;
    int m_include = 1;
    std::vector<MTOutputPoint> m_points;
    MTOutputLine m_line;
    std::vector<MTOutputCorner> m_polygon;
    int m_layerMin = 1;
    int m_layerMax = 1;

    CMTOutputCoordListKiv* m_coordList = nullptr;
    CMTOutputItemSub2DKiv* m_sub2D = nullptr;
    CMTOutputItemSub3DKiv* m_sub3D = nullptr;
    CMTOutputItemSubDischargeKiv* m_discharge = nullptr;
    CMTOutputItemSubMassbudgetKiv* m_massbudget = nullptr;
};
