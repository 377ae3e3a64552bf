#include "ZoMapProjection.h"

#include <proj.h>

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <map>

namespace {

std::vector<ProjectionEntry> MakeEntries() {
    std::vector<ProjectionEntry> e;
    e.push_back({1, "LONG/LAT", "Geographical longitude/latitude (WGS 84)", 4326});
    e.push_back({2, "UTM-32", "UTM zone 32 north (WGS 84)", 32632});
    for (int z = 1; z <= 60; ++z)
        if (z != 32)
            e.push_back({100 + z, "UTM-" + std::to_string(z),
                         "UTM zone " + std::to_string(z) + " north (WGS 84)", 32600 + z});
    for (int z = 1; z <= 60; ++z)
        e.push_back({200 + z, "UTM-" + std::to_string(z) + "S",
                     "UTM zone " + std::to_string(z) + " south (WGS 84)", 32700 + z});
    return e;
}

const ProjectionEntry* Find(const std::string& name) {
    static const std::map<std::string, const ProjectionEntry*> byName = [] {
        std::map<std::string, const ProjectionEntry*> m;
        for (const ProjectionEntry& e : CZoMapProjection::Entries())
            m.emplace(e.name, &e);
        return m;
    }();
    const auto it = byName.find(name);
    return it == byName.end() ? nullptr : it->second;
}

// "EPSG:n" with n a plain positive number, else 0.
int EpsgOf(const std::string& s) {
    if (const ProjectionEntry* e = Find(s))
        return e->epsg;
    if (s.rfind("EPSG:", 0) != 0 || s.size() == 5 || s.size() > 14)
        return 0;
    int n = 0;
    const char* first = s.data() + 5;
    const auto [end, ec] = std::from_chars(first, s.data() + s.size(), n);
    return ec == std::errc() && end == s.data() + s.size() && n > 0 ? n : 0;
}

// PROJ objects belong to one context; the editor calls from one thread, tests may not.
struct Context {
    PJ_CONTEXT* ctx = [] {
        PJ_CONTEXT* c = proj_context_create();
        proj_log_level(c, PJ_LOG_NONE); // failures are reported as results
        return c;
    }();
    std::map<int, bool> known;        // EPSG code -> PROJ knows it
    std::map<int, bool> geographical; // EPSG code -> angular coordinates
    ~Context() { proj_context_destroy(ctx); }
};
Context& Ctx() {
    thread_local Context c;
    return c;
}

// Looks the code up once and remembers what PROJ said.
bool Describe(int epsg, bool* geographical) {
    Context& c = Ctx();
    if (auto it = c.known.find(epsg); it != c.known.end()) {
        if (geographical)
            *geographical = c.geographical[epsg];
        return it->second;
    }
    const std::string def = "EPSG:" + std::to_string(epsg);
    PJ* crs = proj_create(c.ctx, def.c_str());
    bool geo = false;
    if (crs) {
        const PJ_TYPE t = proj_get_type(crs);
        geo = t == PJ_TYPE_GEOGRAPHIC_2D_CRS || t == PJ_TYPE_GEOGRAPHIC_3D_CRS ||
              t == PJ_TYPE_GEOGRAPHIC_CRS;
        proj_destroy(crs);
    }
    proj_errno_reset(nullptr);
    c.known[epsg] = crs != nullptr;
    c.geographical[epsg] = geo;
    if (geographical)
        *geographical = geo;
    return crs != nullptr;
}

} // namespace

const std::vector<ProjectionEntry>& CZoMapProjection::Entries() {
    static const std::vector<ProjectionEntry> entries = MakeEntries();
    return entries;
}

std::string CZoMapProjection::IDtoProjectionString(int id) {
    for (const ProjectionEntry& e : Entries())
        if (e.id == id)
            return e.name;
    return {};
}

int CZoMapProjection::ProjectionStringToID(const std::string& projection) {
    const ProjectionEntry* e = Find(projection);
    return e ? e->id : 0;
}

bool CZoMapProjection::IsKnown(const std::string& projection) {
    if (Find(projection))
        return true;
    const int epsg = EpsgOf(projection);
    return epsg > 0 && Describe(epsg, nullptr);
}

