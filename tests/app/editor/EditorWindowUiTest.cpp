// The editor's window driven as a user would: opening, selecting every section, editing host
// data, validating, saving and the failures of opening and saving.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "HelpTopics.h"
#include "PreferencesDialog.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "fem/UnitUtil.h"
#include "host/ModuleSelection.h"
#include "hydro/HDBoundaryConditionsKiv.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"
#include "setupeditor/NavigationTree.h"
#include "support/SyncedFollower.h"
#include "support/UiTestSupport.h"

#include <QApplication>
#include <QCheckBox>
#include <QDir>
#include <QFileInfo>
#include <QFile>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QSpinBox>
#include <QTableWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTextBrowser>
#include <QTreeWidget>
#include <QUndoStack>

#include <gtest/gtest.h>

#include <memory>

using testsupport::Follower;
using testsupport::Titles;

namespace {

const QString kExample = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");

QByteArray ReadAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

bool WriteAll(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    return f.open(QIODevice::WriteOnly | QIODevice::Truncate) && f.write(bytes) == bytes.size();
}


class EditorTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, m_dir.filePath("settings"));
        EditorSettings().clear();
        CUnitUtil::ResetUserUnits();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([this](const CEditorWindow::Prompt& p) {
            m_prompts.push_back(p.text);
            return m_answer;
        });
        m_window->show();
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        CUnitUtil::ResetUserUnits();
    }

    // A copy of the example in the test's folder, so that saving never touches the original;
    // the data files it names go beside it, as they lie beside the original.
    QString CopyOfExample(const QString& name = "estuary.setup") {
        const QString path = m_dir.filePath(name);
        EXPECT_TRUE(WriteAll(path, ReadAll(kExample)));
        // The files the example refers to go with it: the mesh and the data files.
        const QDir examples = QFileInfo(kExample).dir();
        QFile::copy(examples.filePath("estuary.2dm"), m_dir.filePath("estuary.2dm"));
        QDir(m_dir.path()).mkpath("data");
        for (const QString& f : QDir(examples.filePath("data")).entryList(QDir::Files))
            QFile::copy(examples.filePath("data/" + f), m_dir.filePath("data/" + f));
        return path;
    }

    QPushButton* Button(const QString& text) {
        for (QPushButton* b : m_window->CurrentDialog()->findChildren<QPushButton*>())
            if (b->text() == text)
                return b;
        ADD_FAILURE() << "no button " << text.toStdString();
        return nullptr;
    }
    QTableWidget* Table() { return m_window->CurrentDialog()->findChild<QTableWidget*>(); }
    QStringList Column0() {
        QStringList out;
        for (int r = 0; r < Table()->rowCount(); ++r)
            out << Table()->item(r, 0)->text();
        return out;
    }
    QStringList TreeTexts() {
        QStringList out;
        for (QTreeWidgetItemIterator it(m_window->Tree()); *it; ++it)
            out << (*it)->text(0);
        return out;
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
    std::vector<QString> m_prompts;
    QMessageBox::StandardButton m_answer = QMessageBox::Cancel;
};

}  // namespace

TEST_F(EditorTest, EverySectionOfTheExampleShowsItsForm) {
    ASSERT_TRUE(m_window->OpenFile(kExample));
    EXPECT_FALSE(m_window->IsModified());
    // Opening validates: no warnings on reading the example, and nothing to say of it.
    ASSERT_EQ(m_window->Messages()->topLevelItemCount(), 1);
    EXPECT_EQ(m_window->Messages()->topLevelItem(0)->text(0), "The setup is valid.");

    // The tree shows what the navigation walk shows, then the host data.
    size_t moduleNodes = 0;
    WalkNavigationTree(m_window->Document().Module(), 0, [&](CZoSEKivBase*, int) { ++moduleNodes; });
    const std::vector<CZoSEKivBase*> shown = m_window->ShownNodes();
    ASSERT_EQ(shown.size(), moduleNodes + 7);

    for (size_t i = 0; i < shown.size(); ++i) {
        CZoSEKivBase* node = shown[i];
        SCOPED_TRACE(NodePath(node));
        m_window->SelectTreeItem(node);
        QApplication::processEvents();
        EXPECT_EQ(m_window->CurrentNode(), node);
        // Host data always has a page; module sections have a form once it is registered,
        // a placeholder before.
        const bool hasForm = i >= moduleNodes ||
                             IsDialogClassRegistered(node->GetDlgRuntimeClass(kDlgRuntimeClassRequest));
        EXPECT_EQ(m_window->CurrentDialog() != nullptr, hasForm);
        if (hasForm) {
            EXPECT_TRUE(m_window->CurrentDialog()->isVisibleTo(m_window.get()));
        } else {
            QLabel* note = nullptr;
            for (QLabel* l : m_window->findChildren<QLabel*>())
                if (l->text() == "No form for this section yet." && l->isVisibleTo(m_window.get()))
                    note = l;
            EXPECT_TRUE(note);
        }
    }
    EXPECT_TRUE(m_prompts.empty());
    EXPECT_FALSE(m_window->IsModified());
}

