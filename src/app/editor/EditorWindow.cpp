#include "EditorWindow.h"

#include "EditorSettings.h"
#include "HelpTopics.h"
#include "HostDataPages.h"
#include "PreferencesDialog.h"
#include "SetupHistory.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDWindForcingKiv.h"
#include "host/ModuleSelection.h"
#include "hydro/HDSourcesKiv.h"
#include "setupeditor/NavigationTree.h"
#include "widgets/ZoPrompts.h"
#include "widgets/ZoWheelGuard.h"

#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QDir>
#include <QDockWidget>
#include <QFileDialog>
#include <QFileInfo>
#include <QFormLayout>
#include <QFrame>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPushButton>
#include <QRegularExpression>
#include <QScrollArea>
#include <QSettings>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QSplitter>
#include <QStatusBar>
#include <QStyle>
#include <QTextBrowser>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>
#include <QTreeWidget>
#include <QUndoStack>
#include <QVBoxLayout>

#include <algorithm>
#include <set>

namespace {

constexpr int kNodeRole = Qt::UserRole;
constexpr int kMaxRecentFiles = 8;
const char* const kFileFilter = "Setups (*.setup);;All files (*)";

QString Q(const CString& s) { return QString::fromStdString(s); }

CZoSEKivBase* NodeOf(const QTreeWidgetItem* item) {
    return item ? reinterpret_cast<CZoSEKivBase*>(item->data(0, kNodeRole).value<quintptr>())
                : nullptr;
}

void SetNode(QTreeWidgetItem* item, CZoSEKivBase* node) {
    item->setData(0, kNodeRole, QVariant::fromValue(reinterpret_cast<quintptr>(node)));
}

// A title as the modeller knows the place: the module's "MT " prefix of data-file nodes
// goes, and a nameless item of a list is called by its kind and number, as its grid calls
// it ("BED_DISTRIBUTION_LAYER_1" is "Layer 1").
QString DisplayTitle(const CZoSEKivBase* node) {
    QString title = Q(node->GetTitle());
    if (title.startsWith(QStringLiteral("MT ")))
        title.remove(0, 3);
    if (!title.isEmpty())
        return title;
    const QString section = Q(node->GetSectionName());
    static const QRegularExpression numbered(QStringLiteral("(?:^|_)([A-Za-z]+)_([0-9]+)$"));
    if (const QRegularExpressionMatch m = numbered.match(section); m.hasMatch()) {
        const QString kind = m.captured(1).toLower();
        return kind.left(1).toUpper() + kind.mid(1) + ' ' + m.captured(2);
    }
    return section.isEmpty() ? QObject::tr("(unnamed)") : section;
}

// Asks for the numbers of fractions and layers of a new setup.
bool AskNewSetup(QWidget* parent, int& fractions, int& layers) {
    QDialog dialog(parent);
    dialog.setWindowTitle(QObject::tr("New Setup"));
    auto* form = new QFormLayout(&dialog);
    auto* f = new QSpinBox(&dialog);
    f->setRange(1, 8);
    f->setValue(fractions);
    auto* l = new QSpinBox(&dialog);
    l->setRange(1, 12);
    l->setValue(layers);
    form->addRow(QObject::tr("Number of fractions (1 to 8)"), f);
    form->addRow(QObject::tr("Number of bed layers (1 to 12)"), l);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, &dialog);
    QObject::connect(buttons, &QDialogButtonBox::accepted, &dialog, &QDialog::accept);
    QObject::connect(buttons, &QDialogButtonBox::rejected, &dialog, &QDialog::reject);
    form->addRow(buttons);
    if (dialog.exec() != QDialog::Accepted)
        return false;
    fractions = f->value();
    layers = l->value();
    return true;
}

// Quiet validation waits this long after the last stored change.
constexpr int kRevalidateDelayMs = 400;

QString Plural(int n, const char* one, const char* many) {
    return QStringLiteral("%1 %2").arg(n).arg(QString::fromUtf8(n == 1 ? one : many));
}

}  // namespace

// A line edit claims Ctrl+Z and Ctrl+Y for its own typing even when it has nothing to take
// back, and forms are full of them: then the keys are the setup's undo and redo.
class CUndoKeys : public QObject {
public:
    using QObject::QObject;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() != QEvent::ShortcutOverride)
            return false;
        const auto* key = static_cast<QKeyEvent*>(event);
        const bool undo = key->matches(QKeySequence::Undo);
        const bool redo = key->matches(QKeySequence::Redo) ||
                          key->keyCombination() == QKeyCombination(Qt::CTRL, Qt::Key_Y);
        if (!undo && !redo)
            return false;
        if (qobject_cast<QAbstractSpinBox*>(watched))
            return true;
        if (auto* edit = qobject_cast<QLineEdit*>(watched))
            return undo ? !edit->isUndoAvailable() : !edit->isRedoAvailable();
        return false;
    }
};

CEditorWindow::CEditorWindow(QWidget* parent) : QMainWindow(parent) {
    ZoInstallWheelGuard();
    qApp->installEventFilter(new CUndoKeys(this));
    m_undo = new QUndoStack(this);
    m_history = std::make_unique<CSetupHistory>(
        m_undo, [this](const std::function<void()>& change, bool structural) { RestoreState(change, structural); });
    connect(m_undo, &QUndoStack::cleanChanged, this, [this](bool clean) { SetModified(!clean); });
    m_revalidate = new QTimer(this);
    m_revalidate->setSingleShot(true);
    m_revalidate->setInterval(kRevalidateDelayMs);
    connect(m_revalidate, &QTimer::timeout, this, [this] { RunValidation(true); });
    BuildLayout();
    BuildActions();
    SetDocument(std::make_unique<CSetupDocument>(), QString());
    resize(1280, 800);
}

CEditorWindow::~CEditorWindow() {
    // The stack tells that it is clean again as it goes, which must not reach this window.
    disconnect(m_undo, nullptr, this, nullptr);
    delete m_undo;
    m_undo = nullptr;
    m_revalidate->stop();
    // Forms go before the document they edit.
    CloseDialog(true);
    for (QPointer<QWidget>& w : m_retiring)
        delete w.data();
    m_retiring.clear();
}

