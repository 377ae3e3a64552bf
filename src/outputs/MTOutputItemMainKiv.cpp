#include "MTOutputItemMainKiv.h"

#include "MTOutputCoordListKiv.h"
#include "MTOutputItemSubDischargeKiv.h"
#include "MTOutputItemSubKiv.h"
#include "MTOutputItemSubMassbudgetKiv.h"
#include "datafile/ZoFileSelector.h"
#include "fem/DomainKiv.h"
#include "fem/FemEditorUtil.h"
#include "fem/SimulationPeriodKiv.h"
#include "mesh/MeshIndex.h"
#include "paramfile/Kiv.h"
#include "projection/ZoMapProjection.h"
#include "paramfile/ParamFile.h"
#include "setupeditor/MessageTable.h"
#include "setupeditor/MissingSections.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <filesystem>
#include <optional>

namespace {

// The count of points or corners. One that is missing, empty or refused reads as 0, so that
// sections beyond it are reported as unread rather than read on a guess.
int ReadPointCount(void* h) {
    int n = 0;
    kivGetParam(h, "number_of_points", &n, 1, 1);
    if (n < 0 || n > kMaxOutputPoints) {
        kivWarn(h, "number_of_points",
                FormatString("number_of_points = %d is not between 0 and %d; read as 0", n,
                             kMaxOutputPoints));
        return 0;
    }
    return n;
}

// The numbered POINT_n sections of h up to count, in order; the missing ones reported once.
std::vector<void*> PointSections(void* h, int count) {
    const std::vector<int> present = NumberedSections(h, "POINT_%d", count);
    std::vector<void*> sections;
    sections.reserve(present.size());
    for (int i : present)
        sections.push_back(kivSectionByNameNum(h, FormatString("POINT_%d", i).c_str(), 1));
    const MissingNumbers missing = FindMissingNumbers(present, count);
    std::vector<CString> names;
    for (int i : missing.first)
        names.push_back(FormatString("POINT_%d", i));
    WarnMissingSections(h, "number_of_points", count, missing.count, names,
                        "those points are left out");
    return sections;
}

int Truncated(double z) {
    if (!std::isfinite(z) || z >= 2147483647.0 || z <= -2147483648.0)
        return 0;
    return static_cast<int>(z);
}

bool EndsWithNoCase(const CString& s, const char* suffix) {
    const size_t n = std::char_traits<char>::length(suffix);
    if (s.size() < n)
        return false;
    for (size_t i = 0; i < n; ++i)
        if (std::tolower(static_cast<unsigned char>(s[s.size() - n + i])) !=
            std::tolower(static_cast<unsigned char>(suffix[i])))
            return false;
    return true;
}

}  // namespace

CMTOutputItemMainKiv::CMTOutputItemMainKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Outputs", "OUTPUT_%d", parent) {
    if (const CSimulationPeriodKiv* period = SimulationPeriod(this))
        m_lastTimeStep = period->TimeStepCount();
    m_coordinateType = CZoMapProjection::IDtoProjectionString(CZoMapProjection::kDefaultId);
    CDomainKiv* domain = Domain(this);
    if (domain && domain->MeshExist()) {
        const MeshInfo b = domain->GetMeshInfo();
        m_points.push_back({(b.xMin + b.xMax) / 2, (b.yMin + b.yMax) / 2, (b.zMin + b.zMax) / 2, 1,
                            "Point 1"});
        m_line.xFirst = b.xMin;
        m_line.yFirst = b.yMin;
        m_line.zFirst = b.zMin;
        m_line.xLast = b.xMax;
        m_line.yLast = b.yMax;
        m_line.zLast = b.zMax;
        const double dx = 0.01 * (b.xMax - b.xMin);
        const double dy = 0.01 * (b.yMax - b.yMin);
        m_polygon = {{b.xMin - dx, b.yMin - dy},
                     {b.xMin - dx, b.yMax + dy},
                     {b.xMax + dx, b.yMax + dy},
                     {b.xMax + dx, b.yMin - dy}};
        m_layerMax = domain->LayerTotNum();
        m_coordinateType = domain->Projection();
        m_type = domain->ThreeD() ? kType3D : kType2D;
    }
    m_coordList = new CMTOutputCoordListKiv(this);
    AddProperty(m_coordList);
    m_sub2D = new CMTOutputItemSub2DKiv(this);
    AddProperty(m_sub2D);
    m_sub3D = new CMTOutputItemSub3DKiv(this);
    AddProperty(m_sub3D);
    m_discharge = new CMTOutputItemSubDischargeKiv(this);
    AddProperty(m_discharge);
    m_massbudget = new CMTOutputItemSubMassbudgetKiv(this);
    AddProperty(m_massbudget);
    if (domain)
        Listen(domain);
}

