// The value of one quantity at one open boundary: its boundary type, and for specified
// values a constant or a data file, with soft start and interpolation settings.
#pragma once

#include "FemInDataKiv.h"
#include "setupeditor/ZoSEKivBase.h"

#include <memory>
#include <vector>

// The data file of a boundary value; ItemString names the item read from it.
class CBoundaryConditionsComponentItemFileKiv : public CFemInDataFile {};

class CBoundaryConditionsComponentItemKiv : public CZoSEKivBase {
public:
    // Type indexes the modules give their texts: 0 land, 1 specified values, 2 zero gradient.
    static constexpr int kTypeSpecified = 1;
    // Format: 0 a constant; a data file varying in time (1), along the boundary (2) or both (3).
    static constexpr int kFormatLast = 3;
    // Soft start: 0 none, 1 linear, 2 sinusoidal. Interpolation: 0 piecewise constant, 1 linear.
    static constexpr int kTypeSoftLast = 2;
    static constexpr int kInterpolationLast = 1;

    CBoundaryConditionsComponentItemKiv(const CString& title, const CString& sectionName,
                                        CZoSEKivBase* parent);

    int Type() const { return m_type; }
    void Type(int type) { m_type = type; }
    int Format() const { return m_format; }
    void Format(int format) { m_format = format; }
    double Constant() const { return m_constant; }
    void Constant(double value) { m_constant = value; }
    double SoftTime() const { return m_softTime; }
    void SoftTime(double value) { m_softTime = value; }
    double RefSoft() const { return m_refSoft; }
    void RefSoft(double value) { m_refSoft = value; }
    int TypeSoft() const { return m_typeSoft; }
    void TypeSoft(int type) { m_typeSoft = type; }
    int TypeTI() const { return m_typeTI; }
    void TypeTI(int type) { m_typeTI = type; }
    int TypeSI() const { return m_typeSI; }
    void TypeSI(int type) { m_typeSI = type; }
    long OvuType() const { return m_ovuType; }
    void OvuType(long type) { m_ovuType = type; }

    // The texts of the boundary types, by type index. Items of one module share theirs until
    // one is changed, so that thousands of items cost one array.
    const std::vector<CString>& TypeTextArr() const { return *m_typeTexts; }
    void TypeTextArr(std::shared_ptr<const std::vector<CString>> texts);
    // The text of the current type; "Type %d" for an index no text stands for.
    CString TypeText() const;

    CBoundaryConditionsComponentItemFileKiv* QrdData() { return &m_file; }
    const CBoundaryConditionsComponentItemFileKiv* QrdData() const { return &m_file; }

    static CString FormatName(int format);
    static CString SoftStartName(int type);
    static CString InterpolationName(int type, bool inSpace);

    // Whether the data file of a specified value read from a file will do (from its header:
    // kind, item and unit type, and for values in time the simulation period); why says
    // what is wrong. Passes for other types and formats.
    bool CheckFile(CString* why = nullptr) const;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    // Back to the defaults the module chose (RememberDefaults).
    void SetDefault() override;

protected:
    // A module's constructor sets its defaults, then remembers them.
    void RememberDefaults();

private:
    friend struct BoundaryItemFields;
    int m_type = 0;
    int m_format = 0;
    double m_constant = 0.0;
    double m_softTime = 0.0;
    double m_refSoft = 0.0;
    int m_typeSoft = 0;
    int m_typeTI = 0;
    int m_typeSI = 0;
    long m_ovuType = 0;
    std::shared_ptr<const std::vector<CString>> m_typeTexts;
    CBoundaryConditionsComponentItemFileKiv m_file;

    struct Defaults {
        int type, format;
        double constant, softTime, refSoft;
        int typeSoft, typeTI, typeSI;
    };
    Defaults m_defaults{};
};