// --- layout ------------------------------------------------------------------------------

void CEditorWindow::BuildLayout() {
    setDockOptions(QMainWindow::AnimatedDocks | QMainWindow::AllowTabbedDocks);

    m_tree = new QTreeWidget(this);
    m_tree->setHeaderHidden(true);
    m_tree->setUniformRowHeights(true);
    m_tree->setMinimumWidth(220);
    m_tree->setExpandsOnDoubleClick(true);
    connect(m_tree, &QTreeWidget::currentItemChanged, this,
            [this](QTreeWidgetItem* current, QTreeWidgetItem* previous) {
                OnCurrentItemChanged(current, previous);
            });

    auto* pane = new QWidget(this);
    auto* paneLayout = new QVBoxLayout(pane);
    paneLayout->setContentsMargins(0, 0, 0, 0);
    paneLayout->setSpacing(0);
    auto* header = new QWidget(pane);
    header->setAutoFillBackground(true);
    header->setBackgroundRole(QPalette::Base);
    auto* headerLayout = new QHBoxLayout(header);
    headerLayout->setContentsMargins(16, 10, 10, 10);
    auto* titles = new QVBoxLayout;
    titles->setSpacing(2);
    m_paneTitle = new QLabel(header);
    QFont titleFont = m_paneTitle->font();
    titleFont.setPointSizeF(titleFont.pointSizeF() * 1.35);
    titleFont.setBold(true);
    m_paneTitle->setFont(titleFont);
    m_panePath = new QLabel(header);
    m_panePath->setTextInteractionFlags(Qt::TextSelectableByMouse);
    m_panePath->setStyleSheet("color: gray");
    titles->addWidget(m_paneTitle);
    titles->addWidget(m_panePath);
    headerLayout->addLayout(titles, 1);
    m_paneHelp = new QToolButton(header);
    m_paneHelp->setText(tr("Help"));
    m_paneHelp->setToolTip(tr("Help on this section (F1)"));
    m_paneHelp->setAutoRaise(true);
    connect(m_paneHelp, &QToolButton::clicked, this, [this] { ShowHelp(CurrentHelpId()); });
    headerLayout->addWidget(m_paneHelp, 0, Qt::AlignTop);
    paneLayout->addWidget(header);
    auto* rule = new QFrame(pane);
    rule->setFrameShape(QFrame::HLine);
    rule->setFrameShadow(QFrame::Sunken);
    paneLayout->addWidget(rule);
    m_scroll = new QScrollArea(pane);
    m_scroll->setWidgetResizable(true);
    m_scroll->setFrameShape(QFrame::NoFrame);
    paneLayout->addWidget(m_scroll, 1);

    auto* splitter = new QSplitter(Qt::Horizontal, this);
    splitter->addWidget(m_tree);
    splitter->addWidget(pane);
    splitter->setStretchFactor(0, 0);
    splitter->setStretchFactor(1, 1);
    splitter->setSizes({300, 980});
    splitter->setChildrenCollapsible(false);
    setCentralWidget(splitter);

    m_messages = new QTreeWidget(this);
    m_messages->setColumnCount(2);
    m_messages->setHeaderLabels({tr("Section"), tr("Message")});
    m_messages->setRootIsDecorated(false);
    m_messages->setUniformRowHeights(true);
    // A long place keeps its end in view: the item that the message is about.
    m_messages->setTextElideMode(Qt::ElideMiddle);
    m_messages->header()->setSectionResizeMode(0, QHeaderView::Interactive);
    m_messages->header()->resizeSection(0, 380);
    m_messages->header()->setStretchLastSection(true);
    m_messages->setSelectionMode(QAbstractItemView::ExtendedSelection);
    connect(m_messages, &QTreeWidget::itemActivated, this,
            [this](QTreeWidgetItem* item) { OnMessageActivated(item); });
    auto* copy = new QAction(tr("&Copy"), m_messages);
    copy->setShortcut(QKeySequence::Copy);
    copy->setShortcutContext(Qt::WidgetShortcut);
    connect(copy, &QAction::triggered, this,
            [this] { QApplication::clipboard()->setText(MessagesText(true)); });
    m_messages->addAction(copy);
    auto* copyAll = new QAction(tr("Copy &All"), m_messages);
    connect(copyAll, &QAction::triggered, this,
            [this] { QApplication::clipboard()->setText(MessagesText(false)); });
    m_messages->addAction(copyAll);
    m_messages->setContextMenuPolicy(Qt::ActionsContextMenu);
    m_messagesDock = new QDockWidget(tr("Messages"), this);
    m_messagesDock->setObjectName("messages");
    m_messagesDock->setWidget(m_messages);
    addDockWidget(Qt::BottomDockWidgetArea, m_messagesDock);
    resizeDocks({m_messagesDock}, {150}, Qt::Vertical);

    m_help = new QTextBrowser(this);
    m_help->setOpenExternalLinks(false);
    m_helpDock = new QDockWidget(tr("Help"), this);
    m_helpDock->setObjectName("help");
    m_helpDock->setWidget(m_help);
    addDockWidget(Qt::RightDockWidgetArea, m_helpDock);
    m_helpDock->hide();

    statusBar();
}

