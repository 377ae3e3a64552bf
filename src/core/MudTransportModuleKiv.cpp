#include "MudTransportModuleKiv.h"

#include "setupeditor/Keywords.h"
#include "MTForcingsGroupKiv.h"
#include "MTSolutionTechniqueKiv.h"
#include "MTWaterColumnKiv.h"
#include "ParameterSelectionKiv.h"
#include "bed/MTBedGroupKiv.h"
#include "bed/MTMorphologyKiv.h"
#include "conditions/InitialConditionsKiv.h"
#include "conditions/MTBoundaryConditionsKiv.h"
#include "conditions/MTSourceKiv.h"
#include "dredging/MTDredgingKiv.h"
#include "outputs/MTOutputKiv.h"
#include "host/ModuleSelection.h"
#include "paramfile/Kiv.h"
#include "watercolumn/MTDispersionKiv.h"

namespace {
const char* const kKey = "MudTransportBase";
}

CMudTransportModuleKiv::CMudTransportModuleKiv(CZoSEKivBase* parent)
    : CFemKivGroupBase("Mud Transport Module", "MUD_TRANSPORT_MODULE", parent, 5001) {
    GetRoot()->RegisterImportantNode(this, kKey);
    // The model definition comes first: every list below sizes itself from it.
    AddChild(new CParameterSelectionKiv(this));
    AddChild(new CMTSolutionTechniqueKiv(this));
    AddChild(new CMTWaterColumnKiv(this));
    AddChild(new CMTBedGroupKiv(this));
    AddChild(new CMTForcingsGroupKiv(this));
    AddChild(new CMTDredgingKiv(this));
    AddChild(new CMTDispersionKiv(this));
    AddChild(new CMTSourceKiv(this));
    AddChild(new CInitialConditionsKiv(this));
    AddChild(new CMTBoundaryConditionsKiv(this));
    AddChild(new CMTMorphologyKiv(this));
    AddChild(new CMTOutputKiv(this));
}

CMudTransportModuleKiv::~CMudTransportModuleKiv() { GetRoot()->UnregisterImportantNode(kKey); }

void CMudTransportModuleKiv::WriteData(void* h) {
    kivPutParam(h, "mode", ModuleSelection(this)->Mode());
}

void CMudTransportModuleKiv::ReadData(void* h) {
    CModuleSelection* selection = ModuleSelection(this);
    int mode = selection->Mode();
    kivGetParam(h, "mode", &mode, 1, 1);
    selection->Mode(mode);
}

bool CMudTransportModuleKiv::IsDlgUsedInSetup() { return ModuleSelection(this)->Mode() == 2; }

const char* CMudTransportModuleKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMudTransportModuleDlg"
                                           : CFemKivGroupBase::GetDlgRuntimeClass(code);
}

void CMudTransportModuleKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kMode{"mode", KeywordType::Int, "2",
                                   "How the module runs, as the module selection says"};
    sink.Add(kMode);
}
