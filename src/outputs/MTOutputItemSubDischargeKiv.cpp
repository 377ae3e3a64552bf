#include "MTOutputItemSubDischargeKiv.h"

#include "setupeditor/Keywords.h"
#include "MTOutputItemMainKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "paramfile/Kiv.h"

CMTOutputItemSubDischargeKiv::CMTOutputItemSubDischargeKiv(CZoSEKivBase* parent)
    : COutputItemsKiv("Parameters", "DISCHARGE", parent) {
    if (CParameterSelectionKiv* model = ModelDefinition(this))
        Listen(model);
    Rebuild();
}

void CMTOutputItemSubDischargeKiv::Rebuild() {
    RemoveAllItems();
    for (const char* keyword : {"DISCHARGE_POSITIVE", "ACCUMULATED_DISCHARGE_POSITIVE",
                                "DISCHARGE_NEGATIVE", "ACCUMULATED_DISCHARGE_NEGATIVE"})
        AddBasicItem("", keyword, 1, true);
    const CParameterSelectionKiv* model = ModelDefinition(this);
    const int fractions = model ? model->NumberOfFractions() : 0;
    for (int f = 1; f <= fractions; ++f)
        AddBasicItem(FormatString("SSC - fraction %d", f), FormatString("SSC_FRACTION_%d", f), 1,
                     true);
}

void CMTOutputItemSubDischargeKiv::WriteData(void* h) {
    kivPutParam(h, "Type", m_type);
    COutputItemsKiv::WriteData(h);
}

void CMTOutputItemSubDischargeKiv::ReadData(void* h) {
    kivGetParam(h, "Type", &m_type, 1, 1);
    COutputItemsKiv::ReadData(h);
}

bool CMTOutputItemSubDischargeKiv::IsDlgUsedInSetup() {
    auto* output = dynamic_cast<CMTOutputItemMainKiv*>(GetParent());
    return output && output->Type() == 4;
}

const char* CMTOutputItemSubDischargeKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTOutputDischargeDlg"
                                           : COutputItemsKiv::GetDlgRuntimeClass(code);
}

void CMTOutputItemSubDischargeKiv::Notify(CFemNotifier* notifier, ENotifyMessage message) {
    if (message == kNotifyFractions)
        Rebuild();
    CFemListener::Notify(notifier, message);
}

void CMTOutputItemSubDischargeKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kType{"Type", KeywordType::Int, "1", "Quantities of the discharge output",
                                   0, "", "1 basic, 2 extended"};
    sink.Add(kType);
    COutputItemsKiv::DescribeKeywords(sink);
}
