#include "MTBoundaryConditionsKiv.h"

#include "setupeditor/Keywords.h"
#include "MTFollowedCount.h"
#include "fem/BoundaryNamesKiv.h"

#include <algorithm>

namespace {
const char* const kKey = "MudTransportBoundaryConditions";

// Every item of the module shares one array of type texts.
const std::shared_ptr<const std::vector<CString>>& TypeTexts() {
    static const auto texts = std::make_shared<const std::vector<CString>>(
        std::vector<CString>{"Land", "Specified values", "Zero gradient"});
    return texts;
}

const CBoundaryNameKiv* BoundaryAt(const CZoSEKivBase* node, int number) {
    const CBoundaryNamesKiv* names = BoundaryNames(node);
    return names ? names->GetItem(number) : nullptr;
}
}  // namespace

CMTBoundaryConditionsComponentItemKiv::CMTBoundaryConditionsComponentItemKiv(CZoSEKivBase* parent)
    : CBoundaryConditionsComponentItemKiv("Fraction %d", "SSC_FRACTION_%d", parent) {
    Type(2);
    Format(0);
    Constant(0.0);
    SoftTime(0.0);
    RefSoft(0.0);
    TypeSoft(2);
    TypeTI(1);
    TypeSI(1);
    OvuType(100403);
    TypeTextArr(TypeTexts());
    RememberDefaults();
}

const char* CMTBoundaryConditionsComponentItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest
               ? "CMTBoundaryConditionsComponentItemDlg"
               : CBoundaryConditionsComponentItemKiv::GetDlgRuntimeClass(code);
}

void CMTBoundaryConditionsComponentItemKiv::Renew() {
    SetDefault();
    SetHasBeenTouched(false);
}

CMTBoundaryConditionsComponentKiv::CMTBoundaryConditionsComponentKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("", "", parent, MTCount::Fractions) {}

CMTBoundaryConditionsComponentItemKiv* CMTBoundaryConditionsComponentKiv::Create() {
    if (CMTBoundaryConditionsComponentItemKiv* item = m_spares.Take()) {
        item->Renew();
        return item;
    }
    return CMTCountListKiv::Create();
}

CString CMTBoundaryConditionsComponentKiv::GetTitle() const {
    const CBoundaryNameKiv* boundary = BoundaryAt(this, GetNumberWhatAmI());
    return boundary ? boundary->Identifier() : CString();
}

int CMTBoundaryConditionsComponentKiv::BoundaryCode() {
    const CBoundaryNameKiv* boundary = BoundaryAt(this, GetNumberWhatAmI());
    return boundary ? boundary->BoundaryCode() : 0;
}

void CMTBoundaryConditionsComponentKiv::LoadSize(void* h) {
    CheckFollowedCount(h, GetItemCount(), "fraction", "fractions");
}

const char* CMTBoundaryConditionsComponentKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTBoundaryConditionsComponentDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

CMTBoundaryConditionsKiv::CMTBoundaryConditionsKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase("Boundary Conditions", "BOUNDARY_CONDITIONS", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
    if (CBoundaryNamesKiv* names = BoundaryNames(this)) {
        // Built over boundaries that exist already, the list starts with one component each.
        SetItemCount(names->GetItemCount(), 1);
        names->RegisterSyncedList(this, 1);
    }
}

CMTBoundaryConditionsKiv::~CMTBoundaryConditionsKiv() {
    GetRoot()->UnregisterImportantNode(kKey);
    if (CBoundaryNamesKiv* names = BoundaryNames(this))
        names->UnRegisterSyncedList(this);
}

void CMTBoundaryConditionsKiv::NameComponents() {
    const CBoundaryNamesKiv* names = BoundaryNames(this);
    const int n = std::min(GetItemCount(), names ? names->GetItemCount() : 0);
    for (int i = 1; i <= n; ++i)
        GetItem(i)->SetSectionName(names->GetItem(i)->GetSectionName());
}

void CMTBoundaryConditionsKiv::LoadSize(void* h) {
    const CBoundaryNamesKiv* names = BoundaryNames(this);
    CheckFollowedCount(h, names ? names->GetItemCount() : GetItemCount(), "boundary", "boundaries");
}

void CMTBoundaryConditionsKiv::WriteData(void* h) {
    NameComponents();
    kivAddSection(h, "CODE_1");
    kivEndSection(h);
}

void CMTBoundaryConditionsKiv::ReadData(void* h) {
    NameComponents();
    // Written for the engine, empty; looked up so that it counts as read.
    kivSectionByNameNum(h, "CODE_1", 1);
}

int CMTBoundaryConditionsKiv::ValidateData() {
    // Messages name the boundaries as they are now, after any insert or move since the load.
    NameComponents();
    return 1;
}

const char* CMTBoundaryConditionsKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTBoundaryConditionsPropertySheet"
                                           : CZoSEKivListBase::GetDlgRuntimeClass(code);
}

CMTBoundaryConditionsKiv* MTBoundaryConditions(const CZoSEKivBase* node) {
    return GetImportant<CMTBoundaryConditionsKiv>(node, kKey);
}

// CODE_1 is written empty: it holds no keyword. The items take their boundaries' section
// names here, as on writing.
void CMTBoundaryConditionsKiv::DescribeKeywords(KeywordSink&) { NameComponents(); }
