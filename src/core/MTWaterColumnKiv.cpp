#include "MTWaterColumnKiv.h"

#include "watercolumn/MTDensityFeedbackKiv.h"
#include "watercolumn/MTDepositionKiv.h"
#include "watercolumn/MTSandFractionListKiv.h"
#include "watercolumn/MTSettlingKiv.h"

CMTWaterColumnKiv::CMTWaterColumnKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Water Column Parameters", "WATER_COLUMN", parent, 5044, "CMTGroupDlg") {
    // Children in file order.
    AddChild(new CMTSandFractionListKiv(this));
    AddChild(new CMTSettlingKiv(this));
    AddChild(new CMTDepositionKiv(this));
    AddChild(new CMTDensityFeedbackKiv(this));
}
