#include "SetupDocument.h"

#include "ModuleSelection.h"
#include "core/MudTransportModuleKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "hydro/HDBoundaryConditionsKiv.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"

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

CString CSetupDocument::DocumentFolder() const {
    if (m_fileName.empty())
        return {};
    std::error_code ec;
    const std::filesystem::path full = std::filesystem::absolute(m_fileName, ec);
    if (ec)
        return {};
    return full.lexically_normal().parent_path().string();
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
        return result;
    }
    auto doc = std::make_unique<CSetupDocument>();
    doc->m_fileName = fileName;
    void* top = const_cast<paramfile::Section*>(&parsed.document->Root());
    POSITION pos = 0;
    for (CZoSEKivBase* c = doc->GetFirstChild(pos); c; c = doc->GetNextChild(pos))
        c->Load(top);
    result.warnings = parsed.document->Warnings();
    doc->m_source = std::move(parsed.document);
    result.document = std::move(doc);
    return result;
}

std::string CSetupDocument::ToText() {
    paramfile::Document out;
    paramfile::Builder builder(out);
    void* h = &builder;

    std::set<CString> written;
    auto ownerOf = [&](std::string_view name) -> CZoSEKivBase* {
        POSITION pos = 0;
        for (CZoSEKivBase* c = GetFirstChild(pos); c; c = GetNextChild(pos))
            if (c->GetSectionName() == name)
                return c;
        return nullptr;
    };
    // Sections keep the places they had in the file; new ones follow in the host's order.
    if (m_source) {
        const paramfile::Section& root = m_source->Root();
        for (int i = 0; i < root.EntryCount(); ++i) {
            if (!root.EntryIsSection(i))
                continue;
            const paramfile::Section& s = root.SectionAt(i);
            CZoSEKivBase* owner = ownerOf(s.Name());
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

bool CSetupDocument::SaveAs(const std::string& path, std::string* error) {
    const std::string text = ToText();
    if (!paramfile::WriteFileAtomic(path, text, error))
        return false;
    m_fileName = path;
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
