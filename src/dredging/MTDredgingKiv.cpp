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

// The list's own count has been applied already (LoadSize); number_of_dredgers, which the
// engine reads, has the last word. A count that is missing or cannot be used keeps the one
// held.
void CMTDredgingKiv::ReadData(void* h) {
    void* countKeyword = kivKeywordByNameNum(h, kCount, 1);
    int count = GetItemCount();
    kivGetParam(h, kCount, &count, 1, 1);
    kivGetParam(h, "update_bed", &m_updateBed, 1, 1);
    if (!countKeyword)
        return;
    if (count < 0 || count > kMaxListItemCount) {
        kivWarn(h, kCount,
                FormatString("%s = %d is not between 0 and %d; kept %d", kCount, count,
                             kMaxListItemCount, GetItemCount()));
        return;
    }
    if (kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1) && count != GetItemCount())
        kivWarn(h, kCount,
                FormatString("%s = %d, but ZoSEKivListItemCount = %d; %d dredger%s read", kCount,
                             count, GetItemCount(), count, count == 1 ? " is" : "s are"));
    SetItemCount(count, 1);
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