TEST_F(EditorTest, AnEditOnAHostPageIsSavedAndReadBack) {
    const QString path = CopyOfExample();
    ASSERT_TRUE(m_window->OpenFile(path));
    ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
    auto* steps = m_window->CurrentDialog()->findChild<QSpinBox*>();
    ASSERT_TRUE(steps);
    EXPECT_EQ(steps->value(), 17280);
    steps->setValue(2880);
    QTest::keyClick(steps, Qt::Key_Return);
    EXPECT_EQ(m_window->Document().GetPeriod()->TimeStepCount(), 2880);
    EXPECT_TRUE(m_window->IsModified());
    EXPECT_TRUE(m_window->windowTitle().startsWith("estuary.setup"));

    ASSERT_TRUE(m_window->SaveFile(path));
    EXPECT_FALSE(m_window->IsModified());
    CSetupDocument::OpenResult back = CSetupDocument::Open(path.toStdString());
    ASSERT_TRUE(back.document);
    EXPECT_EQ(back.document->GetPeriod()->TimeStepCount(), 2880);
    // Everything else is as it was.
    CSetupDocument::OpenResult original = CSetupDocument::Open(kExample.toStdString());
    ASSERT_TRUE(original.document);
    EXPECT_EQ(ReadAll(path).replace("number_of_time_steps = 2880", "number_of_time_steps = 17280")
                  .toStdString(),
              original.document->ToText());
}

TEST_F(EditorTest, AFieldStillBeingEditedIsStoredBeforeSaving) {
    const QString path = CopyOfExample();
    ASSERT_TRUE(m_window->OpenFile(path));
    m_window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(m_window.get()));
    ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
    auto* steps = m_window->CurrentDialog()->findChild<QSpinBox*>();
    ASSERT_TRUE(steps);
    steps->setFocus();
    steps->selectAll();
    QTest::keyClicks(steps, "1234");
    ASSERT_EQ(QApplication::focusWidget(), steps);
    // Saving from the menu leaves the focus where it is; the typed value must still count.
    ASSERT_TRUE(m_window->SaveFile(path));
    EXPECT_EQ(m_window->Document().GetPeriod()->TimeStepCount(), 1234);
    EXPECT_TRUE(ReadAll(path).contains("number_of_time_steps = 1234\n"));
    EXPECT_FALSE(m_window->IsModified());
}

TEST_F(EditorTest, AModelDefinitionEditReshapesTheTreeAndIsSaved) {
    const QString path = CopyOfExample();
    ASSERT_TRUE(m_window->OpenFile(path));
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
    ASSERT_TRUE(m_window->CurrentDialog());
    const qsizetype before = TreeTexts().count("Fraction 3");
    ASSERT_GT(before, 0);
    EXPECT_EQ(TreeTexts().count("Fraction 4"), 0);

    uitest::Enter(uitest::Child<QLineEdit>(m_window->CurrentDialog(), "fractions"), "4");
    CParameterSelectionKiv* model = ModelDefinition(m_window->Document().Module());
    EXPECT_EQ(model->NumberOfFractions(), 4);
    // Every per-fraction list grew at once, and the tree with them.
    EXPECT_EQ(TreeTexts().count("Fraction 4"), before);
    EXPECT_TRUE(m_window->IsModified());
    EXPECT_EQ(m_window->CurrentNode(), model);

    ASSERT_TRUE(m_window->SaveFile(path));
    CSetupDocument::OpenResult back = CSetupDocument::Open(path.toStdString());
    ASSERT_TRUE(back.document);
    EXPECT_EQ(ModelDefinition(back.document->Module())->NumberOfFractions(), 4);
}