void CEditorWindow::BuildActions() {
    QStyle* st = style();
    QMenu* file = menuBar()->addMenu(tr("&File"));
    QAction* newAct = file->addAction(st->standardIcon(QStyle::SP_FileIcon), tr("&New..."), this,
                                      [this] { OnNew(); });
    newAct->setShortcut(QKeySequence::New);
    QAction* openAct = file->addAction(st->standardIcon(QStyle::SP_DialogOpenButton), tr("&Open..."),
                                       this, [this] { OnOpen(); });
    openAct->setShortcut(QKeySequence::Open);
    m_recentMenu = file->addMenu(tr("Open &Recent"));
    QAction* saveAct = file->addAction(st->standardIcon(QStyle::SP_DialogSaveButton), tr("&Save"), this,
                                       [this] { OnSave(); });
    saveAct->setShortcut(QKeySequence::Save);
    QAction* saveAsAct = file->addAction(tr("Save &As..."), this, [this] { OnSaveAs(); });
    // The platform's standard key for Save As is empty on some desktops.
    saveAsAct->setShortcut(QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_S));
    file->addSeparator();
    QAction* quitAct = file->addAction(tr("&Quit"), this, &QWidget::close);
    quitAct->setShortcut(QKeySequence::Quit);

    QMenu* edit = menuBar()->addMenu(tr("&Edit"));
    // The stack's own actions name the edit; triggering goes through Undo()/Redo() so that a
    // field being edited stores its value first.
    QAction* undoAct = m_undo->createUndoAction(this, tr("&Undo"));
    QAction* redoAct = m_undo->createRedoAction(this, tr("&Redo"));
    for (QAction* a : {undoAct, redoAct})
        disconnect(a, &QAction::triggered, nullptr, nullptr);
    connect(undoAct, &QAction::triggered, this, [this] { Undo(); });
    connect(redoAct, &QAction::triggered, this, [this] { Redo(); });
    undoAct->setShortcut(QKeySequence::Undo);
    redoAct->setShortcuts({QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_Z), QKeySequence(Qt::CTRL | Qt::Key_Y)});
    edit->addAction(undoAct);
    edit->addAction(redoAct);
    edit->addSeparator();
    edit->addAction(tr("&Preferences..."), this, [this] { OnPreferences(); });

    QMenu* setup = menuBar()->addMenu(tr("&Setup"));
    QAction* validateAct = setup->addAction(st->standardIcon(QStyle::SP_DialogApplyButton),
                                            tr("&Validate"), this, [this] { Validate(); });
    validateAct->setShortcut(Qt::Key_F7);

    QMenu* view = menuBar()->addMenu(tr("&View"));
    view->addAction(m_messagesDock->toggleViewAction());
    view->addAction(m_helpDock->toggleViewAction());

    QMenu* help = menuBar()->addMenu(tr("&Help"));
    QAction* sectionHelp = help->addAction(tr("Help on this &Section"), this, [this] {
        // The innermost form around the focus answers (a page inside a sheet), as its own F1.
        for (QWidget* w = QApplication::focusWidget(); w; w = w->parentWidget())
            if (auto* form = qobject_cast<CZoSEDlgBase*>(w)) {
                form->ShowHelp();
                return;
            }
        ShowHelp(CurrentHelpId());
    });
    sectionHelp->setShortcut(QKeySequence::HelpContents);
    help->addAction(tr("&Using the Editor"), this, [this] { ShowHelp(0); });
    help->addSeparator();
    help->addAction(tr("&About"), this,
                    [this] { QMessageBox::about(this, tr("About the Mud Transport Setup Editor"), AboutText()); });

    QToolBar* bar = addToolBar(tr("Main"));
    bar->setObjectName("main");
    bar->setMovable(false);
    bar->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    bar->addAction(newAct);
    bar->addAction(openAct);
    bar->addAction(saveAct);
    bar->addSeparator();
    bar->addAction(validateAct);

    UpdateRecentMenu();
}

// --- document ----------------------------------------------------------------------------

void CEditorWindow::SetDocument(std::unique_ptr<CSetupDocument> doc, const QString& path) {
    CloseDialog(true);
    for (QPointer<QWidget>& w : m_retiring)
        delete w.data();
    m_retiring.clear();
    m_messages->clear();
    m_readWarnings.clear();
    m_revalidate->stop();
    m_doc = std::move(doc);
    m_doc->SetTreeItemSelector([this](CZoSEKivBase* node) { SelectTreeItem(node); });
    m_path = path;
    StartNewHistory();
    m_entries.clear();
    m_moduleItems.clear();
    m_hostItems.clear();
    m_hostItem = nullptr;
    {
        const QSignalBlocker block(m_tree);
        m_tree->clear();
    }
    RebuildTree();
    if (QTreeWidgetItem* first = m_tree->topLevelItem(0))
        m_tree->setCurrentItem(first);
}

// --- undo --------------------------------------------------------------------------------

void CEditorWindow::StartNewHistory() {
    m_history->Start(m_doc.get());
    SetModified(false);
}

void CEditorWindow::RecordChange(CZoSEDlgBase* dialog, int hint) {
    // Only the calling form's own node is sure to be alive.
    CZoSEKivBase* edited = dialog ? dialog->GetSection() : nullptr;
    m_history->Record(edited, hint, [&] { return EditName(dialog, hint); });
}

void CEditorWindow::SyncState(const QString& name) {
    if (m_restoring)
        return;
    m_history->Record(m_currentNode, kHintValueChanged, [&] { return name; });
}

void CEditorWindow::Undo() {
    CommitPendingEdit();
    m_undo->undo();
}

void CEditorWindow::Redo() {
    CommitPendingEdit();
    m_undo->redo();
}

void CEditorWindow::RestoreState(const std::function<void()>& change, bool structural) {
    // The form is shown again for the same place in the tree, which may be a new node.
    const CString path = m_currentNode ? NodePath(m_currentNode) : CString();
    const bool hadNode = m_currentNode != nullptr;
    m_restoring = true;
    // Deleted later: the keys of the undo may still be on their way through the form.
    CloseDialog(false);
    m_currentNode = nullptr;
    change();
    ShowAgain(path, hadNode, structural);
}

void CEditorWindow::ShowAgain(const CString& path, bool hadNode, bool rebuild) {
    m_restoring = true;
    if (rebuild)
        RebuildTree();
    else
        RefreshTree();
    CZoSEKivBase* target = nullptr;
    if (hadNode)
        for (CZoSEKivBase* node : ShownNodes())
            if (NodePath(node) == path)
                target = node;
    m_restoring = false;
    if (target) {
        SelectTreeItem(target);
        if (m_currentNode != target)
            ShowNode(target);
    } else if (QTreeWidgetItem* current = m_tree->currentItem()) {
        OnCurrentItemChanged(current, nullptr);
    }
    m_revalidate->start();
}