bool CZoMapProjection::IsGeographical(const std::string& projection) {
    if (const ProjectionEntry* e = Find(projection))
        return e->epsg == 4326;
    bool geo = false;
    const int epsg = EpsgOf(projection);
    return epsg > 0 && Describe(epsg, &geo) && geo;
}

std::string CZoMapProjection::FromEpsg(int epsg) {
    for (const ProjectionEntry& e : Entries())
        if (e.epsg == epsg)
            return e.name;
    return epsg > 0 && Describe(epsg, nullptr) ? "EPSG:" + std::to_string(epsg) : std::string();
}

int CZoMapProjection::EpsgOfDefinition(const std::string& definition) {
    PJ_CONTEXT* ctx = Ctx().ctx;
    PJ* crs = proj_create(ctx, definition.c_str());
    int epsg = 0;
    if (crs) {
        const char* auth = proj_get_id_auth_name(crs, 0);
        const char* code = proj_get_id_code(crs, 0);
        if (auth && code && std::string(auth) == "EPSG") {
            epsg = std::atoi(code);
        } else {
            int* confidence = nullptr;
            // 70 and above: PROJ's "likely" match; the best comes first.
            if (PJ_OBJ_LIST* list = proj_identify(ctx, crs, "EPSG", nullptr, &confidence)) {
                if (proj_list_get_count(list) > 0 && confidence[0] >= 70) {
                    PJ* match = proj_list_get(ctx, list, 0);
                    if (const char* c = match ? proj_get_id_code(match, 0) : nullptr)
                        epsg = std::atoi(c);
                    proj_destroy(match);
                }
                proj_int_list_destroy(confidence);
                proj_list_destroy(list);
            }
        }
        proj_destroy(crs);
    }
    proj_errno_reset(nullptr);
    return epsg > 0 ? epsg : 0;
}

CZoMapProjection::CZoMapProjection(const std::string& from, const std::string& to) {
    const int a = IsKnown(from) ? EpsgOf(from) : 0;
    const int b = IsKnown(to) ? EpsgOf(to) : 0;
    if (a == 0 || b == 0) {
        m_error = "unknown projection \"" + (a == 0 ? from : to) + "\"";
        return;
    }
    if (a == b) {
        m_identity = true;
        return;
    }
    PJ_CONTEXT* ctx = Ctx().ctx;
    const std::string sa = "EPSG:" + std::to_string(a), sb = "EPSG:" + std::to_string(b);
    PJ* p = proj_create_crs_to_crs(ctx, sa.c_str(), sb.c_str(), nullptr);
    if (!p) {
        m_error = proj_context_errno_string(ctx, proj_context_errno(ctx));
        return;
    }
    // Longitude first, whatever order the authority gives the axes.
    PJ* n = proj_normalize_for_visualization(ctx, p);
    proj_destroy(p);
    if (!n) {
        m_error = proj_context_errno_string(ctx, proj_context_errno(ctx));
        return;
    }
    m_pj = n;
}

CZoMapProjection::~CZoMapProjection() {
    if (m_pj)
        proj_destroy(static_cast<PJ*>(m_pj));
}

bool CZoMapProjection::Transform(double& x, double& y) const {
    if (m_identity)
        return true;
    if (!m_pj || !std::isfinite(x) || !std::isfinite(y))
        return false;
    PJ* p = static_cast<PJ*>(m_pj);
    proj_errno_reset(p);
    const PJ_COORD out = proj_trans(p, PJ_FWD, proj_coord(x, y, 0, 0));
    if (proj_errno(p) != 0 || !std::isfinite(out.xy.x) || !std::isfinite(out.xy.y) ||
        out.xy.x == HUGE_VAL)
        return false;
    x = out.xy.x;
    y = out.xy.y;
    return true;
}

bool CZoMapProjection::Transform(std::vector<double>& x, std::vector<double>& y) const {
    bool all = x.size() == y.size();
    for (size_t i = 0; i < x.size() && i < y.size(); ++i)
        all = Transform(x[i], y[i]) && all;
    return all;
}