// The selections listen to the model definition; they go before the listener base does.
CMTOutputItemMainKiv::~CMTOutputItemMainKiv() { DeleteChildren(); }

const char* CMTOutputItemMainKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTOutputItemPropertySheet"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

const char* CMTOutputItemMainKiv::ExtensionOfFormat(int format) {
    switch (format) {
    case 0: return ".qrd0";
    case 1: return ".qrd1";
    case 2:
    case 3: return ".qrdu";
    default: return "";
    }
}

CString CMTOutputItemMainKiv::AbsolutePath(const CString& name) const {
    return CZoFileSelector(this).AbsolutePath(name);
}

void CMTOutputItemMainKiv::WriteData(void* h) {
    kivPutParam(h, "include", m_include);
    kivPutParam(h, "title", m_title);
    kivAddKeyword(h, "file_name");
    kivAddResultFilename(h, m_fileName);
    kivPutParam(h, "type", m_type);
    kivPutParam(h, "format", m_format);
    kivPutParam(h, "flood_and_dry", m_floodAndDry);
    kivPutParam(h, "coordinate_type", m_coordinateType);
    kivPutParam(h, "zone", 0);
    kivPutParamFilename(h, "input_file_name", m_inputFileName);
    kivPutParam(h, "input_format", m_format == 0 || m_format == 1 ? m_inputFormat : 1);
    kivPutParam(h, "interpolation_type",
                m_format == 0 ? m_interpolationType : (m_format == 1 ? 2 : 1));
    kivPutParam(h, "first_time_step", m_firstTimeStep);
    kivPutParam(h, "last_time_step", m_lastTimeStep);
    kivPutParam(h, "time_step_frequency", m_timeStepFrequency);
    // Points are stored as they are held, in the base units of their quantities: the user's
    // display units play no part in the file.
    kivPutParam(h, "number_of_points", static_cast<int>(m_points.size()));
    for (size_t i = 0; i < m_points.size(); ++i) {
        const MTOutputPoint& p = m_points[i];
        kivAddSection(h, FormatString("POINT_%d", static_cast<int>(i + 1)).c_str());
        kivPutParam(h, "name", p.name);
        kivPutParam(h, "x", p.x);
        kivPutParam(h, "y", p.y);
        kivPutParam(h, "z", p.z);
        kivPutParam(h, "layer", p.layer);
        kivEndSection(h);
    }
    kivAddSection(h, "LINE");
    kivPutParam(h, "npoints", m_line.npoints);
    kivPutParam(h, "x_first", m_line.xFirst);
    kivPutParam(h, "y_first", m_line.yFirst);
    kivPutParam(h, "z_first", m_line.zFirst);
    kivPutParam(h, "x_last", m_line.xLast);
    kivPutParam(h, "y_last", m_line.yLast);
    kivPutParam(h, "z_last", m_line.zLast);
    kivEndSection(h);
    kivAddSection(h, "AREA");
    kivPutParam(h, "number_of_points", static_cast<int>(m_polygon.size()));
    for (size_t i = 0; i < m_polygon.size(); ++i) {
        kivAddSection(h, FormatString("POINT_%d", static_cast<int>(i + 1)).c_str());
        kivPutParam(h, "x", m_polygon[i].x);
        kivPutParam(h, "y", m_polygon[i].y);
        kivEndSection(h);
    }
    kivPutParam(h, "layer_min", m_layerMin);
    kivPutParam(h, "layer_max", m_layerMax);
    kivEndSection(h);
}

