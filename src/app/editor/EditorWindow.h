// The editor's main window: the navigation tree, the form of the selected section, the
// message list and the help pane, around one setup document.
#pragma once

#include "host/SetupDocument.h"
#include "widgets/ZoSEDlgBase.h"

#include <QMainWindow>
#include <QMessageBox>
#include <QPointer>

#include <functional>
#include <memory>
#include <unordered_set>
#include <vector>

class QAction;
class QLabel;
class QTimer;
class QUndoStack;
class CSetupHistory;
class QMenu;
class QScrollArea;
class QTextBrowser;
class QToolButton;
class QTreeWidget;
class QTreeWidgetItem;

class CEditorWindow : public QMainWindow, public CDialogHost {
    Q_OBJECT
public:
    explicit CEditorWindow(QWidget* parent = nullptr);
    ~CEditorWindow() override;

    // --- the document ---------------------------------------------------------------
    CSetupDocument& Document() const { return *m_doc; }
    bool IsModified() const { return m_modified; }
    // Every stored change.
    QUndoStack* UndoStack() const { return m_undo; }
    CSetupHistory& History() const { return *m_history; }
    // Undo and redo as the menu does them: a field being edited stores its value first.
    void Undo();
    void Redo();
    // A new setup with the given numbers of fractions and layers.
    void NewSetup(int fractions, int layers);
    // Opens a setup; on an unreadable file or a syntax error the message is shown and the
    // open document stays as it was. Warnings from reading go to the message list.
    bool OpenFile(const QString& path);
    // Validates, then saves atomically; on failure the reason is shown, the file on disk
    // stays as it was and the document stays modified. When saving would drop content that
    // reading reported, the user is asked first.
    bool SaveFile(const QString& path);
    // Asks what to do with unsaved changes; true when the caller may go on.
    bool MaybeSave();
    // Validates the whole setup and fills the message list; true when valid.
    bool Validate();
    // What the message list's "Copy" puts on the clipboard for the selected messages: one
    // line each, the keyword path and the message.
    QString MessagesText(bool selectedOnly) const;
    // A node's place as the user knows it: the titles from below the module (or the host
    // data) down, "Bed Parameters > Bed Roughness".
    QString TitlePath(const CZoSEKivBase* node) const;
    // Help > About.
    QString AboutText() const;

    // --- the tree and the pane ------------------------------------------------------
    // Selects the node with that path (NodePath form, host sections by their names).
    bool SelectPath(const QString& path);
    CZoSEKivBase* CurrentNode() const { return m_currentNode; }
    // The form shown for the current node, null for a placeholder.
    CZoSEDlgBase* CurrentDialog() const { return m_dialog; }
    QTreeWidget* Tree() const { return m_tree; }
    QTreeWidget* Messages() const { return m_messages; }
    QTextBrowser* HelpView() const { return m_help; }
    // Every node the tree shows, in tree order (module nodes, then host data).
    std::vector<CZoSEKivBase*> ShownNodes() const;

    // --- CDialogHost -------------------------------------------------------------------
    void UpdateDoc(CZoSEDlgBase* dialog, int hint) override;
    void SelectTreeItem(CZoSEKivBase* node) override;
    void ShowHelp(unsigned long helpId) override;
    CString AbsoluteFilePath(const CString& path) override;

    // Questions and messages to the user; tests answer them instead.
    struct Prompt {
        QMessageBox::Icon icon;
        QString title;
        QString text;
        QMessageBox::StandardButtons buttons;
    };
    using Prompter = std::function<QMessageBox::StandardButton(const Prompt&)>;
    void SetPrompter(Prompter prompter) { m_prompter = std::move(prompter); }

    // The window's size and docks as the user left them.
    void RestoreLayout();
    void SaveLayout();
    // Recreates the visible form, e.g. after the units changed.
    void RefreshDialog();

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    struct ShownEntry {
        CZoSEKivBase* node;
        int depth;
        bool operator==(const ShownEntry&) const = default;
    };

