#include "GisNavigationDlg.h"

#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "hydro/HDSourcesKiv.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QMenu>
#include <QPushButton>
#include <QVBoxLayout>

namespace {
QString Q(const CString& s) {
    return QString::fromStdString(s);
}
QString Number(double v) {
    return QString::number(v, 'f', std::abs(v) < 1000 ? 5 : 1);
}
} // namespace

CGisNavigationDlg::CGisNavigationDlg() {
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    auto* tools = new QHBoxLayout;
    auto* fit = new QPushButton(tr("Fit to mesh"), this);
    tools->addWidget(fit);
    tools->addStretch(1);
    layout->addLayout(tools);
    m_map = new CZoMapView(this);
    layout->addWidget(m_map, 1);
    m_status = new QLabel(this);
    m_status->setTextInteractionFlags(Qt::TextSelectableByMouse);
    layout->addWidget(m_status);

    connect(fit, &QPushButton::clicked, m_map, &CZoMapView::FitToMesh);
    connect(m_map, &CZoMapView::viewChanged, this, [this](const QRectF& r) {
        if (m_viewRestored)
            SetView(r);
    });
    connect(m_map, &CZoMapView::cursorMoved, this, [this](double x, double y) {
        QString text = QStringLiteral("x = %1   y = %2").arg(Number(x), Number(y));
        const std::vector<CZoMapHit> hits = m_map->HitTest(m_map->ToPixel(x, y));
        if (!hits.empty())
            text += "   " + m_map->Feature(hits.front()).name;
        else if (const int e = m_map->ElementAt(m_map->ToPixel(x, y)); e >= 0)
            text += tr("   element %1").arg(e + 1);
        m_status->setText(text);
    });
    connect(m_map, &CZoMapView::featureClicked, this, &CGisNavigationDlg::featureSelected);
    connect(m_map, &CZoMapView::contextMenuRequested, this,
            [this](QPoint global, QPointF pixel) { OnShowContextMenu(m_map, global, pixel); });
}

void CGisNavigationDlg::Initialize() {
    CZoSEDlgBase::Initialize();
    m_map->SetViewRect(GetView());
    m_viewRestored = true;
}

void CGisNavigationDlg::SetData() {
    CZoSEDlgBase::SetData();
    CDomainKiv* domain = Domain(GetSection());
    MeshPtr mesh;
    QString message;
    if (!domain || !domain->MeshExist()) {
        message = tr("No mesh: choose a mesh file on the domain's page.");
    } else {
        std::string error;
        mesh = domain->EnsureMesh(AbsoluteFilePath(domain->MeshFile()), &error);
        if (!mesh)
            message = Q(error);
    }
    m_map->SetProjection(domain ? domain->Projection() : CString("UTM-32"));
    m_map->SetMessage(message);
    m_map->SetMesh(mesh);
    m_map->RemoveOverlays();
    CreateOverlays();
}

int CGisNavigationDlg::AddBoundaryOverlay() {
    CBoundaryNamesKiv* names = BoundaryNames(GetSection());
    const MeshPtr& mesh = m_map->Mesh();
    if (!names || !mesh)
        return -1;
    const int overlay = m_map->AddOverlay(tr("Open boundaries"), QColor(220, 40, 40));
    for (int i = 1; i <= names->GetItemCount(); ++i) {
        const CBoundaryNameKiv* b = names->GetItem(i);
        for (const MeshBoundary& mb : mesh->boundaries) {
            if (mb.code != b->BoundaryCode())
                continue;
            std::vector<double> x, y;
            for (int n : mb.nodes) {
                x.push_back(mesh->x[static_cast<size_t>(n)]);
                y.push_back(mesh->y[static_cast<size_t>(n)]);
            }
            m_map->AddPolyline(overlay, i, Q(b->Identifier()), x, y, m_map->Projection());
            break;
        }
    }
    return overlay;
}

int CGisNavigationDlg::AddSourceOverlay() {
    CHDSourcesKiv* sources = HDSources(GetSection());
    if (!sources)
        return -1;
    const int overlay = m_map->AddOverlay(tr("Sources"), QColor(230, 120, 0));
    // Source positions are in the domain's projection.
    for (int i = 1; i <= sources->GetItemCount(); ++i) {
        const CHDSourceItemKiv* s = sources->GetItem(i);
        m_map->AddPoint(overlay, i, Q(s->Name()), s->X(), s->Y(), m_map->Projection());
    }
    return overlay;
}

int CGisNavigationDlg::AddFeatureMenu(QMenu& menu, const std::vector<CZoMapHit>& hits,
                                      const QString& title, const SubItemNames& subItems) {
    if (hits.empty())
        return 0;
    QMenu* sub = menu.addMenu(title);
    int entries = 0;
    for (const CZoMapHit& hit : hits) {
        const CZoMapFeature& f = m_map->Feature(hit);
        const QString name = f.name.isEmpty() ? tr("Feature %1").arg(f.number) : f.name;
        QAction* a = sub->addAction(name);
        a->setData((f.number << 16) | (f.subIndex & 0xffff));
        ++entries;
        if (!subItems)
            continue;
        const std::vector<QString> names = subItems(f.number);
        for (size_t i = 0; i < names.size() && i < 0xffff; ++i) {
            QAction* s = sub->addAction(QStringLiteral("%1: %2").arg(name, names[i]));
            s->setData((f.number << 16) | static_cast<int>(i + 1));
            ++entries;
        }
    }
    return entries;
}

void CGisNavigationDlg::BuildDefaultMenu(QMenu& menu) {
    menu.addAction(tr("Fit to mesh"), m_map, &CZoMapView::FitToMesh);
}

void CGisNavigationDlg::OnShowContextMenu(QWidget* owner, QPoint globalPos, QPointF) {
    QMenu menu(owner);
    BuildDefaultMenu(menu);
    menu.exec(globalPos);
}

void CMeshNavigationDlg::CreateOverlays() {
    m_boundaries = AddBoundaryOverlay();
    m_sources = AddSourceOverlay();
}