void CMTOutputItemMainKiv::ReadData(void* h) {
    kivGetParam(h, "include", &m_include, 1, 1);
    kivGetParam(h, "title", &m_title, 1, 1);
    if (void* keyword = kivKeywordByNameNum(h, "file_name", 1); keyword && kivParamCount(keyword) > 0)
        m_fileName = kivGetResultFilename(kivParamByNum(keyword, 1));
    else if (keyword)
        m_fileName.clear();
    kivGetParam(h, "type", &m_type, 1, 1);
    kivGetParam(h, "format", &m_format, 1, 1);
    kivGetParam(h, "flood_and_dry", &m_floodAndDry, 1, 1);
    kivGetParam(h, "coordinate_type", &m_coordinateType, 1, 1);
    // Always written as 0 and of no use when read; looked at so that it counts as known.
    kivKeywordByNameNum(h, "zone", 1);
    kivGetParamFilename(h, "input_file_name", &m_inputFileName, 1, 1);
    kivGetParam(h, "input_format", &m_inputFormat, 1, 1);
    kivGetParam(h, "interpolation_type", &m_interpolationType, 1, 1);
    kivGetParam(h, "first_time_step", &m_firstTimeStep, 1, 1);
    kivGetParam(h, "last_time_step", &m_lastTimeStep, 1, 1);
    kivGetParam(h, "time_step_frequency", &m_timeStepFrequency, 1, 1);
    kivGetParam(h, "no_of_points_on_line", &m_line.npoints, 1, 1);
    ReadPoints(h);
    if (void* line = kivSectionByNameNum(h, "LINE", 1)) {
        kivGetParam(line, "npoints", &m_line.npoints, 1, 1);
        kivGetParam(line, "x_first", &m_line.xFirst, 1, 1);
        kivGetParam(line, "y_first", &m_line.yFirst, 1, 1);
        kivGetParam(line, "z_first", &m_line.zFirst, 1, 1);
        kivGetParam(line, "x_last", &m_line.xLast, 1, 1);
        kivGetParam(line, "y_last", &m_line.yLast, 1, 1);
        kivGetParam(line, "z_last", &m_line.zLast, 1, 1);
    }
    if (void* area = kivSectionByNameNum(h, "AREA", 1))
        ReadArea(area);
    if (m_inputFormat == 2) {
        std::vector<double> x, y, z;
        std::vector<CString> names;
        CString error;
        if (CFemEditorUtil::ImportXYZ(AbsolutePath(m_inputFileName), x, y, z, names, false, &error)) {
            m_points.reserve(m_points.size() + x.size());
            for (size_t i = 0; i < x.size(); ++i)
                m_points.push_back({x[i], y[i], z[i], Truncated(z[i]), names[i]});
            m_inputFormat = 1;
        } else {
            // The points stay as read and the import is tried again at the next reading.
            kivWarn(h, "input_file_name", "the points of the input file could not be imported: " + error);
        }
    }
}

void CMTOutputItemMainKiv::ReadPoints(void* h) {
    const int count = ReadPointCount(h);
    m_points.clear();
    for (void* s : PointSections(h, count)) {
        MTOutputPoint p;
        p.name = CString(static_cast<const paramfile::Section*>(s)->Name());
        kivGetParam(s, "name", &p.name, 1, 1);
        kivGetParam(s, "x", &p.x, 1, 1);
        kivGetParam(s, "y", &p.y, 1, 1);
        kivGetParam(s, "z", &p.z, 1, 1);
        kivGetParam(s, "layer", &p.layer, 1, 1);
        m_points.push_back(std::move(p));
    }
}

void CMTOutputItemMainKiv::ReadArea(void* area) {
    const int count = ReadPointCount(area);
    m_polygon.clear();
    if (count > 0) {
        for (void* s : PointSections(area, count)) {
            MTOutputCorner c;
            kivGetParam(s, "x", &c.x, 1, 1);
            kivGetParam(s, "y", &c.y, 1, 1);
            m_polygon.push_back(c);
        }
    } else if (kivKeywordByNameNum(area, "x_min", 1) || kivKeywordByNameNum(area, "x_max", 1) ||
               kivKeywordByNameNum(area, "y_min", 1) || kivKeywordByNameNum(area, "y_max", 1)) {
        // The older form gives a rectangle by its bounds. Without them an area of no corners
        // is empty (validation says so) rather than four corners at the origin.
        double xMin = 0, xMax = 0, yMin = 0, yMax = 0;
        kivGetParam(area, "x_min", &xMin, 1, 1);
        kivGetParam(area, "x_max", &xMax, 1, 1);
        kivGetParam(area, "y_min", &yMin, 1, 1);
        kivGetParam(area, "y_max", &yMax, 1, 1);
        m_polygon = {{xMin, yMin}, {xMin, yMax}, {xMax, yMax}, {xMax, yMin}};
    }
    kivGetParam(area, "layer_min", &m_layerMin, 1, 1);
    kivGetParam(area, "layer_max", &m_layerMax, 1, 1);
}