TEST_F(EditorTest, BoundariesAndSourcesChangedOnTheirPagesAreFollowed) {
    ASSERT_TRUE(m_window->OpenFile(CopyOfExample()));
    CSetupDocument& doc = m_window->Document();
    CBoundaryNamesKiv* names = doc.GetBoundaryNames();
    Follower boundaries(names);
    Follower sources(doc.GetSources());

    ASSERT_TRUE(m_window->SelectPath("DOMAIN/BOUNDARY_NAMES"));
    EXPECT_EQ(Column0(), QStringList({"Sea boundary", "River Elbe", "River Oste"}));
    Button("Add")->click();
    boundaries.Tag();
    EXPECT_EQ(Titles(names).back(), "Boundary 4");
    EXPECT_EQ(Column0().size(), 4);
    EXPECT_TRUE(m_window->IsModified());

    Table()->setCurrentCell(0, 0);
    Button("Insert")->click();
    boundaries.Tag();
    Table()->item(0, 0)->setText("North channel");  // rename in place
    EXPECT_EQ(Titles(names)[0], "North channel");
    Table()->setCurrentCell(0, 0);
    Button("Move Down")->click();
    EXPECT_EQ(Column0(), QStringList({"Sea boundary", "North channel", "River Elbe", "River Oste",
                                      "Boundary 4"}));
    Table()->setCurrentCell(3, 0);
    Button("Delete")->click();
    EXPECT_EQ(Titles(names), (std::vector<CString>{"Sea boundary", "North channel", "River Elbe",
                                                   "Boundary 4"}));
    // The follower kept its items with their boundaries through every step.
    EXPECT_EQ(boundaries.Tags(), (std::vector<CString>{"Sea boundary", "Boundary 5", "River Elbe",
                                                       "Boundary 4"}));
    EXPECT_EQ(Titles(doc.GetBoundaryConditions()), Titles(names));
    // A rename to nothing is refused; the table shows the stored name again.
    Table()->item(1, 0)->setText("  ");
    EXPECT_EQ(Titles(names)[1], "North channel");
    EXPECT_EQ(Table()->item(1, 0)->text(), "North channel");

    ASSERT_TRUE(m_window->SelectPath("HYDRODYNAMIC_SOURCES"));
    Button("Add")->click();
    sources.Tag();
    Table()->setCurrentCell(2, 0);
    Button("Move Up")->click();
    EXPECT_EQ(Column0(), QStringList({"Brunsbüttel outfall", "Source 3", "Cuxhaven harbour"}));
    EXPECT_EQ(sources.Tags(), Titles(doc.GetSources()));
    Table()->item(1, 1)->setCheckState(Qt::Unchecked);
    EXPECT_EQ(doc.GetSources()->GetItem(2)->Include(), 0);
    Table()->item(1, 2)->setText("500000.5");
    EXPECT_EQ(doc.GetSources()->GetItem(2)->X(), 500000.5);
    Table()->item(1, 3)->setText("not a number");
    const MeshInfo extent = doc.GetDomain()->GetMeshInfo();
    EXPECT_EQ(doc.GetSources()->GetItem(2)->Y(), (extent.yMin + extent.yMax) / 2);

    // The module's own lists, where they exist, appear in the tree under the new names.
    if (doc.GetImportantNode("MudTransportBoundaryConditions")) {
        EXPECT_TRUE(TreeTexts().contains("North channel"));
    }
    if (doc.GetImportantNode("MTSource")) {
        EXPECT_TRUE(TreeTexts().contains("Source 3"));
    }

    // Saved and read again, the lists are as edited.
    const QString saved = m_dir.filePath("edited.setup");
    ASSERT_TRUE(m_window->SaveFile(saved));
    CSetupDocument::OpenResult back = CSetupDocument::Open(saved.toStdString());
    ASSERT_TRUE(back.document);
    EXPECT_EQ(Titles(back.document->GetBoundaryNames()), Titles(names));
    EXPECT_EQ(Titles(back.document->GetSources()), Titles(doc.GetSources()));
}

