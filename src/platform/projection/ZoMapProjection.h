// The map projections a setup can name, and transforms between them (on PROJ).
//
// Strings: "LONG/LAT" (geographical longitude and latitude in degrees, WGS 84),
// "UTM-1" to "UTM-60" (northern zones, WGS 84, metres) and "UTM-1S" to "UTM-60S" (southern
// zones), and "EPSG:n" for any coordinate reference system PROJ knows by that code.
#pragma once

#include <memory>
#include <string>
#include <vector>

struct ProjectionEntry {
    int id;
    std::string name;        // the projection string stored in setups
    std::string description; // shown beside it in drop-down lists
    int epsg;
};

class CZoMapProjection {
public:
    // Id 2, "UTM-32", is the host's default; 1 is "LONG/LAT"; zone z north is 100 + z
    // (but 32), zone z south 200 + z.
    static constexpr int kDefaultId = 2;

    // Every registered projection, in the order of the drop-down lists.
    static const std::vector<ProjectionEntry>& Entries();
    // The string of an identifier; empty for an unknown one.
    static std::string IDtoProjectionString(int id);
    // The identifier of a registered string, 0 when it has none ("EPSG:n", unknown).
    static int ProjectionStringToID(const std::string& projection);
    // Whether transforms to and from the projection can be made.
    static bool IsKnown(const std::string& projection);
    // Coordinates in degrees of longitude and latitude.
    static bool IsGeographical(const std::string& projection);
    // The registry string for an EPSG code: a registered name where there is one, else
    // "EPSG:n"; empty when PROJ does not know the code.
    static std::string FromEpsg(int epsg);
    // The EPSG code of a definition (WKT, PROJ string, "EPSG:n") that names one or that PROJ
    // identifies as likely; 0 when none.
    static int EpsgOfDefinition(const std::string& definition);

    // A transform from one projection to another; IsValid is false when either is unknown.
    CZoMapProjection(const std::string& from, const std::string& to);
    ~CZoMapProjection();
    CZoMapProjection(const CZoMapProjection&) = delete;
    CZoMapProjection& operator=(const CZoMapProjection&) = delete;

    bool IsValid() const { return m_identity || m_pj != nullptr; }
    const std::string& Error() const { return m_error; }
    // In place; false (and the point unchanged) when the point cannot be transformed.
    bool Transform(double& x, double& y) const;
    // Every point; false when any could not be transformed (those are left as they were).
    bool Transform(std::vector<double>& x, std::vector<double>& y) const;

private:
    bool m_identity = false;
    void* m_pj = nullptr; // PJ*, kept out of the header
    std::string m_error;
};