bool CMTOutputItemMainKiv::CheckData(bool report) {
    auto fail = [&](unsigned id) {
        if (report)
            AddError(id);
        return false;
    };
    if (m_include == 0)
        return true;
    const CSimulationPeriodKiv* period = SimulationPeriod(this);
    const int n = period ? period->TimeStepCount() : 0;
    if (m_firstTimeStep < 0 || m_firstTimeStep > n)
        return fail(4122);
    if (m_lastTimeStep < 0 || m_lastTimeStep > n || m_lastTimeStep < m_firstTimeStep)
        return fail(4124);
    if (n > 0 && (m_timeStepFrequency < 1 || m_timeStepFrequency > n))
        return fail(4123);

    CString name = m_fileName;
    std::replace(name.begin(), name.end(), '\\', '/');
    const std::filesystem::path folder = std::filesystem::path(name).parent_path();
    if (!folder.empty()) {
        std::error_code ec;
        if (!std::filesystem::is_directory(AbsolutePath(folder.string()), ec))
            return fail(4112);
    }
    if (!EndsWithNoCase(name, ExtensionOfFormat(m_format)))
        return fail(4112);

    const CDomainKiv* domain = Domain(this);
    const int layers = domain ? domain->LayerTotNum() : 0;
    if (m_type == kType3D) {
        if (m_format == 0 && m_interpolationType == 1) {
            for (const MTOutputPoint& p : m_points)
                if (p.layer < 1 || p.layer > layers) {
                    if (report)
                        AddError(FormatString(LoadMessage(4117).c_str(), p.name.c_str()));
                    return false;
                }
        } else if (m_format == 3) {
            if (m_layerMin < 1 || m_layerMin > layers || m_layerMax < 1 || m_layerMax > layers ||
                m_layerMin > m_layerMax)
                return fail(4118);
        }
    }
    if ((m_format == 2 || m_format == 3 || m_type == kTypeMassBudget) && m_polygon.size() < 3)
        return fail(4107);
    return true;
}

int CMTOutputItemMainKiv::ValidateData() {
    return CheckData(true) && CheckPointsInMesh() ? 1 : 0;
}

bool CMTOutputItemMainKiv::CheckPointsInMesh() {
    CDomainKiv* domain = m_include ? Domain(this) : nullptr;
    // A mesh that cannot be read is the domain's message.
    const CMeshIndex* index = UsesPoints() && domain ? domain->NamedMeshIndex() : nullptr;
    if (!index || m_points.empty())
        return true;
    // Points are given in the output's projection, the mesh in the domain's.
    std::optional<CZoMapProjection> toMesh;
    if (m_coordinateType != domain->Projection()) {
        toMesh.emplace(m_coordinateType, domain->Projection());
        if (!toMesh->IsValid())
            return true;  // no place on the mesh to check against
    }
    const MTOutputPoint* first = nullptr;
    int outside = 0;
    for (const MTOutputPoint& p : m_points) {
        double x = p.x, y = p.y;
        if ((!toMesh || toMesh->Transform(x, y)) && index->ElementAt(x, y) >= 0)
            continue;
        if (!first)
            first = &p;
        ++outside;
    }
    if (!first)
        return true;
    AddError(outside == 1
                 ? FormatString("Point \"%s\" lies outside the mesh", first->name.c_str())
                 : FormatString("Point \"%s\" and %d more points lie outside the mesh",
                                first->name.c_str(), outside - 1));
    return false;
}