QString CEditorWindow::EditName(CZoSEDlgBase* dialog, int hint) const {
    // Only the calling form's own node is sure to be alive: a change of a count may just
    // have deleted the node of the form on show.
    const QString title = dialog && dialog->GetSection() ? TitleOf(dialog->GetSection()) : QString();
    QWidget* source = ZoEditSource();
    if (!source)
        source = QApplication::focusWidget();
    QWidget* page = m_scroll ? m_scroll->widget() : nullptr;
    if (source && page && page->isAncestorOf(source)) {
        // Grids: the row operation, or the column of the cell.
        const QAbstractItemView* view = nullptr;
        for (QWidget* w = source; w && w != page && !view; w = w->parentWidget())
            view = qobject_cast<const QAbstractItemView*>(w);
        if (view) {
            if (hint & kHintItemsAdded)
                return tr("Insert rows in %1").arg(title);
            if (hint & kHintItemsDeleted)
                return tr("Delete rows in %1").arg(title);
            if (hint & kHintItemsReordered)
                return tr("Move rows in %1").arg(title);
            const QModelIndex current = view->currentIndex();
            if (current.isValid() && view->model()) {
                const QString column = view->model()->headerData(current.column(), Qt::Horizontal).toString();
                if (!column.isEmpty())
                    return tr("%1 in %2").arg(column, title);
            }
        } else {
            const QString label = ZoFieldLabel(source);
            if (!label.isEmpty())
                return qobject_cast<const QPushButton*>(source) || qobject_cast<const QToolButton*>(source)
                           ? tr("%1 in %2").arg(label, title)
                           : label;
        }
    }
    const QString in = title.isEmpty() ? QString() : tr(" in %1").arg(title);
    if (hint & kHintItemsAdded)
        return tr("Add items") + in;
    if (hint & kHintItemsDeleted)
        return tr("Delete items") + in;
    if (hint & kHintItemsReordered)
        return tr("Move items") + in;
    if (hint & kHintTitleChanged)
        return tr("Rename") + in;
    return tr("Change") + in;
}

void CEditorWindow::SetModified(bool modified) {
    m_modified = modified;
    UpdateTitle();
}

void CEditorWindow::UpdateTitle() {
    const QString name = m_path.isEmpty() ? tr("Untitled") : QFileInfo(m_path).fileName();
    setWindowTitle(tr("%1[*] - Mud Transport Setup Editor %2").arg(name, QStringLiteral(MUDSETUP_VERSION)));
    setWindowModified(m_modified);
}

void CEditorWindow::NewSetup(int fractions, int layers) {
    auto doc = std::make_unique<CSetupDocument>();
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    model->NumberOfFractions(fractions);
    model->NumberOfLayers(layers);
    SetDocument(std::move(doc), QString());
    statusBar()->showMessage(tr("New setup with %1 and %2")
                                 .arg(Plural(fractions, "fraction", "fractions"),
                                      Plural(layers, "bed layer", "bed layers")),
                             5000);
}

bool CEditorWindow::OpenFile(const QString& path) {
    const QFileInfo info(path);
    if (!info.exists() || info.isDir()) {
        Ask({QMessageBox::Critical, tr("Open Setup"),
             info.isDir() ? tr("%1 is a folder, not a setup file.").arg(path)
                          : tr("The file %1 does not exist.").arg(path),
             QMessageBox::Ok});
        return false;
    }
    CSetupDocument::OpenResult opened = CSetupDocument::Open(path.toStdString());
    if (opened.error) {
        // A file that cannot be read at all has no line to point to.
        const QString where = opened.error->pos.line > 0 ? Q(opened.error->ToString()) : Q(opened.error->message);
        Ask({QMessageBox::Critical, tr("Open Setup"), tr("The setup could not be opened:\n\n%1").arg(where),
             QMessageBox::Ok});
        return false;
    }
    SetDocument(std::move(opened.document), QFileInfo(path).absoluteFilePath());
    AddRecentFile(m_path);
    ShowReadWarnings(opened.warnings);
    // A setup that disagrees with its files (a mesh or data file gone) says so at once.
    if (!RunValidation(true))
        m_messagesDock->show();
    if (opened.warnings.empty())
        statusBar()->showMessage(tr("Opened %1").arg(path), 5000);
    return true;
}

void CEditorWindow::ShowReadWarnings(const std::vector<paramfile::Diagnostic>& warnings) {
    m_readWarnings = warnings;
    if (warnings.empty())
        return;
    AddReadWarningItems();
    m_messagesDock->show();
    statusBar()->showMessage(tr("Opened with %1; see the messages")
                                 .arg(Plural(static_cast<int>(warnings.size()), "warning", "warnings")));
}

void CEditorWindow::AddReadWarningItems() {
    const QIcon icon = style()->standardIcon(QStyle::SP_MessageBoxWarning);
    for (const paramfile::Diagnostic& w : m_readWarnings) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, QStringLiteral("%1:%2:%3").arg(Q(w.file)).arg(w.pos.line).arg(w.pos.column));
        item->setText(1, tr("warning: %1").arg(Q(w.message)));
        item->setToolTip(1, Q(w.message));
        item->setIcon(0, icon);
        item->setData(0, Qt::UserRole + 1, item->text(0));  // what Copy puts first
    }
}

// What reading the mesh passed over or did not find: not errors, but a modeller should see them.
void CEditorWindow::AddMeshNoteItems() {
    CDomainKiv* domain = Domain(m_doc.get());
    const MeshPtr mesh = domain ? domain->Mesh() : nullptr;
    if (!mesh)
        return;
    const QIcon icon = style()->standardIcon(QStyle::SP_MessageBoxInformation);
    const QString path = Q(NodePath(domain));
    for (const std::string& note : mesh->notes) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, TitlePath(domain));
        item->setToolTip(0, path);
        item->setData(0, Qt::UserRole + 1, path);
        item->setText(1, tr("mesh: %1").arg(Q(note)));
        item->setToolTip(1, Q(note));
        item->setIcon(0, icon);
        SetNode(item, domain);
    }
}

