// Map pages: a map of the domain's mesh with feature layers, a tool row and a status line
// with the cursor position and the feature under it. Pages that show their own data on the
// map derive from CGisNavigationDlg and build their layers in CreateOverlays; pages of one
// kind keep one view rectangle between them by overriding SetView and GetView.
#pragma once

#include "ZoMapView.h"
#include "ZoSEDlgBase.h"

#include <functional>
#include <vector>

class QLabel;
class QMenu;

class CGisNavigationDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    CGisNavigationDlg();

    // Builds the map, then SetData.
    void Initialize() override;
    // The mesh of the domain again, and the layers built anew.
    void SetData() override;

    CZoMapView* Map() const { return m_map; }
    // The quantity the mesh is coloured by (bed level is the only one drawn so far).
    void ContourItem(int item) { m_contourItem = item; }
    int ContourItem() const { return m_contourItem; }

    // The layers that the host's data gives, numbered as in their lists; -1 when there is
    // nothing to show. Boundaries are matched to the mesh's node strings by code.
    int AddBoundaryOverlay();
    int AddSourceOverlay();

    // A sub-menu "title" with one entry per feature hit; each entry's data holds the
    // feature's number (high word) and sub-index (low word). With subItems, each feature's
    // entry is followed by one per sub-item (the names it gives for the feature's number),
    // with the sub-indexes 1 to n. Returns the number of entries.
    using SubItemNames = std::function<std::vector<QString>(int number)>;
    int AddFeatureMenu(QMenu& menu, const std::vector<CZoMapHit>& hits, const QString& title,
                       const SubItemNames& subItems = {});
    // The features under a pixel of the map.
    std::vector<CZoMapHit> HitTest(QPointF pixel) const { return m_map->HitTest(pixel); }

signals:
    // A feature was clicked on the map.
    void featureSelected(int overlay, int number);

protected:
    // Called by SetData after the layers were removed.
    virtual void CreateOverlays() {}
    // The view rectangle: stored whenever the view changes, asked for when the page opens.
    virtual void SetView(const QRectF& rect) { m_view = rect; }
    virtual QRectF GetView() const { return m_view; }
    // The default menu (fit to the mesh); pages add their own entries.
    virtual void OnShowContextMenu(QWidget* owner, QPoint globalPos, QPointF pixel);
    void BuildDefaultMenu(QMenu& menu);

private:
    CZoMapView* m_map = nullptr;
    QLabel* m_status = nullptr;
    QRectF m_view;
    int m_contourItem = 0;
    bool m_viewRestored = false;
};

// The map page of the domain: the mesh with its open boundaries and the hydrodynamic
// sources.
class CMeshNavigationDlg : public CGisNavigationDlg {
    Q_OBJECT
public:
    int BoundaryOverlay() const { return m_boundaries; }
    int SourceOverlay() const { return m_sources; }

protected:
    void CreateOverlays() override;

private:
    int m_boundaries = -1;
    int m_sources = -1;
};
