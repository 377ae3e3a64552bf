#include "SetupDocument.h"

#include "ModuleSelection.h"
#include "common/FileNames.h"
#include "core/MudTransportModuleKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "hydro/HDBoundaryConditionsKiv.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"

#include <algorithm>
#include <filesystem>
#include <set>

CSetupDocument::CSetupDocument() {
    // Host nodes first: the module reads them while it is built and loaded.
    m_moduleSelection = AddHostNode(new CModuleSelection(this));
    m_domain = AddHostNode(new CDomainKiv(this));
    m_period = AddHostNode(new CSimulationPeriodKiv(this));
    m_density = AddHostNode(new CHDDensityKiv(this));
    m_sources = AddHostNode(new CHDSourcesKiv(this));
    m_wind = AddHostNode(new CHDWindForcingKiv(this));
    // A view of the boundaries with no section of its own; it follows them.
    m_boundaryConditions = AddHostNode(new CHDBoundaryConditionsKiv(this));
    m_module = new CMudTransportModuleKiv(this);
    AddChild(m_module);
}

CSetupDocument::~CSetupDocument() = default;

namespace {
std::string FolderOf(const std::string& fileName) {
    std::error_code ec;
    const std::filesystem::path full = std::filesystem::absolute(fileName, ec);
    if (ec)
        return {};
    return full.lexically_normal().parent_path().string();
}
}  // namespace

CString CSetupDocument::DocumentFolder() const {
    return m_fileName.empty() ? CString() : FolderOf(m_fileName);
}

std::string CSetupDocument::NamesFolder() const {
    if (!m_fileName.empty())
        return DocumentFolder();
    std::error_code ec;
    return std::filesystem::current_path(ec).lexically_normal().string();
}

int CSetupDocument::DecoupledSimulation() const {
    return m_moduleSelection->DecoupledSimulation() ? 1 : 0;
}

CBoundaryNamesKiv* CSetupDocument::GetBoundaryNames() const { return m_domain->BoundaryNames(); }

void CSetupDocument::SelectTreeItem(CZoSEKivBase* node) {
    if (m_selector)
        m_selector(node);
}

CSetupDocument::OpenResult CSetupDocument::Open(const std::string& path) {
    return FromParsed(paramfile::ParseFile(path), path);
}

CSetupDocument::OpenResult CSetupDocument::FromText(std::string text, const std::string& fileName) {
    return FromParsed(paramfile::ParseText(std::move(text), fileName), fileName);
}

CSetupDocument::OpenResult CSetupDocument::FromParsed(paramfile::ParseResult parsed,
                                                      const std::string& fileName) {
    OpenResult result;
    if (parsed.error) {
        result.error = parsed.error;
        // What the parser would say of a picture or a data file helps nobody.
        if (parsed.beforeFirstSection)
            result.error = paramfile::Diagnostic{
                fileName, {},
                FormatString("%s is not a setup file: no section at line %d", fileName.c_str(),
                             parsed.error->pos.line)};
        return result;
    }
    auto doc = std::make_unique<CSetupDocument>();
    doc->m_fileName = fileName;
    doc->m_identity = parsed.identity;
    void* top = const_cast<paramfile::Section*>(&parsed.document->Root());
    POSITION pos = 0;
    for (CZoSEKivBase* c = doc->GetFirstChild(pos); c; c = doc->GetNextChild(pos))
        c->Load(top);
    result.warnings = parsed.document->Warnings();
    doc->m_source = std::move(parsed.document);
    doc->CheckWhatWasRead(result.warnings);
    result.document = std::move(doc);
    return result;
}

bool CSetupDocument::Restore(const std::string& text) {
    paramfile::ParseResult parsed = paramfile::ParseText(text, m_fileName);
    if (parsed.error)
        return false;
    // ToText writes every section of the host and the module, so reading them over the
    // nodes in place leaves nothing of the state before.
    void* top = const_cast<paramfile::Section*>(&parsed.document->Root());
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        c->Load(top);
    return true;
}

std::string CSetupDocument::NodeText(CZoSEKivBase* node) {
    paramfile::Document out;
    paramfile::Builder builder(out);
    node->Save(&builder);
    return paramfile::WriteText(out);
}

bool CSetupDocument::RestoreNode(CZoSEKivBase* node, const std::string& text) {
    paramfile::ParseResult parsed = paramfile::ParseText(text, {});
    if (parsed.error)
        return false;
    node->Load(const_cast<paramfile::Section*>(&parsed.document->Root()));
    return true;
}

std::vector<int> CSetupDocument::PlaceOf(const CZoSEKivBase* node) {
    std::vector<int> place;
    for (; node && node != this; node = node->GetParent()) {
        CZoSEKivBase* parent = node->GetParent();
        if (!parent)
            return {};
        std::optional<int> index;
        POSITION pos = 0;
        int i = 0;
        for (CZoSEKivBase* c = parent->GetFirstChild(pos); c && !index; c = parent->GetNextChild(pos), ++i)
            if (c == node)
                index = i;
        for (int p = 0; p < parent->GetPropertyCount() && !index; ++p)
            if (parent->GetProperty(p) == node)
                index = -(p + 1);
        if (!index)
            return {};
        place.push_back(*index);
    }
    if (node != this)
        return {};
    std::reverse(place.begin(), place.end());
    return place;
}