bool CEditorWindow::SaveFile(const QString& path) {
    Validate();
    if (const auto& dropped = m_doc->DroppedOnSave(); !dropped.empty()) {
        QString list;
        const size_t shown = std::min<size_t>(dropped.size(), 5);
        for (size_t i = 0; i < shown; ++i)
            list += QStringLiteral("\n%1:%2: %3")
                        .arg(dropped[i].pos.line)
                        .arg(dropped[i].pos.column)
                        .arg(Q(dropped[i].message));
        if (dropped.size() > shown)
            list += tr("\n... and %n more (see the messages)", nullptr,
                       static_cast<int>(dropped.size() - shown));
        const QMessageBox::StandardButton answer =
            Ask({QMessageBox::Warning, tr("Save Setup"),
                 tr("The file held content that no section of the setup reads. Saving drops "
                    "it:\n%1\n\nSave anyway?")
                     .arg(list),
                 QMessageBox::Save | QMessageBox::Cancel});
        if (answer != QMessageBox::Save)
            return false;
    }
    std::string error;
    bool changed = false;
    // Saving may rewrite file names; the text before tells (saving writes it whole anyway).
    const std::string before = m_doc->ToText();
    bool saved = m_doc->SaveAs(path.toStdString(), &error, &changed);
    if (!saved && changed) {
        const QMessageBox::StandardButton answer =
            Ask({QMessageBox::Warning, tr("Save Setup"),
                 tr("%1 was changed by another program since it was opened or saved here.\n\n"
                    "Overwrite it with this setup?")
                     .arg(path),
                 QMessageBox::Save | QMessageBox::Cancel});
        if (answer != QMessageBox::Save)
            return false;
        saved = m_doc->SaveAs(path.toStdString(), &error, nullptr, true);
    }
    if (!saved) {
        Ask({QMessageBox::Critical, tr("Save Setup"),
             tr("The setup could not be saved to %1:\n\n%2\n\nThe file was not changed.")
                 .arg(path, Q(error)),
             QMessageBox::Ok});
        return false;
    }
    m_path = QFileInfo(path).absoluteFilePath();
    // The file now holds what the setup holds: what reading said of the old one is past
    // (the list shows it until the next validation).
    m_readWarnings.clear();
    if (m_doc->ToText() != before) {
        // Saved into another folder, relative file names were rewritten to name the same
        // files from there: the form shows the new names, the states before hold the old
        // ones (no longer right from here), and the files are checked from the new place.
        CloseDialog(false);
        const CString shown = m_currentNode ? NodePath(m_currentNode) : CString();
        const bool hadNode = m_currentNode != nullptr;
        m_currentNode = nullptr;
        ShowAgain(shown, hadNode);
        StartNewHistory();
        RunValidation(false);
    } else {
        m_undo->setClean();
        SetModified(false);
    }
    AddRecentFile(m_path);
    const int problems = static_cast<int>(m_doc->Errors().size());
    statusBar()->showMessage(problems ? tr("Saved %1 with %2")
                                            .arg(path, Plural(problems, "validation message", "validation messages"))
                                      : tr("Saved %1").arg(path),
                             8000);
    return true;
}

bool CEditorWindow::MaybeSave() {
    CommitPendingEdit();
    if (!m_modified)
        return true;
    const QMessageBox::StandardButton answer =
        Ask({QMessageBox::Warning, tr("Unsaved Changes"),
             tr("The setup has been modified.\nDo you want to save your changes?"),
             QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel});
    if (answer == QMessageBox::Save)
        return OnSave();
    return answer == QMessageBox::Discard;
}

bool CEditorWindow::Validate() {
    CommitPendingEdit();
    return RunValidation(false);
}

bool CEditorWindow::RunValidation(bool quiet) {
    m_revalidate->stop();
    const int ok = m_doc->ValidateAll();
    const bool valid = ok && m_doc->Errors().empty();
    FillMessages(valid);
    // Validation may correct values silently; they count as a change of their own.
    const int before = m_undo->index();
    SyncState(tr("Corrections by validation"));
    const bool corrected = m_undo->index() != before;
    RefreshTree();
    if (m_dialog && (!quiet || corrected))
        m_dialog->SetData();
    if (quiet)
        return valid;
    m_messagesDock->show();
    statusBar()->showMessage(valid ? tr("The setup is valid")
                                   : Plural(static_cast<int>(m_doc->Errors().size()), "validation message",
                                            "validation messages"),
                             8000);
    return valid;
}

void CEditorWindow::FillMessages(bool valid) {
    m_messages->clear();
    AddReadWarningItems();
    AddMeshNoteItems();
    const QIcon icon = style()->standardIcon(QStyle::SP_MessageBoxCritical);
    for (const CZoSEKivGlobalBase::ErrorEntry& e : m_doc->Errors()) {
        auto* item = new QTreeWidgetItem(m_messages);
        const QString path = Q(NodePath(e.node));
        item->setText(0, e.node ? TitlePath(e.node) : path);
        item->setToolTip(0, path);
        item->setData(0, Qt::UserRole + 1, path);
        item->setText(1, Q(e.Text()));
        item->setIcon(0, icon);
        item->setToolTip(1, Q(e.Text()));
        SetNode(item, e.node);
    }
    if (valid) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, tr("The setup is valid."));
        item->setIcon(0, style()->standardIcon(QStyle::SP_DialogApplyButton));
        item->setFirstColumnSpanned(true);
    } else {
        // The places shown whole, as far as half the list's width allows.
        m_messages->resizeColumnToContents(0);
        const int widest = m_messages->header()->sectionSize(0);
        m_messages->header()->resizeSection(
            0, std::clamp(widest, 380, std::max(380, m_messages->viewport()->width() / 2)));
    }
}

QString CEditorWindow::MessagesText(bool selectedOnly) const {
    QStringList lines;
    for (int i = 0; i < m_messages->topLevelItemCount(); ++i) {
        const QTreeWidgetItem* item = m_messages->topLevelItem(i);
        if (selectedOnly && !item->isSelected())
            continue;
        const QString where = item->data(0, Qt::UserRole + 1).toString();
        if (where.isEmpty())
            lines << item->text(0);  // "The setup is valid."
        else
            lines << QStringLiteral("%1: %2").arg(where, item->text(1));
    }
    return lines.join('\n');
}