TEST_F(EditorTest, SaveAsIntoAnotherFolderKeepsEveryFileTheSetupNames) {
    ASSERT_TRUE(m_window->OpenFile(CopyOfExample()));
    ASSERT_TRUE(m_window->SelectPath("DOMAIN"));
    m_window->Document().GetSources()->GetItem(1)->Name("Renamed outfall");
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    ASSERT_TRUE(m_window->IsModified());

    ASSERT_TRUE(QDir(m_dir.path()).mkpath("runs/april"));
    const QString moved = m_dir.filePath("runs/april/moved.setup");
    ASSERT_TRUE(m_window->SaveFile(moved));
    EXPECT_FALSE(m_window->IsModified());
    const QByteArray text = ReadAll(moved);
    EXPECT_TRUE(text.contains("mesh_file = '../../estuary.2dm'\n"));
    EXPECT_TRUE(text.contains("file_name = '../../data/dredger_1.qrd0'\n"));
    // The form shows the name as saved, the files are found from the new folder, and no undo
    // brings back names that were right only from the old one.
    EXPECT_EQ(m_window->Document().GetDomain()->MeshFile(), "../../estuary.2dm");
    bool shown = false;
    for (QLineEdit* edit : m_window->CurrentDialog()->findChildren<QLineEdit*>())
        shown = shown || edit->text() == "../../estuary.2dm";
    EXPECT_TRUE(shown);
    QStringList listed;
    for (int i = 0; i < m_window->Messages()->topLevelItemCount(); ++i)
        listed << m_window->Messages()->topLevelItem(i)->text(0) + ": " + m_window->Messages()->topLevelItem(i)->text(1);
    EXPECT_EQ(listed, QStringList{"The setup is valid.: "});
    EXPECT_FALSE(m_window->UndoStack()->canUndo());
    EXPECT_EQ(m_window->Document().GetSources()->GetItem(1)->Name(), "Renamed outfall");
    ASSERT_TRUE(m_window->SaveFile(moved));
    EXPECT_EQ(ReadAll(moved), text);

    // The same setup opened where its files are not: the missing mesh is listed at once.
    ASSERT_TRUE(QDir(m_dir.path()).mkpath("lost"));
    const QString lost = m_dir.filePath("lost/moved.setup");
    ASSERT_TRUE(QFile::copy(moved, lost));
    ASSERT_TRUE(m_window->OpenFile(lost));
    QStringList messages;
    for (int i = 0; i < m_window->Messages()->topLevelItemCount(); ++i)
        messages << m_window->Messages()->topLevelItem(i)->text(1);
    ASSERT_FALSE(messages.isEmpty());
    EXPECT_TRUE(messages[0].startsWith("The mesh cannot be read: " +
                                       QDir::cleanPath(m_dir.path() + "/../estuary.2dm")))
        << messages.join("\n").toStdString();
    EXPECT_FALSE(m_window->IsModified());
}

TEST_F(EditorTest, ASyntaxErrorLeavesTheOpenSetupAsItWas) {
    ASSERT_TRUE(m_window->OpenFile(CopyOfExample()));
    CSetupDocument* before = &m_window->Document();
    before->GetPeriod()->TimeStepCount(5);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    const QString bad = m_dir.filePath("bad.setup");
    ASSERT_TRUE(WriteAll(bad, "DOMAIN {\n    x_min = 1.0.0\n}\n"));

    EXPECT_FALSE(m_window->OpenFile(bad));
    ASSERT_EQ(m_prompts.size(), 1u);
    EXPECT_TRUE(m_prompts[0].contains(bad + ":2:")) << m_prompts[0].toStdString();
    EXPECT_EQ(&m_window->Document(), before);
    EXPECT_EQ(before->GetPeriod()->TimeStepCount(), 5);
    EXPECT_TRUE(m_window->IsModified());
    EXPECT_TRUE(m_window->windowTitle().startsWith("estuary.setup"));

    EXPECT_FALSE(m_window->OpenFile(m_dir.filePath("missing.setup")));
    EXPECT_EQ(&m_window->Document(), before);
}

TEST_F(EditorTest, AFailedSaveLeavesFileAndSetupAsTheyWere) {
    const QString path = CopyOfExample();
    ASSERT_TRUE(m_window->OpenFile(path));
    m_window->Document().GetPeriod()->TimeStepCount(7);
    m_window->UpdateDoc(nullptr, kHintValueChanged);

    // A folder that does not exist, and a "folder" that is a file: both fail for anyone.
    for (const QString& target : {m_dir.filePath("no/such/folder/x.setup"), path + "/x.setup"}) {
        SCOPED_TRACE(target.toStdString());
        m_prompts.clear();
        EXPECT_FALSE(m_window->SaveFile(target));
        ASSERT_EQ(m_prompts.size(), 1u);
        EXPECT_TRUE(m_prompts[0].contains("could not be saved")) << m_prompts[0].toStdString();
        EXPECT_TRUE(m_window->IsModified());
        EXPECT_FALSE(QFile::exists(target));
    }
    EXPECT_EQ(ReadAll(path), ReadAll(kExample));
    EXPECT_EQ(m_window->Document().GetPeriod()->TimeStepCount(), 7);
    EXPECT_TRUE(m_window->windowTitle().startsWith("estuary.setup"));
    // The setup can still be saved where it came from.
    EXPECT_TRUE(m_window->SaveFile(path));
    EXPECT_FALSE(m_window->IsModified());
}

