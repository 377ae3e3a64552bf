// BOUNDARY_CONDITIONS: one component per open boundary of the mesh, in the order of the
// host's boundary list ("BoundaryNames"), each with one value per suspended fraction.
#pragma once

#include "MTSpareItems.h"
#include "core/MTCountListKiv.h"
#include "fem/BoundaryBaseInterface.h"
#include "fem/BoundaryConditionsComponentItemKiv.h"

// The boundary value of one fraction ("SSC_FRACTION_%d"), a zero gradient at first.
class CMTBoundaryConditionsComponentItemKiv : public CBoundaryConditionsComponentItemKiv {
public:
    explicit CMTBoundaryConditionsComponentItemKiv(CZoSEKivBase* parent);
    CString GetAbbreviatedTitle() const override { return GetTitle(); }
    const char* GetDlgRuntimeClass(unsigned code) override;
    // As it was made: the defaults, untouched.
    void Renew();
};

// The values at one boundary; its section is named like the boundary's.
class CMTBoundaryConditionsComponentKiv
    : public CBoundaryBaseInterface,
      public CMTCountListKiv<CMTBoundaryConditionsComponentItemKiv> {
public:
    explicit CMTBoundaryConditionsComponentKiv(CZoSEKivBase* parent);

    // The boundary's name and code, asked of the boundary with the same number.
    CString GetTitle() const override;
    int BoundaryCode() override;

    CMTBoundaryConditionsComponentItemKiv* Create() override;
    void LoadSize(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;

protected:
    void DiscardItem(CMTBoundaryConditionsComponentItemKiv* item) override { m_spares.Keep(item); }

private:
    CMTSpareItems<CMTBoundaryConditionsComponentItemKiv> m_spares;
};

class CMTBoundaryConditionsKiv : public CZoSEKivListBase<CMTBoundaryConditionsComponentKiv> {
public:
    explicit CMTBoundaryConditionsKiv(CZoSEKivBase* parent);
    ~CMTBoundaryConditionsKiv() override;

    // Components take the section names of the boundaries at their places.
    void NameComponents();

    void LoadSize(void* h) override;
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    bool IsDlgUsedInSetup() override { return GetItemCount() > 0; }
    const char* GetDlgRuntimeClass(unsigned code) override;
};

CMTBoundaryConditionsKiv* MTBoundaryConditions(const CZoSEKivBase* node);
