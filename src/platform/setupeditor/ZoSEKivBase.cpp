#include "ZoSEKivBase.h"

#include "MessageTable.h"
#include "paramfile/Kiv.h"

#include <algorithm>

CZoSEKivBase::CZoSEKivBase(const CString& title, const CString& sectionName,
                           CZoSEKivBase* parent)
    : m_title(title), m_sectionName(sectionName), m_parent(parent) {
    if (parent)
        m_root = parent->m_root;
}

CZoSEKivBase::~CZoSEKivBase() { DeleteChildren(); }

void CZoSEKivBase::DeleteChildren() {
    // Later nodes may depend on earlier ones (lists on the model definition, module lists on
    // host lists), so the last goes first.
    while (!m_children.empty()) {
        CZoSEKivBase* c = m_children.back();
        m_children.pop_back();
        delete c;
    }
    while (!m_properties.empty()) {
        CZoSEKivBase* p = m_properties.back();
        m_properties.pop_back();
        delete p;
    }
}

void CZoSEKivBase::AddChild(CZoSEKivBase* node) {
    m_children.push_back(node);
    node->m_positionHint = static_cast<int>(m_children.size());
}

void CZoSEKivBase::AddProperty(CZoSEKivBase* node) { m_properties.push_back(node); }

void CZoSEKivBase::SwapChilds(int first, int second) {
    const int n = static_cast<int>(m_children.size());
    if (first < 0 || second < 0 || first >= n || second >= n)
        return;
    std::swap(m_children[first], m_children[second]);
    TellShapeChanged();
    m_children[first]->m_positionHint = first + 1;
    m_children[second]->m_positionHint = second + 1;
}

CZoSEKivBase* CZoSEKivBase::GetFirstChild(POSITION& pos) {
    pos = 0;
    return GetNextChild(pos);
}

CZoSEKivBase* CZoSEKivBase::GetNextChild(POSITION& pos) {
    if (pos < 0 || pos >= static_cast<int>(m_children.size()))
        return nullptr;
    return m_children[pos++];
}

CZoSEKivBase* CZoSEKivBase::GetFirstChild() {
    POSITION pos = 0;
    return GetFirstChild(pos);
}

CZoSEKivBase* CZoSEKivBase::GetNextChild(CZoSEKivBase* node) {
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        if (c == node)
            return GetNextChild(pos);
    return nullptr;
}

CZoSEKivBase* CZoSEKivBase::GetChild(int index) {
    if (index < 0 || index >= static_cast<int>(m_children.size()))
        return nullptr;
    return m_children[index];
}

int CZoSEKivBase::GetChildCount() { return static_cast<int>(m_children.size()); }

CZoSEKivBase* CZoSEKivBase::GetFirstProperty(POSITION& pos) {
    pos = 0;
    return GetNextProperty(pos);
}

CZoSEKivBase* CZoSEKivBase::GetNextProperty(POSITION& pos) {
    if (pos < 0 || pos >= static_cast<int>(m_properties.size()))
        return nullptr;
    return m_properties[pos++];
}

CZoSEKivBase* CZoSEKivBase::GetProperty(int index) {
    if (index < 0 || index >= static_cast<int>(m_properties.size()))
        return nullptr;
    return m_properties[index];
}

int CZoSEKivBase::GetNumberWhatIs(const CZoSEKivBase* node) {
    const int hint = node->m_positionHint;
    if (hint >= 1 && hint <= static_cast<int>(m_children.size()) && m_children[hint - 1] == node)
        return hint;
    return -1;
}

int CZoSEKivBase::GetNumberWhatAmI() const {
    return m_parent ? m_parent->GetNumberWhatIs(this) : -1;
}

void CZoSEKivBase::Save(void* h) {
    const bool own = !m_sectionName.empty();
    if (own)
        kivAddSection(h, GetSectionName().c_str());
    SaveSize(h);
    WriteData(h);
    for (CZoSEKivBase* p : m_properties)
        p->Save(h);
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        c->Save(h);
    if (own)
        kivEndSection(h);
}

void CZoSEKivBase::Load(void* h) {
    void* section = h;
    if (!m_sectionName.empty())
        section = h ? kivSectionByNameNum(h, GetSectionName().c_str(), 1) : nullptr;
    if (!section)
        return;
    LoadSize(section);
    ReadData(section);
    for (CZoSEKivBase* p : m_properties)
        p->Load(section);
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        c->Load(section);
}