TEST_F(EditorTest, UnsavedChangesAreAskedAbout) {
    const QString path = CopyOfExample();
    ASSERT_TRUE(m_window->OpenFile(path));
    EXPECT_TRUE(m_window->MaybeSave());
    EXPECT_TRUE(m_prompts.empty());

    m_window->Document().GetPeriod()->TimeStepCount(9);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    m_answer = QMessageBox::Cancel;
    EXPECT_FALSE(m_window->close());
    EXPECT_TRUE(m_window->isVisible());
    EXPECT_EQ(m_prompts.size(), 1u);

    m_answer = QMessageBox::Save;
    EXPECT_TRUE(m_window->MaybeSave());
    EXPECT_FALSE(m_window->IsModified());
    EXPECT_TRUE(ReadAll(path).contains("number_of_time_steps = 9\n"));

    m_window->Document().GetPeriod()->TimeStepCount(10);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    m_answer = QMessageBox::Discard;
    EXPECT_TRUE(m_window->close());
    EXPECT_TRUE(ReadAll(path).contains("number_of_time_steps = 9\n"));
}

TEST_F(EditorTest, ValidationListsMessagesThatLeadToTheirSections) {
    ASSERT_TRUE(m_window->OpenFile(CopyOfExample()));
    EXPECT_TRUE(m_window->Validate());
    ASSERT_EQ(m_window->Messages()->topLevelItemCount(), 1);
    EXPECT_EQ(m_window->Messages()->topLevelItem(0)->text(0), "The setup is valid.");

    CHDDensityKiv* density = m_window->Document().GetDensity();
    density->DensityMode(9);
    EXPECT_FALSE(m_window->Validate());
    ASSERT_EQ(m_window->Messages()->topLevelItemCount(), 1);
    QTreeWidgetItem* message = m_window->Messages()->topLevelItem(0);
    EXPECT_EQ(message->text(0), "Density");
    EXPECT_EQ(message->toolTip(0), "HYDRODYNAMIC_DENSITY");
    EXPECT_EQ(message->text(1), "Density mode 9 is not known");
    emit m_window->Messages()->itemActivated(message, 0);
    EXPECT_EQ(m_window->CurrentNode(), density);
}

TEST_F(EditorTest, WarningsFromReadingAreListed) {
    QByteArray text = ReadAll(kExample);
    text.replace("number_of_time_steps = 17280", "number_of_time_steps = \"many\"");
    const QString path = m_dir.filePath("odd.setup");
    ASSERT_TRUE(WriteAll(path, text));
    ASSERT_TRUE(m_window->OpenFile(path));
    // The one warning of reading comes first, then what validation says.
    ASSERT_GE(m_window->Messages()->topLevelItemCount(), 1);
    for (int i = 1; i < m_window->Messages()->topLevelItemCount(); ++i)
        EXPECT_FALSE(m_window->Messages()->topLevelItem(i)->text(1).startsWith("warning: "));
    QTreeWidgetItem* w = m_window->Messages()->topLevelItem(0);
    EXPECT_TRUE(w->text(0).startsWith(path + ":")) << w->text(0).toStdString();
    EXPECT_TRUE(w->text(1).startsWith("warning: ")) << w->text(1).toStdString();
    EXPECT_EQ(m_window->Document().GetPeriod()->TimeStepCount(), 0);
}