bool CMTOutputItemMainKiv::ImportXyz(const CString& path, CString* error) {
    std::vector<double> x, y, z;
    std::vector<CString> names;
    if (!CFemEditorUtil::ImportXYZ(path, x, y, z, names, false, error))
        return false;
    if (UsesLine()) {
        if (!x.empty()) {
            m_line.xFirst = x[0];
            m_line.yFirst = y[0];
            m_line.zFirst = z[0];
        }
        if (x.size() >= 2) {
            m_line.xLast = x[1];
            m_line.yLast = y[1];
            m_line.zLast = z[1];
        }
    } else if (UsesPoints()) {
        for (size_t i = 0; i < x.size(); ++i)
            m_points.push_back({x[i], y[i], z[i], Truncated(z[i]), names[i]});
    } else {
        for (size_t i = 0; i < x.size(); ++i)
            m_polygon.push_back({x[i], y[i]});
    }
    return true;
}

namespace {
size_t PolygonSize(int rows) { return rows <= 0 ? 0 : static_cast<size_t>(std::max(rows, 3)); }
}  // namespace

void CMTOutputItemMainKiv::GeometryToCoordList(bool resize) {
    CMTOutputCoordListKiv* list = m_coordList;
    if (UsesPoints()) {
        if (!resize)
            m_points.resize(static_cast<size_t>(list->GetItemCount()), MTOutputPoint{0, 0, 0, 0, ""});
        list->SetItemCount(static_cast<int>(m_points.size()), 1);
        for (size_t i = 0; i < m_points.size(); ++i) {
            CMTOutputCoordItemKiv* row = list->GetItem(static_cast<int>(i + 1));
            const MTOutputPoint& p = m_points[i];
            row->X(p.x), row->Y(p.y), row->Z(p.z), row->Layer(p.layer), row->Name(p.name);
        }
    } else if (!UsesLine()) {
        if (!resize)
            m_polygon.resize(PolygonSize(list->GetItemCount()));
        list->SetItemCount(static_cast<int>(m_polygon.size()), 1);
        for (size_t i = 0; i < m_polygon.size(); ++i) {
            CMTOutputCoordItemKiv* row = list->GetItem(static_cast<int>(i + 1));
            row->X(m_polygon[i].x), row->Y(m_polygon[i].y);
        }
    } else {
        list->SetItemCount(2, 1);
        CMTOutputCoordItemKiv* first = list->GetItem(1);
        CMTOutputCoordItemKiv* last = list->GetItem(2);
        first->X(m_line.xFirst), first->Y(m_line.yFirst), first->Z(m_line.zFirst);
        last->X(m_line.xLast), last->Y(m_line.yLast), last->Z(m_line.zLast);
    }
}

void CMTOutputItemMainKiv::CoordListToGeometry() {
    CMTOutputCoordListKiv* list = m_coordList;
    const int rows = list->GetItemCount();
    if (UsesLine()) {
        if (const CMTOutputCoordItemKiv* first = list->GetItem(1))
            m_line.xFirst = first->X(), m_line.yFirst = first->Y(), m_line.zFirst = first->Z();
        if (const CMTOutputCoordItemKiv* last = list->GetItem(2))
            m_line.xLast = last->X(), m_line.yLast = last->Y(), m_line.zLast = last->Z();
    } else if (!UsesPoints()) {
        m_polygon.resize(PolygonSize(rows));
        for (int i = 1; i <= rows; ++i)
            m_polygon[static_cast<size_t>(i - 1)] = {list->GetItem(i)->X(), list->GetItem(i)->Y()};
    } else {
        m_points.resize(static_cast<size_t>(rows));
        for (int i = 1; i <= rows; ++i) {
            const CMTOutputCoordItemKiv* row = list->GetItem(i);
            m_points[static_cast<size_t>(i - 1)] = {row->X(), row->Y(), row->Z(), row->Layer(), row->Name()};
        }
    }
}

void CMTOutputItemMainKiv::Notify(CFemNotifier* notifier, ENotifyMessage message) {
    const CDomainKiv* domain = Domain(this);
    if (message == CDomainKiv::kThreeDChanged && domain && !domain->ThreeD()) {
        // Only 3D outputs lose their kind; mass budgets and discharges keep theirs. No
        // output keeps a volume in two dimensions.
        if (m_type == kType3D)
            m_type = kType2D;
        if (m_format == 3)
            m_format = 2;
    } else if (message == CDomainKiv::kLayersChanged && domain) {
        m_layerMax = domain->LayerTotNum();
    }
    CFemListener::Notify(notifier, message);
}
