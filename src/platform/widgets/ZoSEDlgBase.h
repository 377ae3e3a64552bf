// Section dialogs: a form bound to one node. The editor (or a test) is the dialog's host:
// it receives the update hints, selects tree items and shows help.
#pragma once

#include "fem/FemHelpBase.h"
#include "setupeditor/ZoSEKivBase.h"

#include <QWidget>

#include <functional>

class CZoSEDlgBase;

// Update hints: what changed in the node.
enum UpdateHint : int {
    kHintValueChanged = 1,
    kHintItemsAdded = 2,
    kHintItemsDeleted = 4,
    kHintTitleChanged = 8,
    kHintItemsReordered = 16,
};

class CDialogHost {
public:
    virtual ~CDialogHost() = default;
    // The node of the dialog changed; the host refreshes its views (and the dialog's SetData).
    virtual void UpdateDoc(CZoSEDlgBase* dialog, int hint) = 0;
    virtual void SelectTreeItem(CZoSEKivBase* node) = 0;
    virtual void ShowHelp(unsigned long helpId) = 0;
    // A path relative to the setup file made absolute (unchanged when already absolute).
    virtual CString AbsoluteFilePath(const CString& path) = 0;
};

class CZoSEDlgBase : public QWidget, public CFemHelpBase {
    Q_OBJECT
public:
    explicit CZoSEDlgBase(QWidget* parent = nullptr);
    ~CZoSEDlgBase() override;

    // Binds the dialog to its node and host; Initialize follows.
    void Attach(CZoSEKivBase* node, CDialogHost* host);
    CZoSEKivBase* GetSection() const { return m_node; }
    template <class T>
    T* Section() const {
        return dynamic_cast<T*>(m_node);
    }
    CDialogHost* Host() const { return m_host; }

    // One-time set-up; overrides build their controls, then call the base last.
    virtual void Initialize();
    // Fills the controls from the node and applies the enabling rules. The base refreshes
    // every bound number field (CZoNumberEdit); overrides call it first.
    virtual void SetData();
    // Tells the host that the node changed; the node counts as touched from then on.
    // The host refreshes the dialog (SetData) before this returns, and must not delete the
    // dialog inside the call (deleteLater).
    void UpdateDoc(int hint);
    // The help command (also F1): shows the topic of what the dialog shows now.
    void ShowHelp();
    // The topic of what the dialog shows now: its help id, or a page's on a sheet of pages.
    virtual unsigned long CurrentHelpID() const { return GetHelpID(); }
    // Selects another node in the editor's tree ("Go to..." links).
    void SelectTreeItem(CZoSEKivBase* node);
    // A path relative to the setup file made absolute; unchanged without a host.
    CString AbsoluteFilePath(const CString& path) const;
    // Shows every bound number field's value again.
    void RefreshFields();
    // Layout helpers of the framework; Qt layouts do the work.
    void AddAlignRight(QWidget* widget);
    void HideCaption(int hide);

signals:
    // Another page is on show, so CurrentHelpID may have changed.
    void helpTopicChanged();

protected:
    void keyPressEvent(QKeyEvent* event) override;

    CZoSEKivBase* m_node = nullptr;
    CDialogHost* m_host = nullptr;
};

// The field whose change is being stored while a field stores itself, so that the host can
// name the edit (undo); null otherwise, when the focus widget tells.
QWidget* ZoEditSource();
class ZoEditSourceScope {
public:
    explicit ZoEditSourceScope(QWidget* field);
    ~ZoEditSourceScope();
    ZoEditSourceScope(const ZoEditSourceScope&) = delete;
    ZoEditSourceScope& operator=(const ZoEditSourceScope&) = delete;

private:
    QWidget* m_previous;
};

// Dialogs are created from the class name a node answers to GetDlgRuntimeClass(2555).
using DialogFactory = std::function<CZoSEDlgBase*()>;
bool RegisterDialogClass(const char* className, DialogFactory factory);
CZoSEDlgBase* CreateDialogFromClass(const char* className);  // null for unknown names
bool IsDialogClassRegistered(const char* className);

// In the dialog's .cpp: makes the class creatable from its name.
#define IMPLEMENT_DYNCREATE_DLG(cls)                                                         \
    [[maybe_unused]] static const bool cls##_dyncreate =                                     \
        RegisterDialogClass(#cls, []() -> CZoSEDlgBase* { return new cls; });
