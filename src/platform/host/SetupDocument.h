// The host's document: the host's own nodes and the mud-transport module, read from and
// written to one setup file. Top-level sections that neither owns are kept as read.
#pragma once

#include "paramfile/ParamFile.h"
#include "setupeditor/ZoSEKivBase.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

class CMudTransportModuleKiv;
class CModuleSelection;
class CDomainKiv;
class CSimulationPeriodKiv;
class CHDDensityKiv;
class CBoundaryNamesKiv;
class CHDBoundaryConditionsKiv;
class CHDSourcesKiv;
class CHDWindForcingKiv;

class CSetupDocument : public CZoSEKivGlobalBase {
public:
    // A new setup with every default.
    CSetupDocument();
    ~CSetupDocument() override;

    struct OpenResult {
        std::unique_ptr<CSetupDocument> document;      // null when error is set
        std::optional<paramfile::Diagnostic> error;    // unreadable file or syntax error
        // Values that could not be used, content no node reads, counts that disagree...,
        // in the order of the file.
        std::vector<paramfile::Diagnostic> warnings;
    };
    static OpenResult Open(const std::string& path);
    static OpenResult FromText(std::string text, const std::string& fileName);

    // The whole setup in its canonical form.
    std::string ToText();
    // Brings the nodes back to a state that ToText wrote earlier (undo and redo); the
    // sections of other modules stay as read. False, and nothing changed, when the text does
    // not parse.
    bool Restore(const std::string& text);
    // One node's part of the text, written on its own (no comments of the file): the undo
    // history keeps these for edits that stay within a node.
    static std::string NodeText(CZoSEKivBase* node);
    // Reads text that NodeText wrote back into the same node; false when it does not parse.
    static bool RestoreNode(CZoSEKivBase* node, const std::string& text);
    // A node's place as positions among its parents' children (properties count from -1
    // down), valid while the tree keeps its shape; empty for a node outside this document.
    std::vector<int> PlaceOf(const CZoSEKivBase* node);
    CZoSEKivBase* NodeAt(const std::vector<int>& place);
    // Atomic: on failure the file on disk and this document stay as they were. Saved into
    // another folder, every relative file name is rewritten to name the same file from there
    // (in the file and in the nodes, RebasedFileName). Saving to the file that was read
    // writes nothing when another program saved it since (changed is then set), unless
    // overwrite is true.
    bool SaveAs(const std::string& path, std::string* error, bool* changed = nullptr,
                bool overwrite = false);

    // What the file held that no node reads, so that saving drops it (one warning each, also
    // among the warnings of Open). Empty after the first successful save.
    const std::vector<paramfile::Diagnostic>& DroppedOnSave() const { return m_dropped; }

    // Clears the error list and validates the host's nodes and, when it is in use, the module.
    int ValidateAll();

    const std::string& FileName() const { return m_fileName; }
    CString DocumentFolder() const override;
    // Kept with the module selection.
    int DecoupledSimulation() const override;
    CMudTransportModuleKiv* Module() const { return m_module; }
    CModuleSelection* GetModuleSelection() const { return m_moduleSelection; }
    CDomainKiv* GetDomain() const { return m_domain; }
    CSimulationPeriodKiv* GetPeriod() const { return m_period; }
    CHDDensityKiv* GetDensity() const { return m_density; }
    CBoundaryNamesKiv* GetBoundaryNames() const;
    CHDBoundaryConditionsKiv* GetBoundaryConditions() const { return m_boundaryConditions; }
    CHDSourcesKiv* GetSources() const { return m_sources; }
    CHDWindForcingKiv* GetWind() const { return m_wind; }

    // Where a window shows the tree, nodes ask it to select another node through this.
    void SetTreeItemSelector(std::function<void(CZoSEKivBase*)> selector) {
        m_selector = std::move(selector);
    }
    void SelectTreeItem(CZoSEKivBase* node) override;

private:
    template <class T>
    T* AddHostNode(T* node) {
        AddChild(node);
        return node;
    }
    static OpenResult FromParsed(paramfile::ParseResult parsed, const std::string& fileName);
    // The folder relative file names are taken from: the file's, or the current one for a
    // setup not yet saved.
    std::string NamesFolder() const;
    std::string ToText(const std::string& fromFolder, const std::string& toFolder);
    CZoSEKivBase* OwnerOf(std::string_view sectionName);
    // Reports what loading passed over: content no node read, a module section that is
    // missing or repeated.
    void CheckWhatWasRead(std::vector<paramfile::Diagnostic>& warnings);

    std::string m_fileName;
    // The file as read or last saved; unknown for a new setup.
    fileio::FileIdentity m_identity;
    // What was read, for the top-level sections that are kept as they were.
    std::unique_ptr<paramfile::Document> m_source;
    std::vector<paramfile::Diagnostic> m_dropped;
    CMudTransportModuleKiv* m_module = nullptr;
    CModuleSelection* m_moduleSelection = nullptr;
    CDomainKiv* m_domain = nullptr;
    CSimulationPeriodKiv* m_period = nullptr;
    CHDDensityKiv* m_density = nullptr;
    CHDSourcesKiv* m_sources = nullptr;
    CHDWindForcingKiv* m_wind = nullptr;
    CHDBoundaryConditionsKiv* m_boundaryConditions = nullptr;
    std::function<void(CZoSEKivBase*)> m_selector;
};
