#include "BoundaryNamesKiv.h"

#include "setupeditor/KivFields.h"

#include <map>

namespace {
const char* const kKey = "BoundaryNames";
}

struct BoundaryNameFields {
    using F = KivField<CBoundaryNameKiv>;
    using K = CBoundaryNameKiv;
    static inline const F kFields[] = {
        F::String("name", &K::m_name, "").Doc("Name of the open boundary"),
        F::Int("code", &K::m_code, 2).Doc("Boundary code of the open boundary in the mesh"),
    };
};

CBoundaryNameKiv::CBoundaryNameKiv(CZoSEKivBase* parent) : CZoSEKivBase("", "BOUNDARY_%d", parent) {
    // Code 1 is the land boundary; open boundaries count from 2.
    int number = 1;
    if (auto* list = dynamic_cast<CZoSEKivListBaseInterface*>(parent))
        number = list->GetItemCount() + 1;
    m_name = FormatString("Boundary %d", number);
    m_code = number + 1;
}

void CBoundaryNameKiv::WriteData(void* h) { WriteFields(h, *this, BoundaryNameFields::kFields); }
void CBoundaryNameKiv::ReadData(void* h) { ReadFields(h, *this, BoundaryNameFields::kFields); }

int CBoundaryNameKiv::ValidateData() {
    if (m_name.empty()) {
        AddError("A boundary needs a name");
        return 0;
    }
    return 1;
}

CBoundaryNamesKiv::CBoundaryNamesKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase<CBoundaryNameKiv>("Boundaries", "BOUNDARY_NAMES", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
}

CBoundaryNamesKiv::~CBoundaryNamesKiv() { GetRoot()->UnregisterImportantNode(kKey); }

int CBoundaryNamesKiv::ValidateData() {
    std::map<int, int> firstWithCode;
    int ok = 1;
    for (int i = 1; i <= GetItemCount(); ++i) {
        const int code = GetItem(i)->BoundaryCode();
        auto [it, inserted] = firstWithCode.emplace(code, i);
        if (!inserted) {
            AddError(FormatString("Boundaries %d and %d have the same code %d", it->second, i,
                                  code));
            ok = 0;
        }
    }
    return ok;
}

CBoundaryNamesKiv* BoundaryNames(const CZoSEKivBase* node) {
    return GetImportant<CBoundaryNamesKiv>(node, kKey);
}

void CBoundaryNameKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, BoundaryNameFields::kFields); }
