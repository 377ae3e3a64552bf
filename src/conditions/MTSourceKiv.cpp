#include "MTSourceKiv.h"

#include "setupeditor/Keywords.h"
#include "MTFollowedCount.h"
#include "hydro/HDSourcesKiv.h"
#include "watercolumn/MTReadChecks.h"

#include <algorithm>

namespace {
const char* const kKey = "MTSource";
}

CMTSourceItemSubKiv::CMTSourceItemSubKiv(CZoSEKivBase* parent)
    : CZoSEKivGroupBase("Title", "SSC_FRACTION_%d", parent) {
    // Components are only ever appended, so the number they get is the count plus one.
    int number = 1;
    if (auto* source = dynamic_cast<CZoSEKivListBaseInterface*>(parent))
        number = source->GetItemCount() + 1;
    SetTitle(FormatString("Fraction %d", number));
    m_value = new CFemInDataKiv("", GetTitlePattern(), 1, false, false, 0.0, 100403, this);
    AddChild(m_value);
}

CString CMTSourceItemSubKiv::TypeText(int type) {
    switch (type) {
    case kSpecifiedConcentration: return "Specified concentration";
    case kExcessConcentration: return "Excess concentration";
    default: return FormatString("Type %d", type);
    }
}

void CMTSourceItemSubKiv::WriteData(void* h) {
    // The value is written after this, as a child, and carries the type with it.
    m_value->Type(m_type + 1);
    kivPutParam(h, "type_of_component", m_type);
}

void CMTSourceItemSubKiv::ReadData(void* h) {
    kivGetParam(h, "type_of_component", &m_type, 1, 1);
    WarnUnknownChoice(h, "type_of_component", m_type, kSpecifiedConcentration,
                      kExcessConcentration);
}

const char* CMTSourceItemSubKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSourceItemSubDlg"
                                           : CZoSEKivGroupBase::GetDlgRuntimeClass(code);
}

void CMTSourceItemSubKiv::SetDefault() {
    m_type = kSpecifiedConcentration;
    m_value->SetDefault();
}

void CMTSourceItemSubKiv::Renew(int number) {
    SetDefault();
    SetTitle(FormatString("Fraction %d", number));
    m_value->SetTitle(GetTitlePattern());
    m_value->Type(0);
    m_value->Disable(false);
    m_value->SetHasBeenTouched(false);
    SetHasBeenTouched(false);
}

CMTSourceItemKiv::CMTSourceItemKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("", "SOURCE_%d", parent, MTCount::Fractions) {}

CMTSourceItemSubKiv* CMTSourceItemKiv::Create() {
    // Components are only ever appended: the one made now takes the place after the last.
    if (CMTSourceItemSubKiv* component = m_spares.Take()) {
        component->Renew(GetItemCount() + 1);
        return component;
    }
    return CMTCountListKiv::Create();
}

const CHDSourceItemKiv* CMTSourceItemKiv::HDSource() const {
    const CHDSourcesKiv* sources = HDSources(this);
    return sources ? sources->GetItem(GetNumberWhatAmI()) : nullptr;
}

CString CMTSourceItemKiv::GetTitle() const {
    const CHDSourceItemKiv* source = HDSource();
    return source ? source->Name() : CString();
}

bool CMTSourceItemKiv::IsDlgUsedInSetup() {
    const CHDSourceItemKiv* source = HDSource();
    return source && source->Include() != 0;
}

void CMTSourceItemKiv::LoadSize(void* h) { CheckFollowedCount(h, GetItemCount(), "fraction", "fractions"); }

// The name is for whoever reads the file; the title always comes from the hydrodynamic
// source, so the stored name is only looked up, so that it counts as read.
void CMTSourceItemKiv::WriteData(void* h) { kivPutParam(h, "name", GetTitle()); }
void CMTSourceItemKiv::ReadData(void* h) { kivKeywordByNameNum(h, "name", 1); }

const char* CMTSourceItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSourceItemDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

CMTSourceKiv::CMTSourceKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase("Sources", "SOURCES", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
    if (CHDSourcesKiv* sources = HDSources(this)) {
        sources->RegisterSyncedList(this, 1);
        SetItemCount(std::max(sources->GetItemCount(), 0), 1);
    }
    HelpID(0, 5037);
    HelpID(1, 5038);
}

CMTSourceKiv::~CMTSourceKiv() {
    GetRoot()->UnregisterImportantNode(kKey);
    if (CHDSourcesKiv* sources = HDSources(this))
        sources->UnRegisterSyncedList(this);
}

void CMTSourceKiv::LoadSize(void* h) {
    const CHDSourcesKiv* sources = HDSources(this);
    CheckFollowedCount(h, sources ? sources->GetItemCount() : GetItemCount(), "source", "sources");
}

const char* CMTSourceKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CHDSourceGisPropSheet"
                                           : CZoSEKivListBase::GetDlgRuntimeClass(code);
}

CMTSourceKiv* MTSources(const CZoSEKivBase* node) {
    return GetImportant<CMTSourceKiv>(node, kKey);
}

void CMTSourceItemSubKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kType{"type_of_component", KeywordType::Int, "0",
                                   "What the source brings of the fraction", 0, "",
                                   "0 specified concentration, 1 excess concentration"};
    sink.Add(kType);
}

void CMTSourceItemKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kName{"name", KeywordType::String, "",
                                   "Name of the hydrodynamic source, as the host names it"};
    sink.Add(kName);
}