TEST_F(EditorTest, ContentNoSectionReadsIsListedAndSavingItAwayIsAskedOnce) {
    CopyOfExample();  // brings the mesh and data files beside it
    QByteArray text = ReadAll(kExample);
    text.replace("MUD_TRANSPORT_MODULE {\n", "MUD_TRANSPORT_MODULE {\n    PARTICLE_TRACKING {\n    }\n");
    const QString path = m_dir.filePath("newer.setup");
    ASSERT_TRUE(WriteAll(path, text));
    ASSERT_TRUE(m_window->OpenFile(path));
    // Opening validates: the warning, then the verdict.
    ASSERT_EQ(m_window->Messages()->topLevelItemCount(), 2);
    EXPECT_TRUE(m_window->Messages()->topLevelItem(0)->text(1).contains("unknown section 'PARTICLE_TRACKING'"));
    // Validation keeps the warnings of reading above its own messages.
    m_window->Validate();
    ASSERT_EQ(m_window->Messages()->topLevelItemCount(), 2);
    EXPECT_TRUE(m_window->Messages()->topLevelItem(0)->text(1).startsWith("warning: "));

    m_answer = QMessageBox::Cancel;
    EXPECT_FALSE(m_window->SaveFile(path));
    ASSERT_EQ(m_prompts.size(), 1u);
    EXPECT_TRUE(m_prompts[0].contains("unknown section 'PARTICLE_TRACKING'"));
    EXPECT_EQ(ReadAll(path), text);

    m_answer = QMessageBox::Save;
    EXPECT_TRUE(m_window->SaveFile(path));
    EXPECT_FALSE(ReadAll(path).contains("PARTICLE_TRACKING"));
    // Once saved, the setup and the file agree: nothing more to ask.
    EXPECT_TRUE(m_window->SaveFile(path));
    EXPECT_EQ(m_prompts.size(), 2u);
}

TEST_F(EditorTest, TheTreeFollowsTheModelAndLosesRemovedSections) {
    ASSERT_TRUE(m_window->OpenFile(CopyOfExample()));
    CParameterSelectionKiv* model = ModelDefinition(m_window->Document().Module());
    const int before = static_cast<int>(m_window->ShownNodes().size());
    model->NumberOfLayers(3);
    m_window->UpdateDoc(nullptr, kHintItemsAdded);
    const int grown = static_cast<int>(m_window->ShownNodes().size());
    EXPECT_GE(grown, before);

    // Whatever per-layer sections exist show a third layer; selecting one and removing the
    // layer again closes its form.
    CZoSEKivBase* third = nullptr;
    for (CZoSEKivBase* node : m_window->ShownNodes())
        if (node->GetTitle() == "Layer 3")
            third = node;
    if (third) {
        m_window->SelectTreeItem(third);
        model->NumberOfLayers(2);
        m_window->UpdateDoc(nullptr, kHintItemsDeleted);
        EXPECT_EQ(m_window->CurrentNode(), nullptr);
        EXPECT_EQ(m_window->CurrentDialog(), nullptr);
        EXPECT_FALSE(TreeTexts().contains("Layer 3"));
    }
    // Titles follow renames at once.
    m_window->Document().GetBoundaryNames()->GetItem(1)->Identifier("Outer sea");
    m_window->UpdateDoc(nullptr, kHintTitleChanged);
    EXPECT_EQ(Titles(m_window->Document().GetBoundaryConditions())[0], "Outer sea");
}

TEST_F(EditorTest, AModuleNotInUseIsGreyed) {
    ASSERT_TRUE(m_window->OpenFile(kExample));
    QTreeWidgetItem* root = m_window->Tree()->topLevelItem(0);
    const QBrush active = m_window->Tree()->palette().brush(QPalette::Active, QPalette::Text);
    const QBrush greyed = m_window->Tree()->palette().brush(QPalette::Disabled, QPalette::Text);
    ASSERT_NE(active, greyed);
    EXPECT_EQ(root->foreground(0), active);
    ASSERT_TRUE(m_window->SelectPath("MODULE_SELECTION"));
    QCheckBox* mud = nullptr;
    for (QCheckBox* box : m_window->CurrentDialog()->findChildren<QCheckBox*>())
        if (box->text() == "Mud transport")
            mud = box;
    ASSERT_TRUE(mud);
    mud->click();
    EXPECT_EQ(m_window->Document().GetModuleSelection()->Mode(), 0);
    EXPECT_EQ(root->foreground(0), greyed);
    // Sections below it are greyed with it.
    ASSERT_GT(root->childCount(), 0);
    EXPECT_EQ(root->child(0)->foreground(0), greyed);
    mud->click();
    EXPECT_EQ(m_window->Document().GetModuleSelection()->Mode(), 2);
    EXPECT_EQ(root->foreground(0), active);
}

