// The flow model's point sources as a sheet of pages: a map of the sources (where the map
// view is built in) and the list of sources. Other modules show their own per-source values
// in it; a "View location" elsewhere opens it on a chosen page and source.
#pragma once

#include "FemPropertySheetDlg.h"

class CHDSourceGisPropSheet : public CFemPropertySheetDlg {
    Q_OBJECT
public:
    explicit CHDSourceGisPropSheet(QWidget* parent = nullptr);

    void Initialize() override;
    // The page's help: the node's help for the map (index 0) or for the list (index 1).
    unsigned long CurrentHelpID() const override;

    // The page and the source (1-based, 0 none) the next sheet opens with.
    static void SetInitialSelectedPage(int page);
    static int GetInitialSelectedPage() { return s_page; }
    static void SetInitialSelectedFeature(int feature);
    static int GetInitialSelectedFeature() { return s_feature; }

private:
    static int s_page;
    static int s_feature;
};