QString CEditorWindow::TitlePath(const CZoSEKivBase* node) const {
    QStringList titles;
    for (const CZoSEKivBase* n = node; n && n != m_doc.get(); n = n->GetParent()) {
        // The module's root is where every path starts; it goes without saying.
        if (n == m_doc->Module() && n != node)
            break;
        titles.prepend(TitleOf(n));
    }
    return titles.join(QStringLiteral(" > "));
}

QString CEditorWindow::AboutText() const {
    return tr("<h3>Mud Transport Setup Editor</h3>"
              "<p>Version %1</p>"
              "<p>Edits the mud-transport module of a flexible-mesh flow model's setup: "
              "fractions, bed layers, settling, erosion, waves, conditions, sources, dredgers "
              "and outputs.</p>"
              "<p>Built with Qt %2 (running on Qt %3).</p>")
        .arg(QStringLiteral(MUDSETUP_VERSION), QStringLiteral(QT_VERSION_STR), QString::fromLatin1(qVersion()));
}

void CEditorWindow::OnMessageActivated(QTreeWidgetItem* item) {
    CZoSEKivBase* node = NodeOf(item);
    // The node may have gone since the message was made.
    if (node && LiveNodes().count(node))
        SelectTreeItem(node);
}

QMessageBox::StandardButton CEditorWindow::Ask(const Prompt& prompt) {
    if (m_prompter)
        return m_prompter(prompt);
    QMessageBox box(prompt.icon, prompt.title, prompt.text, prompt.buttons, this);
    return static_cast<QMessageBox::StandardButton>(box.exec());
}

// --- tree --------------------------------------------------------------------------------

std::vector<CEditorWindow::ShownEntry> CEditorWindow::CollectModuleEntries() const {
    std::vector<ShownEntry> entries;
    WalkNavigationTree(m_doc->Module(), 0,
                       [&](CZoSEKivBase* node, int depth) { entries.push_back({node, depth}); });
    return entries;
}

bool CEditorWindow::IsHostNode(const CZoSEKivBase* node) const {
    for (QTreeWidgetItem* item : m_hostItems)
        if (NodeOf(item) == node)
            return true;
    return false;
}

QString CEditorWindow::TitleOf(const CZoSEKivBase* node) const {
    // Host sections named as the modeller knows them beside the module's own.
    if (node == m_doc->GetModuleSelection())
        return tr("Modules");
    if (node == m_doc->GetSources())
        return tr("Hydrodynamic Sources");
    return DisplayTitle(node);
}

void CEditorWindow::StyleItem(QTreeWidgetItem* item, CZoSEKivBase* node) {
    item->setText(0, TitleOf(node));
    // A section below one that is not used is not used either.
    const QTreeWidgetItem* parent = item->parent();
    const bool parentUnused = parent && parent->data(0, Qt::UserRole + 1).toBool();
    const bool unused = parentUnused || !node->IsDlgUsedInSetup();
    item->setData(0, Qt::UserRole + 1, unused);
    const QPalette& pal = m_tree->palette();
    item->setForeground(0, unused ? pal.brush(QPalette::Disabled, QPalette::Text)
                                  : pal.brush(QPalette::Active, QPalette::Text));
    item->setToolTip(0, unused ? tr("%1 (not used in this setup)").arg(Q(NodePath(node)))
                               : Q(NodePath(node)));
}

void CEditorWindow::RebuildTree() {
    const QSignalBlocker block(m_tree);
    // Nodes keep their expansion; new ones open down to the sections of the module.
    std::set<const CZoSEKivBase*> known, expanded;
    for (QTreeWidgetItem* item : m_moduleItems) {
        known.insert(NodeOf(item));
        if (item->isExpanded())
            expanded.insert(NodeOf(item));
    }
    const bool hostExpanded = !m_hostItem || m_hostItem->isExpanded();
    const bool domainExpanded = m_hostItems.size() < 2 || m_hostItems[1]->isExpanded();

    m_tree->clear();
    m_entries = CollectModuleEntries();
    m_moduleItems.clear();
    m_hostItems.clear();
    std::vector<QTreeWidgetItem*> stack;
    for (const ShownEntry& e : m_entries) {
        const int depth = std::min<int>(e.depth, static_cast<int>(stack.size()));
        QTreeWidgetItem* item = depth == 0 ? new QTreeWidgetItem(m_tree)
                                           : new QTreeWidgetItem(stack[depth - 1]);
        stack.resize(depth);
        stack.push_back(item);
        SetNode(item, e.node);
        StyleItem(item, e.node);
        m_moduleItems.push_back(item);
        item->setExpanded(known.count(e.node) ? expanded.count(e.node) > 0 : e.depth <= 1);
    }

    m_hostItem = new QTreeWidgetItem(m_tree);
    m_hostItem->setText(0, tr("Host data"));
    m_hostItem->setToolTip(0, tr("The flow model's own data that the module builds on"));
    auto host = [&](CZoSEKivBase* node, QTreeWidgetItem* parent) {
        auto* item = new QTreeWidgetItem(parent);
        SetNode(item, node);
        StyleItem(item, node);
        m_hostItems.push_back(item);
        return item;
    };
    host(m_doc->GetModuleSelection(), m_hostItem);
    QTreeWidgetItem* domain = host(m_doc->GetDomain(), m_hostItem);
    host(m_doc->GetBoundaryNames(), domain);
    host(m_doc->GetPeriod(), m_hostItem);
    host(m_doc->GetSources(), m_hostItem);
    host(m_doc->GetDensity(), m_hostItem);
    host(m_doc->GetWind(), m_hostItem);
    m_hostItem->setExpanded(hostExpanded);
    domain->setExpanded(domainExpanded);

    if (QTreeWidgetItem* current = ItemOf(m_currentNode))
        m_tree->setCurrentItem(current);
}

void CEditorWindow::RefreshTree() {
    if (CollectModuleEntries() != m_entries) {
        RebuildTree();
        // The form's node may be gone with the items that were removed.
        if (m_currentNode && !ItemOf(m_currentNode)) {
            CloseDialog(false);
            m_currentNode = nullptr;
            m_paneTitle->clear();
            m_panePath->clear();
        }
        return;
    }
    for (size_t i = 0; i < m_moduleItems.size(); ++i)
        StyleItem(m_moduleItems[i], m_entries[i].node);
    for (QTreeWidgetItem* item : m_hostItems)
        StyleItem(item, NodeOf(item));
}

