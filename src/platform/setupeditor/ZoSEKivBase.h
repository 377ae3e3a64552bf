// Nodes of the setup tree: every section of a setup is a node that saves, loads and
// validates itself and its children, and hands the editor the name of its dialog.
#pragma once

#include "common/Platform.h"

#include <memory>
#include <vector>

class CZoSEKivGlobalBase;
class KeywordSink;

// Dialogs are asked for with this code; other codes are the framework's own.
constexpr unsigned kDlgRuntimeClassRequest = 2555;

class CZoSEKivBase {
public:
    // "%d" in title or section name stands for the node's 1-based position in its list.
    CZoSEKivBase(const CString& title, const CString& sectionName, CZoSEKivBase* parent);
    virtual ~CZoSEKivBase();
    CZoSEKivBase(const CZoSEKivBase&) = delete;
    CZoSEKivBase& operator=(const CZoSEKivBase&) = delete;

    CZoSEKivBase* GetParent() const { return m_parent; }
    CZoSEKivGlobalBase* GetRoot() const { return m_root; }

    // Children and properties are owned and kept in the order added.
    void AddChild(CZoSEKivBase* node);
    void AddProperty(CZoSEKivBase* node);
    virtual void SwapChilds(int first, int second);  // 0-based positions among the children

    // Iteration visits every child the walks must reach; lists add their items after the
    // ordinary children. POSITION starts at 0.
    virtual CZoSEKivBase* GetFirstChild(POSITION& pos);
    virtual CZoSEKivBase* GetNextChild(POSITION& pos);
    CZoSEKivBase* GetFirstChild();
    CZoSEKivBase* GetNextChild(CZoSEKivBase* node);
    virtual CZoSEKivBase* GetChild(int index);  // 0-based
    virtual int GetChildCount();
    CZoSEKivBase* GetFirstProperty(POSITION& pos);
    CZoSEKivBase* GetNextProperty(POSITION& pos);
    CZoSEKivBase* GetProperty(int index);
    int GetPropertyCount() const { return static_cast<int>(m_properties.size()); }

    // 1-based position of node among this node's children (lists: among the items), or -1.
    virtual int GetNumberWhatIs(const CZoSEKivBase* node);
    int GetNumberWhatAmI() const;

    // Persistence through the parameter-file handles (write: builder, read: section).
    virtual void Save(void* h);
    virtual void Load(void* h);
    virtual void SaveSize(void* h);
    virtual void LoadSize(void* h);
    virtual void WriteData(void* h);
    virtual void ReadData(void* h);
    // Declares every keyword WriteData (and SaveSize) may write, for the keyword reference.
    virtual void DescribeKeywords(KeywordSink&) {}
    virtual void DescribeSize(KeywordSink&) {}

    // Validation: 1 valid, 0 when messages were added.
    virtual int Validate();
    virtual int ValidateData();
    virtual bool IsDlgUsedInSetup();
    virtual bool IsDataUsedInSetup();
    virtual void SetDefault();
    virtual bool GetSectionUsed();

    // The dialog's class name for code 2555, else null (the framework's choice).
    virtual const char* GetDlgRuntimeClass(unsigned code);

    virtual CString GetTitle() const;
    virtual void SetTitle(const CString& title);
    virtual CString GetAbbreviatedTitle() const;
    virtual void SetAbbreviatedTitle(const CString& title);
    // The section name with "%d" expanded; empty when the node writes into its parent's.
    CString GetSectionName() const;
    const CString& GetSectionNamePattern() const { return m_sectionName; }
    void SetSectionName(const CString& name) { m_sectionName = name; }
    void SectionName(const char* name) { m_sectionName = name ? name : ""; }
    const CString& GetTitlePattern() const { return m_title; }

    // Validation messages go to the document's error list.
    void AddError(unsigned messageId);
    void AddError(const CString& text);
    // A fixed message with the reason for this case.
    void AddError(unsigned messageId, const CString& detail);

    // A node counts as touched once the user edited it.
    bool GetHasBeenTouched() const { return m_touched; }
    void SetHasBeenTouched(bool touched) { m_touched = touched; }
    void TouchAllChildren();

    // Position cache for GetNumberWhatIs; owned by whoever numbers the node.
    int m_positionHint = 0;

protected:
    const std::vector<CZoSEKivBase*>& Children() const { return m_children; }
    void TellShapeChanged();
    // Deletes children and properties, last first, while this node is still whole.
    void DeleteChildren();
    CZoSEKivGlobalBase* m_root = nullptr;

private:
    CString m_title;
    CString m_abbreviatedTitle;
    CString m_sectionName;
    CZoSEKivBase* m_parent;
    std::vector<CZoSEKivBase*> m_children;
    std::vector<CZoSEKivBase*> m_properties;
    bool m_touched = false;
};

class CZoSEKivGroupBase : public CZoSEKivBase {
public:
    using CZoSEKivBase::CZoSEKivBase;
};

// The document root: the registry of important nodes and the error list.
class CZoSEKivGlobalBase : public CZoSEKivBase {
public:
    CZoSEKivGlobalBase();
    ~CZoSEKivGlobalBase() override;

    void RegisterImportantNode(CZoSEKivBase* node, const CString& key);
    void UnregisterImportantNode(const CString& key);
    CZoSEKivBase* GetImportantNode(const CString& key) const;

    struct ErrorEntry {
        CZoSEKivBase* node;
        CString message;
        CString detail;  // why, where the message is a fixed text ("File is not valid")
        // "message: detail", or the message alone.
        CString Text() const { return detail.empty() ? message : message + ": " + detail; }
    };
    virtual void ReportError(CZoSEKivBase* node, const CString& message,
                             const CString& detail = {});
    const std::vector<ErrorEntry>& Errors() const { return m_errors; }
    void ClearErrors() { m_errors.clear(); }

    // Where the editor shows the tree, it selects nodes; elsewhere nothing happens.
    virtual void SelectTreeItem(CZoSEKivBase* node);
    // The folder of the setup file, against which relative data-file names are taken;
    // empty for a document that has no file (names are then taken as they stand).
    virtual CString DocumentFolder() const { return {}; }
    // 1 when the setup runs decoupled from stored flow results, so that no other module's
    // simulation (a spectral-wave one) runs alongside; 0 otherwise.
    virtual int DecoupledSimulation() const { return 0; }

    // Counts changes of the tree's shape (items added, removed or moved), so that the undo
    // history can tell an edit of values from one that remade nodes.
    unsigned long ShapeChanges() const { return m_shapeChanges; }
    void NoteShapeChange() { ++m_shapeChanges; }

private:
    struct Entry {
        CString key;
        CZoSEKivBase* node;
    };
    std::vector<Entry> m_registry;
    std::vector<ErrorEntry> m_errors;
    unsigned long m_shapeChanges = 0;
};

// Typed registry look-up; the key's owner guarantees the type.
template <class T>
T* GetImportant(const CZoSEKivBase* from, const char* key) {
    if (!from->GetRoot())
        return nullptr;
    return dynamic_cast<T*>(from->GetRoot()->GetImportantNode(key));
}

// The place of a node in the tree: section names from the top down joined by '/', the
// title standing in where a node has no section name.
CString NodePath(const CZoSEKivBase* node);
