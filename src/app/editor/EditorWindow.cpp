#include "EditorWindow.h"

#include "EditorSettings.h"
#include "HelpTopics.h"
#include "HostDataPages.h"
#include "PreferencesDialog.h"
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

#include <QAction>
#include <QApplication>
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
#include <QLabel>
#include <QMenuBar>
#include <QScrollArea>
#include <QSettings>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QSplitter>
#include <QStatusBar>
#include <QStyle>
#include <QTextBrowser>
#include <QToolBar>
#include <QToolButton>
#include <QTreeWidget>
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

// A title for the tree; nameless nodes fall back to their section name.
QString DisplayTitle(const CZoSEKivBase* node) {
    QString title = Q(node->GetTitle());
    if (title.isEmpty())
        title = Q(node->GetSectionName());
    return title.isEmpty() ? QObject::tr("(unnamed)") : title;
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

}  // namespace

CEditorWindow::CEditorWindow(QWidget* parent) : QMainWindow(parent) {
    BuildLayout();
    BuildActions();
    SetDocument(std::make_unique<CSetupDocument>(), QString());
    resize(1280, 800);
}

CEditorWindow::~CEditorWindow() {
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
            [this](QTreeWidgetItem* current) { OnCurrentItemChanged(current); });

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
    m_messages->header()->setSectionResizeMode(0, QHeaderView::Interactive);
    m_messages->header()->resizeSection(0, 380);
    m_messages->header()->setStretchLastSection(true);
    connect(m_messages, &QTreeWidget::itemActivated, this,
            [this](QTreeWidgetItem* item) { OnMessageActivated(item); });
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
    saveAsAct->setShortcut(QKeySequence::SaveAs);
    file->addSeparator();
    QAction* quitAct = file->addAction(tr("&Quit"), this, &QWidget::close);
    quitAct->setShortcut(QKeySequence::Quit);

    QMenu* edit = menuBar()->addMenu(tr("&Edit"));
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
    m_doc = std::move(doc);
    m_doc->SetTreeItemSelector([this](CZoSEKivBase* node) { SelectTreeItem(node); });
    m_path = path;
    m_entries.clear();
    m_moduleItems.clear();
    m_hostItems.clear();
    m_hostItem = nullptr;
    {
        const QSignalBlocker block(m_tree);
        m_tree->clear();
    }
    RebuildTree();
    SetModified(false);
    if (QTreeWidgetItem* first = m_tree->topLevelItem(0))
        m_tree->setCurrentItem(first);
}

void CEditorWindow::SetModified(bool modified) {
    m_modified = modified;
    UpdateTitle();
}

void CEditorWindow::UpdateTitle() {
    const QString name = m_path.isEmpty() ? tr("Untitled") : QFileInfo(m_path).fileName();
    setWindowTitle(tr("%1[*] - Mud Transport Setup Editor").arg(name));
    setWindowModified(m_modified);
}

void CEditorWindow::NewSetup(int fractions, int layers) {
    auto doc = std::make_unique<CSetupDocument>();
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    model->NumberOfFractions(fractions);
    model->NumberOfLayers(layers);
    SetDocument(std::move(doc), QString());
    statusBar()->showMessage(tr("New setup with %1 fractions and %2 bed layers").arg(fractions).arg(layers),
                             5000);
}

bool CEditorWindow::OpenFile(const QString& path) {
    CSetupDocument::OpenResult opened = CSetupDocument::Open(path.toStdString());
    if (opened.error) {
        Ask({QMessageBox::Critical, tr("Open Setup"),
             tr("The setup could not be opened:\n\n%1").arg(Q(opened.error->ToString())),
             QMessageBox::Ok});
        return false;
    }
    SetDocument(std::move(opened.document), QFileInfo(path).absoluteFilePath());
    AddRecentFile(m_path);
    ShowReadWarnings(opened.warnings);
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
    statusBar()->showMessage(tr("Opened with %n warning(s); see the messages", nullptr,
                                static_cast<int>(warnings.size())));
}