QTreeWidgetItem* CEditorWindow::ItemOf(CZoSEKivBase* node) const {
    if (!node)
        return nullptr;
    for (QTreeWidgetItem* item : m_moduleItems)
        if (NodeOf(item) == node)
            return item;
    for (QTreeWidgetItem* item : m_hostItems)
        if (NodeOf(item) == node)
            return item;
    return nullptr;
}

std::vector<CZoSEKivBase*> CEditorWindow::ShownNodes() const {
    std::vector<CZoSEKivBase*> nodes;
    for (QTreeWidgetItem* item : m_moduleItems)
        nodes.push_back(NodeOf(item));
    for (QTreeWidgetItem* item : m_hostItems)
        nodes.push_back(NodeOf(item));
    return nodes;
}

std::unordered_set<const CZoSEKivBase*> CEditorWindow::LiveNodes() const {
    std::unordered_set<const CZoSEKivBase*> live;
    std::vector<CZoSEKivBase*> todo{m_doc.get()};
    while (!todo.empty()) {
        CZoSEKivBase* node = todo.back();
        todo.pop_back();
        live.insert(node);
        POSITION pos = 0;
        for (CZoSEKivBase* p = node->GetFirstProperty(pos); p; p = node->GetNextProperty(pos))
            todo.push_back(p);
        pos = 0;
        for (CZoSEKivBase* c = node->GetFirstChild(pos); c; c = node->GetNextChild(pos))
            todo.push_back(c);
    }
    return live;
}

bool CEditorWindow::SelectPath(const QString& path) {
    QString wanted = path.trimmed();
    while (wanted.startsWith('/'))
        wanted.remove(0, 1);
    while (wanted.endsWith('/'))
        wanted.chop(1);
    for (CZoSEKivBase* node : ShownNodes())
        if (Q(NodePath(node)) == wanted) {
            SelectTreeItem(node);
            return true;
        }
    return false;
}

// --- the pane ----------------------------------------------------------------------------

void CEditorWindow::OnCurrentItemChanged(QTreeWidgetItem* item, QTreeWidgetItem* previous) {
    if (!item)
        return;
    // A value typed on the form and refused as the click on the tree took the focus away
    // stays on that form, where the user can mend it.
    if (QWidget* refused = ZoJustRefused(); refused && previous && m_scroll->widget() &&
                                            m_scroll->widget()->isAncestorOf(refused)) {
        {
            const QSignalBlocker block(m_tree);
            m_tree->setCurrentItem(previous);
        }
        refused->setFocus();
        // The click goes on to select the item it hit once this returns: the tree is put
        // back on the form's node after it.
        QMetaObject::invokeMethod(
            this,
            [this] {
                QTreeWidgetItem* shown = ItemOf(m_currentNode);
                if (!shown)
                    return;
                const QSignalBlocker block(m_tree);
                m_tree->setCurrentItem(shown);
                m_tree->clearSelection();
                shown->setSelected(true);
            },
            Qt::QueuedConnection);
        return;
    }
    CZoSEKivBase* node = NodeOf(item);
    if (node) {
        ShowNode(node);
        ShowHelpOfSelection();
        return;
    }
    // The host data branch itself: what it holds.
    CloseDialog(false);
    m_currentNode = nullptr;
    m_paneTitle->setText(item->text(0));
    m_panePath->clear();
    // The pane's title is the heading already.
    auto* page = new QLabel(HelpTopicBodyHtml(kHelpHostData));
    page->setWordWrap(true);
    page->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    page->setContentsMargins(16, 12, 16, 12);
    m_scroll->setWidget(page);
    ShowHelpOfSelection();
}

void CEditorWindow::ShowHelpOfSelection() {
    // The pane follows the tree whether it is open or not, so it is current when opened.
    m_help->setHtml(HelpTopicHtml(CurrentHelpId()));
}

void CEditorWindow::ShowNode(CZoSEKivBase* node) {
    CloseDialog(false);
    m_currentNode = node;
    m_history->Watch(node);
    m_paneTitle->setText(TitleOf(node));
    m_panePath->setText(Q(NodePath(node)));

    auto* container = new QWidget;
    auto* layout = new QVBoxLayout(container);
    layout->setContentsMargins(16, 12, 16, 12);
    m_scroll->setWidget(container);
    CZoSEDlgBase* dialog = IsHostNode(node)
                               ? CreateHostDataPage(node, *m_doc)
                               : CreateDialogFromClass(node->GetDlgRuntimeClass(kDlgRuntimeClassRequest));
    // A page with nothing to edit (a group, the module itself) describes its section.
    auto describe = [&](unsigned long helpId) {
        const QString text = HelpTopicBodyHtml(helpId);
        if (text.isEmpty())
            return;
        auto* about = new QLabel(text, container);
        about->setWordWrap(true);
        about->setMaximumWidth(720);
        about->setStyleSheet("color: #505050");
        layout->addWidget(about);
    };
    if (dialog) {
        layout->addWidget(dialog);
        m_dialog = dialog;
        // The help pane follows the page on show as it follows the tree.
        connect(dialog, &CZoSEDlgBase::helpTopicChanged, this, [this] { ShowHelpOfSelection(); });
        dialog->Attach(node, this);
        m_initializing = true;
        dialog->Initialize();
        m_initializing = false;
        if (dialog->findChildren<QWidget*>().isEmpty())
            describe(dialog->GetHelpID());
        else
            layout->setStretchFactor(dialog, 1);
    } else {
        auto* note = new QLabel(tr("No form for this section yet."), container);
        note->setEnabled(false);
        layout->addWidget(note);
        if (const auto* help = dynamic_cast<const CFemHelpBase*>(node))
            describe(help->GetHelpID());
    }
    layout->addStretch(dialog && layout->stretch(layout->indexOf(dialog)) ? 0 : 1);
}

