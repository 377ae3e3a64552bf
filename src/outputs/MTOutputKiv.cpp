#include "MTOutputKiv.h"

#include "setupeditor/Keywords.h"
#include "paramfile/Kiv.h"

namespace {
const char* const kKey = "MTOutputs";
}

CMTOutputKiv::CMTOutputKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase("Outputs", "OUTPUTS", parent) {
    SetItemCount(0, 1);
    GetRoot()->RegisterImportantNode(this, kKey);
}

CMTOutputKiv::~CMTOutputKiv() { GetRoot()->UnregisterImportantNode(kKey); }

bool CMTOutputKiv::NameNewOutputs() {
    bool renamed = false;
    for (int i = 1; i <= GetItemCount(); ++i) {
        CMTOutputItemMainKiv* output = GetItem(i);
        if (output->Title().starts_with("OUTPUTXXX")) {
            output->Title(FormatString("Output %d", i));
            renamed = true;
        }
    }
    return renamed;
}

void CMTOutputKiv::WriteData(void* h) { kivPutParam(h, "number_of_outputs", GetItemCount()); }

void CMTOutputKiv::ReadData(void* h) { ReadEngineCount(h, "number_of_outputs", "output"); }

const char* CMTOutputKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTOutputDlg"
                                           : CZoSEKivListBase::GetDlgRuntimeClass(code);
}

void CMTOutputKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kCount{"number_of_outputs", KeywordType::Int, "0",
                                    "Number of outputs (as ZoSEKivListItemCount)", 0, "0 .. 100000"};
    sink.Add(kCount);
}