void CEditorWindow::AddReadWarningItems() {
    const QIcon icon = style()->standardIcon(QStyle::SP_MessageBoxWarning);
    for (const paramfile::Diagnostic& w : m_readWarnings) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, QStringLiteral("%1:%2:%3").arg(Q(w.file)).arg(w.pos.line).arg(w.pos.column));
        item->setText(1, tr("warning: %1").arg(Q(w.message)));
        item->setToolTip(1, Q(w.message));
        item->setIcon(0, icon);
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
    if (!m_doc->SaveAs(path.toStdString(), &error)) {
        Ask({QMessageBox::Critical, tr("Save Setup"),
             tr("The setup could not be saved to %1:\n\n%2\n\nThe file was not changed.")
                 .arg(path, Q(error)),
             QMessageBox::Ok});
        return false;
    }
    m_path = QFileInfo(path).absoluteFilePath();
    SetModified(false);
    AddRecentFile(m_path);
    // The file now holds what the setup holds: what reading said of the old one is past
    // (the list shows it until the next validation).
    m_readWarnings.clear();
    const int problems = static_cast<int>(m_doc->Errors().size());
    statusBar()->showMessage(problems ? tr("Saved %1 with %n validation message(s)", nullptr, problems).arg(path)
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
    const int ok = m_doc->ValidateAll();
    m_messages->clear();
    AddReadWarningItems();
    const QIcon icon = style()->standardIcon(QStyle::SP_MessageBoxCritical);
    for (const CZoSEKivGlobalBase::ErrorEntry& e : m_doc->Errors()) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, Q(NodePath(e.node)));
        item->setText(1, Q(e.message));
        item->setIcon(0, icon);
        item->setToolTip(1, Q(e.message));
        SetNode(item, e.node);
    }
    const bool valid = ok && m_doc->Errors().empty();
    if (valid) {
        auto* item = new QTreeWidgetItem(m_messages);
        item->setText(0, tr("The setup is valid."));
        item->setIcon(0, style()->standardIcon(QStyle::SP_DialogApplyButton));
        item->setFirstColumnSpanned(true);
    }
    m_messagesDock->show();
    // Validation may correct values silently.
    RefreshTree();
    if (m_dialog)
        m_dialog->SetData();
    statusBar()->showMessage(valid ? tr("The setup is valid")
                                   : tr("%n validation message(s)", nullptr,
                                        static_cast<int>(m_doc->Errors().size())),
                             8000);
    return valid;
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

void CEditorWindow::OnCurrentItemChanged(QTreeWidgetItem* item) {
    if (!item)
        return;
    CZoSEKivBase* node = NodeOf(item);
    if (node) {
        ShowNode(node);
        return;
    }
    // The host data branch itself: what it holds.
    CloseDialog(false);
    m_currentNode = nullptr;
    m_paneTitle->setText(item->text(0));
    m_panePath->clear();
    auto* page = new QLabel(HelpTopicHtml(kHelpHostData));
    page->setWordWrap(true);
    page->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    page->setContentsMargins(16, 12, 16, 12);
    m_scroll->setWidget(page);
}

void CEditorWindow::ShowNode(CZoSEKivBase* node) {
    CloseDialog(false);
    m_currentNode = node;
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
    if (m_dialog && m_dialog->GetHelpID())
        return m_dialog->GetHelpID();
    if (const auto* help = dynamic_cast<const CFemHelpBase*>(m_currentNode))
        return help->GetHelpID();
    if (!m_currentNode && m_tree->currentItem() == m_hostItem)
        return kHelpHostData;
    return 0;
}

// --- CDialogHost -------------------------------------------------------------------------

void CEditorWindow::UpdateDoc(CZoSEDlgBase*, int) {
    SetModified(true);
    RefreshTree();
    if (m_dialog && !m_initializing)
        m_dialog->SetData();
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
        QAction* a = m_recentMenu->addAction(QStringLiteral("&%1 %2").arg(i + 1).arg(QFileInfo(path).fileName()),
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