    void BuildActions();
    // Records a stored change on the undo stack under the edit's name.
    void RecordChange(CZoSEDlgBase* dialog, int hint);
    // Names the edit in the Undo menu: the field's label, a button's text, a grid's operation.
    QString EditName(CZoSEDlgBase* dialog, int hint) const;
    // Runs a change of the history (undo, redo); the tree and the form follow.
    void RestoreState(const std::function<void()>& change, bool structural);
    // The tree and the form again after the nodes were read anew (or only their values, when
    // rebuild is false); the form of the node at path when there was one.
    void ShowAgain(const CString& path, bool hadNode, bool rebuild = true);
    // Takes in changes that were made without an update hint (validation corrects some).
    void SyncState(const QString& name);
    void StartNewHistory();
    // Validates and lists the messages; quiet runs (after a change) leave the docks and the
    // form alone.
    bool RunValidation(bool quiet);
    void FillMessages(bool valid);
    void ShowHelpOfSelection();
    void BuildLayout();
    void SetDocument(std::unique_ptr<CSetupDocument> doc, const QString& path);
    void SetModified(bool modified);
    void UpdateTitle();
    QMessageBox::StandardButton Ask(const Prompt& prompt);
    void AddReadWarningItems();
    void AddMeshNoteItems();

    std::vector<ShownEntry> CollectModuleEntries() const;
    void RebuildTree();
    void RefreshTree();
    void StyleItem(QTreeWidgetItem* item, CZoSEKivBase* node);
    QString TitleOf(const CZoSEKivBase* node) const;
    QTreeWidgetItem* ItemOf(CZoSEKivBase* node) const;
    std::unordered_set<const CZoSEKivBase*> LiveNodes() const;

    void OnCurrentItemChanged(QTreeWidgetItem* item, QTreeWidgetItem* previous);
    void ShowNode(CZoSEKivBase* node);
    void CloseDialog(bool now);
    void CommitPendingEdit();
    unsigned long CurrentHelpId() const;
    bool IsHostNode(const CZoSEKivBase* node) const;
    void ShowReadWarnings(const std::vector<paramfile::Diagnostic>& warnings);
    void OnMessageActivated(QTreeWidgetItem* item);

    void OnNew();
    void OnOpen();
    bool OnSave();
    bool OnSaveAs();
    void OnPreferences();
    void AddRecentFile(const QString& path);
    void UpdateRecentMenu();

    std::unique_ptr<CSetupDocument> m_doc;
    QUndoStack* m_undo = nullptr;
    std::unique_ptr<CSetupHistory> m_history;
    bool m_restoring = false;
    QTimer* m_revalidate = nullptr;
    QString m_path;
    bool m_modified = false;
    Prompter m_prompter;

    QTreeWidget* m_tree = nullptr;
    QTreeWidgetItem* m_moduleItem = nullptr;
    QTreeWidgetItem* m_hostItem = nullptr;
    std::vector<ShownEntry> m_entries;
    std::vector<QTreeWidgetItem*> m_moduleItems;  // parallel to m_entries
    std::vector<QTreeWidgetItem*> m_hostItems;
    QLabel* m_paneTitle = nullptr;
    QLabel* m_panePath = nullptr;
    QToolButton* m_paneHelp = nullptr;
    QScrollArea* m_scroll = nullptr;
    CZoSEKivBase* m_currentNode = nullptr;
    bool m_initializing = false;
    QPointer<CZoSEDlgBase> m_dialog;
    std::vector<QPointer<QWidget>> m_retiring;

    QTreeWidget* m_messages = nullptr;
    QTextBrowser* m_help = nullptr;
    class QDockWidget* m_messagesDock = nullptr;
    // Warnings of reading the open file, shown with every validation until it is saved.
    std::vector<paramfile::Diagnostic> m_readWarnings;
    class QDockWidget* m_helpDock = nullptr;
    QMenu* m_recentMenu = nullptr;
};
