#include "MTOutputItemSubMassbudgetKiv.h"

#include "MTOutputItemMainKiv.h"
#include "core/ParameterSelectionKiv.h"

CMTOutputItemSubMassbudgetKiv::CMTOutputItemSubMassbudgetKiv(CZoSEKivBase* parent)
    : COutputItemsKiv("Parameters", "MASSBUDGET", parent) {
    if (CParameterSelectionKiv* model = ModelDefinition(this))
        Listen(model);
    Rebuild();
}

void CMTOutputItemSubMassbudgetKiv::Rebuild() {
    RemoveAllItems();
    const CParameterSelectionKiv* model = ModelDefinition(this);
    const int fractions = model ? model->NumberOfFractions() : 0;
    for (int f = 1; f <= fractions; ++f)
        AddBasicItem(FormatString("SSC - fraction %d", f), FormatString("SSC_FRACTION_%d", f), 1,
                     true);
}

bool CMTOutputItemSubMassbudgetKiv::IsDlgUsedInSetup() {
    auto* output = dynamic_cast<CMTOutputItemMainKiv*>(GetParent());
    return output && output->Type() == 3;
}

const char* CMTOutputItemSubMassbudgetKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "COutputItemsDlg"
                                           : COutputItemsKiv::GetDlgRuntimeClass(code);
}

void CMTOutputItemSubMassbudgetKiv::Notify(CFemNotifier* notifier, ENotifyMessage message) {
    if (message == kNotifyFractions)
        Rebuild();
    CFemListener::Notify(notifier, message);
}
