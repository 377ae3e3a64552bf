#pragma once

#include "GisNavigationDlg.h"

// The flow model's sources on the mesh, the one the sheet was opened for highlighted; a click
// on a source opens the form of the sheet's item with that number.
class CHDSourceGisNavigationDlg : public CMeshNavigationDlg {
    Q_OBJECT
public:
    CHDSourceGisNavigationDlg();
    void Initialize() override;
    void SetData() override;
    int SourceLayer() const { return m_layer; }

protected:
    void CreateOverlays() override;

private:
    int m_layer = -1;
    int m_feature = 0;
};