void CZoSEKivBase::TellShapeChanged() {
    if (m_root)
        m_root->NoteShapeChange();
}

void CZoSEKivBase::SaveSize(void*) {}
void CZoSEKivBase::LoadSize(void*) {}
void CZoSEKivBase::WriteData(void*) {}
void CZoSEKivBase::ReadData(void*) {}

int CZoSEKivBase::Validate() {
    int ok = ValidateData() ? 1 : 0;
    for (CZoSEKivBase* p : m_properties)
        ok &= p->Validate() ? 1 : 0;
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        ok &= c->Validate() ? 1 : 0;
    return ok;
}

int CZoSEKivBase::ValidateData() { return 1; }
bool CZoSEKivBase::IsDlgUsedInSetup() { return true; }
bool CZoSEKivBase::IsDataUsedInSetup() { return IsDlgUsedInSetup(); }
void CZoSEKivBase::SetDefault() {}
bool CZoSEKivBase::GetSectionUsed() { return true; }
const char* CZoSEKivBase::GetDlgRuntimeClass(unsigned) { return nullptr; }

CString CZoSEKivBase::GetTitle() const {
    if (!HasNumberPattern(m_title))
        return m_title;
    return ExpandNumberPattern(m_title, GetNumberWhatAmI());
}

void CZoSEKivBase::SetTitle(const CString& title) { m_title = title; }

CString CZoSEKivBase::GetAbbreviatedTitle() const {
    return m_abbreviatedTitle.empty() ? GetTitle() : m_abbreviatedTitle;
}

void CZoSEKivBase::SetAbbreviatedTitle(const CString& title) { m_abbreviatedTitle = title; }

CString CZoSEKivBase::GetSectionName() const {
    if (!HasNumberPattern(m_sectionName))
        return m_sectionName;
    return ExpandNumberPattern(m_sectionName, GetNumberWhatAmI());
}

void CZoSEKivBase::AddError(unsigned messageId) { AddError(LoadMessage(messageId)); }

void CZoSEKivBase::AddError(unsigned messageId, const CString& detail) {
    if (m_root)
        m_root->ReportError(this, LoadMessage(messageId), detail);
}

void CZoSEKivBase::AddError(const CString& text) {
    if (m_root)
        m_root->ReportError(this, text);
}

void CZoSEKivBase::TouchAllChildren() {
    m_touched = true;
    for (CZoSEKivBase* p : m_properties)
        p->TouchAllChildren();
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        c->TouchAllChildren();
}

// --- document root ------------------------------------------------------------------

CZoSEKivGlobalBase::CZoSEKivGlobalBase() : CZoSEKivBase("", "", nullptr) { m_root = this; }

// Children unregister themselves from the registry as they go, so they go first.
CZoSEKivGlobalBase::~CZoSEKivGlobalBase() { DeleteChildren(); }

void CZoSEKivGlobalBase::RegisterImportantNode(CZoSEKivBase* node, const CString& key) {
    for (Entry& e : m_registry)
        if (e.key == key) {
            e.node = node;
            return;
        }
    m_registry.push_back({key, node});
}

void CZoSEKivGlobalBase::UnregisterImportantNode(const CString& key) {
    std::erase_if(m_registry, [&](const Entry& e) { return e.key == key; });
}

CZoSEKivBase* CZoSEKivGlobalBase::GetImportantNode(const CString& key) const {
    for (const Entry& e : m_registry)
        if (e.key == key)
            return e.node;
    return nullptr;
}

void CZoSEKivGlobalBase::ReportError(CZoSEKivBase* node, const CString& message,
                                     const CString& detail) {
    m_errors.push_back({node, message, detail});
}

void CZoSEKivGlobalBase::SelectTreeItem(CZoSEKivBase*) {}

CString NodePath(const CZoSEKivBase* node) {
    std::vector<CString> parts;
    for (const CZoSEKivBase* n = node; n && n->GetParent(); n = n->GetParent()) {
        CString name = n->GetSectionName();
        if (name.empty())
            name = n->GetTitle();
        if (!name.empty())
            parts.push_back(name);
    }
    CString path;
    for (auto it = parts.rbegin(); it != parts.rend(); ++it) {
        if (!path.empty())
            path += '/';
        path += *it;
    }
    return path;
}
