#include "HDSourcesKiv.h"

#include "fem/DomainKiv.h"
#include "mesh/MeshIndex.h"
#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "HDSources";
}

struct HDSourceFields {
    using F = KivField<CHDSourceItemKiv>;
    using K = CHDSourceItemKiv;
    static inline const F kFields[] = {
        F::String("name", &K::m_name, ""),
        F::Flag("include", &K::m_include, true),
        F::Double("x", &K::m_x, 0.0),
        F::Double("y", &K::m_y, 0.0),
    };
};

CHDSourceItemKiv::CHDSourceItemKiv(CZoSEKivBase* parent) : CZoSEKivBase("", "SOURCE_%d", parent) {
    int number = 1;
    if (auto* list = dynamic_cast<CZoSEKivListBaseInterface*>(parent))
        number = list->GetItemCount() + 1;
    m_name = FormatString("Source %d", number);
    if (const CDomainKiv* domain = Domain(this); domain && domain->MeshExist()) {
        const MeshInfo box = domain->GetMeshInfo();
        m_x = (box.xMin + box.xMax) / 2;
        m_y = (box.yMin + box.yMax) / 2;
    }
}

void CHDSourceItemKiv::WriteData(void* h) { WriteFields(h, *this, HDSourceFields::kFields); }
void CHDSourceItemKiv::ReadData(void* h) { ReadFields(h, *this, HDSourceFields::kFields); }

int CHDSourceItemKiv::ValidateData() {
    if (m_name.empty()) {
        AddError("A source needs a name");
        return 0;
    }
    // A mesh that cannot be read is the domain's message.
    CDomainKiv* domain = Domain(this);
    const CMeshIndex* index = m_include && domain ? domain->NamedMeshIndex() : nullptr;
    if (index && index->ElementAt(m_x, m_y) < 0) {
        AddError(FormatString("The source lies outside the mesh (x %.10g, y %.10g)", m_x, m_y));
        return 0;
    }
    return 1;
}

CHDSourcesKiv::CHDSourcesKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase<CHDSourceItemKiv>("Sources", "HYDRODYNAMIC_SOURCES", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
}

CHDSourcesKiv::~CHDSourcesKiv() { GetRoot()->UnregisterImportantNode(kKey); }

CHDSourcesKiv* HDSources(const CZoSEKivBase* node) {
    return GetImportant<CHDSourcesKiv>(node, kKey);
}
