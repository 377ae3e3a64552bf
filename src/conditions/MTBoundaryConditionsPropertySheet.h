#pragma once

#include "widgets/FemPropertySheetDlg.h"

// The boundary conditions: a map of the boundaries (when the map view is there) and the list
// view. The page last shown is shown again by the next sheet.
class CMTBoundaryConditionsPropertySheet : public CFemPropertySheetDlg {
    Q_OBJECT
public:
    explicit CMTBoundaryConditionsPropertySheet(QWidget* parent = nullptr);

    void Initialize() override;
    void SetData() override;
    // The page the user activates is remembered for the next sheet.
    void OnSetActive(int page);
    static void SetInitialSelectedPage(int page);
    static int GetInitialSelectedPage() { return s_page; }

private:
    static int s_page;
};