void CEditorWindow::CommitPendingEdit() {
    // A field being edited stores its value when it loses the focus.
    QWidget* focus = QApplication::focusWidget();
    QWidget* page = m_scroll ? m_scroll->widget() : nullptr;
    if (focus && page && page->isAncestorOf(focus)) {
        focus->clearFocus();
        if (m_scroll->widget() == page)
            focus->setFocus();
    }
}

void CEditorWindow::CloseDialog(bool now) {
    if (!m_scroll || !m_scroll->widget())
        return;
    CommitPendingEdit();
    QWidget* page = m_scroll->takeWidget();
    m_dialog = nullptr;
    if (now) {
        delete page;
        return;
    }
    // The form may be in the middle of its own handler (a "Go to..." button).
    page->hide();
    page->setParent(nullptr);
    page->deleteLater();
    m_retiring.emplace_back(page);
    std::erase_if(m_retiring, [](const QPointer<QWidget>& w) { return w.isNull(); });
}

void CEditorWindow::RefreshDialog() {
    if (m_currentNode)
        ShowNode(m_currentNode);
}

unsigned long CEditorWindow::CurrentHelpId() const {
    if (m_dialog && m_dialog->CurrentHelpID())
        return m_dialog->CurrentHelpID();
    if (const auto* help = dynamic_cast<const CFemHelpBase*>(m_currentNode))
        return help->GetHelpID();
    if (!m_currentNode && m_tree->currentItem() == m_hostItem)
        return kHelpHostData;
    return 0;
}

// --- CDialogHost -------------------------------------------------------------------------

void CEditorWindow::UpdateDoc(CZoSEDlgBase* dialog, int hint) {
    if (m_restoring)
        return;
    RecordChange(dialog, hint);
    RefreshTree();
    m_history->Watch(m_currentNode);
    if (m_dialog && !m_initializing)
        m_dialog->SetData();
    m_revalidate->start();
}

void CEditorWindow::SelectTreeItem(CZoSEKivBase* node) {
    // Nodes without a form of their own are shown by the nearest one above.
    QTreeWidgetItem* item = nullptr;
    for (CZoSEKivBase* n = node; n && !item; n = n->GetParent())
        item = ItemOf(n);
    if (!item)
        return;
    for (QTreeWidgetItem* p = item->parent(); p; p = p->parent())
        p->setExpanded(true);
    m_tree->setCurrentItem(item);
    m_tree->scrollToItem(item);
}

void CEditorWindow::ShowHelp(unsigned long helpId) {
    m_help->setHtml(HelpTopicHtml(helpId));
    m_helpDock->show();
    m_helpDock->raise();
}

CString CEditorWindow::AbsoluteFilePath(const CString& path) {
    QString p = Q(path);
    p.replace('\\', '/');
    if (p.isEmpty() || QFileInfo(p).isAbsolute())
        return p.toStdString();
    const QString base = m_path.isEmpty() ? QDir::currentPath() : QFileInfo(m_path).absolutePath();
    return QDir::cleanPath(QDir(base).absoluteFilePath(p)).toStdString();
}

// --- menu actions ------------------------------------------------------------------------

void CEditorWindow::OnNew() {
    if (!MaybeSave())
        return;
    int fractions = 1, layers = 1;
    if (AskNewSetup(this, fractions, layers))
        NewSetup(fractions, layers);
}

void CEditorWindow::OnOpen() {
    if (!MaybeSave())
        return;
    const QString dir = m_path.isEmpty() ? QDir::currentPath() : QFileInfo(m_path).absolutePath();
    const QString path = ZoGetOpenFileName(this, tr("Open Setup"), dir, tr(kFileFilter));
    if (!path.isEmpty())
        OpenFile(path);
}

bool CEditorWindow::OnSave() {
    if (m_path.isEmpty())
        return OnSaveAs();
    return SaveFile(m_path);
}

bool CEditorWindow::OnSaveAs() {
    const QString start = m_path.isEmpty() ? QDir::current().filePath("untitled.setup") : m_path;
    QString path = QFileDialog::getSaveFileName(this, tr("Save Setup As"), start, tr(kFileFilter));
    if (path.isEmpty())
        return false;
    if (QFileInfo(path).suffix().isEmpty())
        path += ".setup";
    return SaveFile(path);
}

void CEditorWindow::OnPreferences() {
    CPreferencesDialog dialog(this);
    if (dialog.exec() == QDialog::Accepted)
        RefreshDialog();
}

void CEditorWindow::AddRecentFile(const QString& path) {
    QSettings settings = EditorSettings();
    QStringList files = settings.value("recentFiles").toStringList();
    files.removeAll(path);
    files.prepend(path);
    while (files.size() > kMaxRecentFiles)
        files.removeLast();
    settings.setValue("recentFiles", files);
    UpdateRecentMenu();
}

void CEditorWindow::UpdateRecentMenu() {
    m_recentMenu->clear();
    const QStringList files = EditorSettings().value("recentFiles").toStringList();
    for (int i = 0; i < files.size(); ++i) {
        const QString path = files[i];
        // The folder tells apart setups of the same name; '&' would mark a key.
        const QFileInfo info(path);
        QString text = QStringLiteral("%1  (%2)").arg(info.fileName(), QDir::toNativeSeparators(info.absolutePath()));
        text.replace('&', QStringLiteral("&&"));
        QAction* a = m_recentMenu->addAction(QStringLiteral("&%1 %2").arg(i + 1).arg(text),
                                             this, [this, path] {
                                                 if (MaybeSave())
                                                     OpenFile(path);
                                             });
        a->setToolTip(path);
        a->setStatusTip(path);
    }
    m_recentMenu->setEnabled(!files.isEmpty());
}

void CEditorWindow::closeEvent(QCloseEvent* event) {
    if (!MaybeSave()) {
        event->ignore();
        return;
    }
    SaveLayout();
    event->accept();
}

void CEditorWindow::RestoreLayout() {
    QSettings settings = EditorSettings();
    restoreGeometry(settings.value("window/geometry").toByteArray());
    restoreState(settings.value("window/state").toByteArray());
}

void CEditorWindow::SaveLayout() {
    QSettings settings = EditorSettings();
    settings.setValue("window/geometry", saveGeometry());
    settings.setValue("window/state", saveState());
}
