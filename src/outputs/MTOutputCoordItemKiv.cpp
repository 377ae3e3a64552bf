#include "MTOutputCoordItemKiv.h"

#include "fem/DomainKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

CMTOutputCoordItemKiv::CMTOutputCoordItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("MTOutputCoords", "", parent) {
    if (const CDomainKiv* domain = Domain(this); domain && domain->MeshExist()) {
        const MeshInfo box = domain->GetMeshInfo();
        m_x = (box.xMin + box.xMax) / 2;
        m_y = (box.yMin + box.yMax) / 2;
        m_z = (box.zMin + box.zMax) / 2;
    }
    const auto* list = dynamic_cast<const CZoSEKivListBaseInterface*>(parent);
    m_name = FormatString("Point %d", (list ? list->GetItemCount() : 0) + 1);
}