CZoSEKivBase* CSetupDocument::NodeAt(const std::vector<int>& place) {
    CZoSEKivBase* node = this;
    for (int index : place) {
        if (index < 0) {
            node = node->GetProperty(-index - 1);
        } else {
            POSITION pos = 0;
            CZoSEKivBase* c = node->GetFirstChild(pos);
            for (int i = 0; c && i < index; ++i)
                c = node->GetNextChild(pos);
            node = c;
        }
        if (!node)
            return nullptr;
    }
    return node;
}

CZoSEKivBase* CSetupDocument::OwnerOf(std::string_view sectionName) {
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        if (!c->GetSectionNamePattern().empty() && c->GetSectionName() == sectionName)
            return c;
    return nullptr;
}

void CSetupDocument::CheckWhatWasRead(std::vector<paramfile::Diagnostic>& warnings) {
    const paramfile::Section& root = m_source->Root();
    // Sections of other modules are kept as read; those of the host and the module are
    // written again from what was read, so whatever no node read would be lost.
    for (int i = 0; i < root.EntryCount(); ++i) {
        const paramfile::Section& s = root.SectionAt(i);
        if (!OwnerOf(s.Name()))
            continue;
        if (s.WasFound()) {
            std::vector<paramfile::Diagnostic> unread =
                paramfile::UnreadEntries(s, std::string(s.Name()));
            m_dropped.insert(m_dropped.end(), unread.begin(), unread.end());
            continue;
        }
        const paramfile::Section* first = root.FindSection(s.Name());
        warnings.push_back(paramfile::Diagnostic{
            m_fileName, s.Pos(),
            FormatString("section '%s' repeated at the top level (first at line %d): only the "
                         "first is read, this one is kept as it is",
                         std::string(s.Name()).c_str(), first ? first->Pos().line : 0)});
    }
    if (!root.FindSection(m_module->GetSectionName()))
        warnings.push_back(paramfile::Diagnostic{
            m_fileName, m_source->End(),
            FormatString("no section '%s' in the file: the module takes its defaults",
                         m_module->GetSectionName().c_str())});
    warnings.insert(warnings.end(), m_dropped.begin(), m_dropped.end());
    std::stable_sort(warnings.begin(), warnings.end(),
                     [](const paramfile::Diagnostic& a, const paramfile::Diagnostic& b) {
                         return a.pos.line != b.pos.line ? a.pos.line < b.pos.line
                                                         : a.pos.column < b.pos.column;
                     });
}

std::string CSetupDocument::ToText() { return ToText({}, {}); }

std::string CSetupDocument::ToText(const std::string& fromFolder, const std::string& toFolder) {
    paramfile::Document out;
    paramfile::Builder builder(out);
    void* h = &builder;
    // Sections of other modules are copied through the builder too, so their names follow.
    if (!fromFolder.empty() && !toFolder.empty() && fromFolder != toFolder)
        builder.MapFileNames([&](std::string_view name) {
            return RebasedFileName(name, fromFolder, toFolder);
        });

    std::set<CString> written;
    // Sections keep the places they had in the file; new ones follow in the host's order.
    if (m_source) {
        builder.TakeCommentsFrom(*m_source);
        const paramfile::Section& root = m_source->Root();
        for (int i = 0; i < root.EntryCount(); ++i) {
            if (!root.EntryIsSection(i))
                continue;
            const paramfile::Section& s = root.SectionAt(i);
            CZoSEKivBase* owner = OwnerOf(s.Name());
            if (owner && written.insert(owner->GetSectionName()).second)
                owner->Save(h);
            else
                builder.CopySection(s);
        }
    }
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
        if (written.insert(c->GetSectionName()).second)
            c->Save(h);
    return paramfile::WriteText(out);
}

bool CSetupDocument::SaveAs(const std::string& path, std::string* error, bool* changed,
                            bool overwrite) {
    const std::string from = NamesFolder(), to = FolderOf(path);
    const bool moved = !from.empty() && !to.empty() && from != to;
    const std::string text = moved ? ToText(from, to) : ToText();
    auto normal = [](const std::string& p) {
        std::error_code ec;
        const std::filesystem::path a = std::filesystem::absolute(p, ec);
        return (ec ? std::filesystem::path(p) : a).lexically_normal();
    };
    const bool sameFile = !m_fileName.empty() && normal(path) == normal(m_fileName);
    const fileio::FileIdentity* expected = sameFile && !overwrite ? &m_identity : nullptr;
    fileio::FileIdentity written;
    if (!fileio::WriteFileAtomic(path, text, error, expected, changed, &written))
        return false;
    m_identity = written;
    m_fileName = path;
    m_dropped.clear();
    if (moved) {
        // The nodes and the kept sections take the names as written: the setup is now the
        // file, and saving it again changes nothing.
        paramfile::ParseResult parsed = paramfile::ParseText(text, m_fileName);
        if (parsed.document) {
            void* top = const_cast<paramfile::Section*>(&parsed.document->Root());
            POSITION pos = 0;
            for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
                c->Load(top);
            m_source = std::move(parsed.document);
        }
    }
    return true;
}

int CSetupDocument::ValidateAll() {
    ClearErrors();
    int ok = 1;
    POSITION pos = 0;
    for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos)) {
        if (c == m_module && !m_module->IsDlgUsedInSetup())
            continue;
        ok &= c->Validate();
    }
    return ok;
}
