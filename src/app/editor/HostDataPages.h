// The editor's own forms for the host data: modules, domain, boundaries, simulation period,
// hydrodynamic sources, density and wind forcing. They follow the section-dialog pattern:
// SetData fills the controls from the node, every edit stores into the node at once and
// tells the host. Lists change only through their list operations, so that the lists
// synchronised with them follow.
#pragma once

#include "widgets/ZoSEDlgBase.h"

class CSetupDocument;

// The page for a host node, or null when the node has none.
CZoSEDlgBase* CreateHostDataPage(CZoSEKivBase* node, const CSetupDocument& doc);
