#include "FemEditorUtil.h"

#include "datafile/DataFile.h"

bool CFemEditorUtil::ImportXYZ(const CString& file, std::vector<double>& x, std::vector<double>& y,
                               std::vector<double>& z, std::vector<CString>& names, bool) {
    const datafile::XyzResult r = datafile::ReadXyz(file);
    if (r.error)
        return false;
    std::vector<double> xs, ys, zs;
    std::vector<CString> ns;
    for (const datafile::XyzPoint& p : r.points) {
        xs.push_back(p.x);
        ys.push_back(p.y);
        zs.push_back(p.z);
        ns.push_back(p.name);
    }
    x = std::move(xs);
    y = std::move(ys);
    z = std::move(zs);
    names = std::move(ns);
    return true;
}