TEST_F(EditorTest, PathsAndNodesSelectSections) {
    ASSERT_TRUE(m_window->OpenFile(kExample));
    EXPECT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
    EXPECT_EQ(m_window->CurrentNode(), ModelDefinition(m_window->Document().Module()));
    EXPECT_TRUE(m_window->SelectPath("/DOMAIN/BOUNDARY_NAMES/"));
    EXPECT_EQ(m_window->CurrentNode(), m_window->Document().GetBoundaryNames());
    EXPECT_FALSE(m_window->SelectPath("MUD_TRANSPORT_MODULE/NO_SUCH_SECTION"));
    // Nodes ask the document, which asks the window.
    m_window->Document().SelectTreeItem(m_window->Document().GetWind());
    EXPECT_EQ(m_window->CurrentNode(), m_window->Document().GetWind());
}

TEST_F(EditorTest, HelpShowsTheTopicOfTheSection) {
    for (unsigned long id : {5001ul, 5011ul, 5028ul, 5044ul, 5046ul, 5047ul})
        EXPECT_TRUE(HasHelpTopic(id)) << id;
    m_window->ShowHelp(5046);
    EXPECT_TRUE(m_window->HelpView()->toPlainText().contains("Number of Fractions"));
    // A section without a topic of its own gets the general help, without internal numbers.
    m_window->ShowHelp(4999);
    EXPECT_TRUE(m_window->HelpView()->toPlainText().startsWith(FindHelpTopic(0).title));
    EXPECT_FALSE(m_window->HelpView()->toPlainText().contains("4999"));
}

TEST_F(EditorTest, UnitsChosenInThePreferencesAreRemembered) {
    const QuantityInfo* settling = CUnitUtil::FindQuantity(100128);
    ASSERT_TRUE(settling);
    {
        CPreferencesDialog dialog;
        EXPECT_TRUE(dialog.ChooseUnit(100128, "mm/s"));
        EXPECT_FALSE(dialog.ChooseUnit(100128, "furlong/fortnight"));
        dialog.Apply();
    }
    EXPECT_EQ(CUnitUtil::GetUnitName(CUnitUtil::GetUserUnit(100128)), "mm/s");
    CUnitUtil::ResetUserUnits();
    CPreferencesDialog::LoadRemembered();
    EXPECT_EQ(CUnitUtil::GetUnitName(CUnitUtil::GetUserUnit(100128)), "mm/s");
    EXPECT_DOUBLE_EQ(ToUserUnit(100128, 0.002), 2.0);
}

#ifdef MUDSETUP_EDITOR_EXE
TEST_F(EditorTest, ScreenshotsNeedNoDisplay) {
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.remove("QT_QPA_PLATFORM");
    env.remove("DISPLAY");
    env.remove("WAYLAND_DISPLAY");
    auto run = [&](const QStringList& args, QString* err = nullptr) {
        QProcess p;
        p.setProcessEnvironment(env);
        p.start(MUDSETUP_EDITOR_EXE, args);
        EXPECT_TRUE(p.waitForFinished(120000));
        if (err)
            *err = QString::fromLocal8Bit(p.readAllStandardError());
        return p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
    };
    const QString png = m_dir.filePath("shot.png");
    EXPECT_EQ(run({"--screenshot", png, "--select", "DOMAIN", kExample}), 0);
    const QImage image(png);
    EXPECT_EQ(image.size(), QSize(1280, 800));

    QString err;
    EXPECT_EQ(run({"--screenshot", m_dir.filePath("x.png"), "--select", "NOWHERE", kExample}, &err), 2);
    EXPECT_TRUE(err.contains("no section at 'NOWHERE'")) << err.toStdString();
    const QString bad = m_dir.filePath("bad.setup");
    ASSERT_TRUE(WriteAll(bad, "MUD_TRANSPORT_MODULE {\n"));
    EXPECT_EQ(run({"--screenshot", m_dir.filePath("y.png"), bad}, &err), 2);
    EXPECT_TRUE(err.contains(bad + ":")) << err.toStdString();
    EXPECT_FALSE(QFile::exists(m_dir.filePath("x.png")));
    // The picture is written as every file is: never over a folder or a device.
    EXPECT_EQ(run({"--screenshot", "/dev/null", kExample}, &err), 2);
    EXPECT_TRUE(err.contains("cannot write '/dev/null': is not a regular file")) << err.toStdString();
}
#endif
