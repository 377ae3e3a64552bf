#include "MTDredgingKiv.h"

#include "paramfile/Kiv.h"

namespace {
const char* const kKey = "MTDredgings";
const char* const kCount = "number_of_dredgers";
}  // namespace

CMTDredgingKiv::CMTDredgingKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase<CMTDredgingItemsKiv>("Dredging", "DREDGING", parent) {
    if (GetRoot())
        GetRoot()->RegisterImportantNode(this, kKey);
}

CMTDredgingKiv::~CMTDredgingKiv() {
    if (GetRoot())
        GetRoot()->UnregisterImportantNode(kKey);
}

void CMTDredgingKiv::WriteData(void* h) {
    kivPutParam(h, kCount, GetItemCount());
    kivPutParam(h, "update_bed", m_updateBed);
}

void CMTDredgingKiv::ReadData(void* h) {
    ReadEngineCount(h, kCount, "dredger");
    kivGetParam(h, "update_bed", &m_updateBed, 1, 1);
}

const char* CMTDredgingKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest
               ? "CMTDredgingDlg"
               : CZoSEKivListBase<CMTDredgingItemsKiv>::GetDlgRuntimeClass(code);
}

void CMTDredgingKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kDecls[] = {
        {kCount, KeywordType::Int, "0", "Number of dredgers (as ZoSEKivListItemCount)"},
        {"update_bed", KeywordType::Bool, "true", "Whether dredging changes the bed"},
    };
    sink.Add(kDecls);
}
