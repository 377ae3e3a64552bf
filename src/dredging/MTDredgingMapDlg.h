#pragma once

#include "widgets/GisNavigationDlg.h"

// The dredgers' tracks on the map of the domain, one polyline per included dredger with a
// readable time series, numbered as in the list. On a dredger's page its own track is
// highlighted.
class CMTDredgingMapDlg : public CGisNavigationDlg {
    Q_OBJECT
public:
    int TrackOverlay() const { return m_tracks; }

protected:
    void CreateOverlays() override;

private:
    int m_tracks = -1;
};
