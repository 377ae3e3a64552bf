#include "MTDredgingMapDlg.h"

#include "MTDredgingFile.h"
#include "MTDredgingKiv.h"

void CMTDredgingMapDlg::CreateOverlays() {
    m_tracks = -1;
    CMTDredgingKiv* list = GetImportant<CMTDredgingKiv>(GetSection(), "MTDredgings");
    if (!list)
        return;
    m_tracks = Map()->AddOverlay(tr("Dredger tracks"), QColor(120, 40, 200));
    Map()->Overlay(m_tracks).lineWidth = 2;
    for (int i = 1; i <= list->GetItemCount(); ++i) {
        const CMTDredgingItemsKiv* d = list->GetItem(i);
        std::vector<double> x, y;
        if (!d->Include() || !d->DataFile()->ReadTrack(x, y) || x.size() < 2)
            continue;
        Map()->AddPolyline(m_tracks, i, QString::fromStdString(d->Name()), x, y, d->CoordinateType());
    }
    const int own = list->GetNumberWhatIs(GetSection());
    if (own > 0)
        Map()->SelectFeature(m_tracks, own);
}
