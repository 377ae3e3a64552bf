// The editor as a modeller meets it beyond the forms themselves: undo and redo of every kind
// of stored change, the mouse wheel over fields, help that follows the tree, messages that
// follow the setup, and the messages and names a user reads.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "HelpTopics.h"
#include "PreferencesDialog.h"
#include "bed/MTBedRoughnessKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/FemInDataKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "fem/UnitUtil.h"
#include "hydro/HDDensityKiv.h"
#include "setupeditor/NavigationTree.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoGridWnd.h"

#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QFormLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QScrollArea>
#include <QScrollBar>
#include <QSpinBox>
#include <QStatusBar>
#include <QTableWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTextBrowser>
#include <QTreeWidget>
#include <QUndoStack>
#include <QWheelEvent>

#include <gtest/gtest.h>

#include <memory>

namespace {

const QString kExample = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");

// Two clicks of the wheel, downwards, as a mouse sends them over the widget.
void Wheel(QWidget* w, int clicks = -2) {
    const QPointF local(w->width() / 2.0, w->height() / 2.0);
    QWheelEvent event(local, w->mapToGlobal(local), QPoint(), QPoint(0, 120 * clicks), Qt::NoButton,
                      Qt::NoModifier, Qt::NoScrollPhase, false);
    QApplication::sendEvent(w, &event);
}

class EditorUndoTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, m_dir.filePath("settings"));
        EditorSettings().clear();
        CUnitUtil::ResetUserUnits();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([this](const CEditorWindow::Prompt& p) {
            m_prompts.push_back(p.text);
            return QMessageBox::Cancel;
        });
        m_window->show();
        m_window->activateWindow();
        ASSERT_TRUE(QTest::qWaitForWindowActive(m_window.get()));
        m_path = m_dir.filePath("estuary.setup");
        QFile::remove(m_path);
        ASSERT_TRUE(QFile::copy(kExample, m_path));
        // The mesh and data files the example names go with it, so that it validates.
        const QDir examples(QStringLiteral(MUD_SOURCE_DIR "/examples"));
        QFile::copy(examples.filePath("estuary.2dm"), m_dir.filePath("estuary.2dm"));
        QDir(m_dir.path()).mkpath("data");
        for (const QString& f : QDir(examples.filePath("data")).entryList(QDir::Files))
            QFile::copy(examples.filePath("data/" + f), m_dir.filePath("data/" + f));
        ASSERT_TRUE(m_window->OpenFile(m_path));
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        CUnitUtil::ResetUserUnits();
    }

    std::string Text() { return m_window->Document().ToText(); }
    CZoSEDlgBase* Form() { return m_window->CurrentDialog(); }
    QPushButton* Button(const QString& text) {
        for (QPushButton* b : Form()->findChildren<QPushButton*>())
            if (b->text() == text)
                return b;
        ADD_FAILURE() << "no button " << text.toStdString();
        return nullptr;
    }
    QStringList MessageSections() {
        QStringList out;
        for (int i = 0; i < m_window->Messages()->topLevelItemCount(); ++i)
            out << m_window->Messages()->topLevelItem(i)->text(0);
        return out;
    }
    // Waits for the quiet validation that follows a change.
    bool WaitForMessages(const std::function<bool()>& done) { return QTest::qWaitFor(done, 3000); }

    QTemporaryDir m_dir;
    QString m_path;
    std::unique_ptr<CEditorWindow> m_window;
    std::vector<QString> m_prompts;
};

}  // namespace

TEST_F(EditorUndoTest, UndoAndRedoOfAValueRestoreTheTextAndNameTheField) {
    const std::string opened = Text();
    ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
    auto* steps = Form()->findChild<QSpinBox*>();
    ASSERT_TRUE(steps);
    steps->setFocus();
    steps->setValue(2880);
    QTest::keyClick(steps, Qt::Key_Return);
    const std::string edited = Text();
    ASSERT_NE(edited, opened);
    EXPECT_EQ(m_window->UndoStack()->undoText(), "Number of time steps");
    EXPECT_TRUE(m_window->IsModified());

    m_window->Undo();
    EXPECT_EQ(Text(), opened);
    EXPECT_FALSE(m_window->IsModified());
    // The form shows the value of the state it came back to.
    ASSERT_TRUE(Form());
    EXPECT_EQ(Form()->findChild<QSpinBox*>()->value(), 17280);
    EXPECT_EQ(m_window->CurrentNode(), m_window->Document().GetPeriod());
    m_window->Redo();
    EXPECT_EQ(Text(), edited);
    EXPECT_TRUE(m_window->IsModified());
}

TEST_F(EditorUndoTest, UndoOfACountChangeBringsBackEveryItemWithItsValues) {
    const std::string opened = Text();
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
    auto* fractions = uitest::Child<QLineEdit>(Form(), "fractions");
    fractions->setFocus();
    uitest::Enter(fractions, "1");
    CParameterSelectionKiv* model = ModelDefinition(m_window->Document().Module());
    ASSERT_EQ(model->NumberOfFractions(), 1);
    EXPECT_EQ(m_window->UndoStack()->undoText(), "Number of Fractions");
    EXPECT_EQ(m_window->UndoStack()->count(), 1);

    m_window->Undo();
    // Every item of fractions 2 and 3, in every per-fraction section, as it was.
    EXPECT_EQ(Text(), opened);
    EXPECT_EQ(ModelDefinition(m_window->Document().Module())->NumberOfFractions(), 3);
    EXPECT_EQ(m_window->CurrentNode(), ModelDefinition(m_window->Document().Module()));
    EXPECT_EQ(uitest::Child<QLineEdit>(Form(), "fractions")->text(), "3");
    m_window->Redo();
    EXPECT_EQ(ModelDefinition(m_window->Document().Module())->NumberOfFractions(), 1);
    // The keys reach the setup's history also from a number field that has nothing of its
    // own to take back.
    fractions = uitest::Child<QLineEdit>(Form(), "fractions");
    fractions->setFocus();
    ASSERT_FALSE(fractions->isUndoAvailable());
    QTest::keyClick(fractions, Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(Text(), opened);
    QTest::keyClick(uitest::Child<QLineEdit>(Form(), "fractions"), Qt::Key_Y, Qt::ControlModifier);
    EXPECT_EQ(ModelDefinition(m_window->Document().Module())->NumberOfFractions(), 1);
    m_window->Undo();
    EXPECT_EQ(Text(), opened);
}

TEST_F(EditorUndoTest, UndoOfRowOperationsRestoresTheList) {
    const std::string opened = Text();
    ASSERT_TRUE(m_window->SelectPath("DOMAIN/BOUNDARY_NAMES"));
    Button("Add")->setFocus();
    Button("Add")->click();
    const std::string added = Text();
    ASSERT_NE(added, opened);
    EXPECT_EQ(m_window->UndoStack()->undoText(), "Add in Boundaries");
    auto* table = Form()->findChild<QTableWidget*>();
    table->setCurrentCell(0, 0);
    Button("Move Down")->click();
    const std::string moved = Text();
    table = Form()->findChild<QTableWidget*>();
    table->setCurrentCell(1, 0);
    Button("Delete")->click();
    EXPECT_EQ(m_window->Document().GetBoundaryNames()->GetItemCount(), 3);

    m_window->Undo();
    EXPECT_EQ(Text(), moved);
    m_window->Undo();
    EXPECT_EQ(Text(), added);
    m_window->Undo();
    EXPECT_EQ(Text(), opened);
    EXPECT_FALSE(m_window->UndoStack()->canUndo());
    // The page shows the list it came back to.
    EXPECT_EQ(Form()->findChild<QTableWidget*>()->rowCount(), 3);
    m_window->Redo();
    EXPECT_EQ(Text(), added);
}

TEST_F(EditorUndoTest, UndoToTheSavedStateClearsTheModifiedMark) {
    CSimulationPeriodKiv* period = m_window->Document().GetPeriod();
    period->TimeStepCount(10);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    ASSERT_TRUE(m_window->SaveFile(m_path));
    EXPECT_FALSE(m_window->IsModified());
    period->TimeStepCount(20);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    EXPECT_TRUE(m_window->IsModified());
    m_window->Undo();
    EXPECT_FALSE(m_window->IsModified());
    m_window->Undo();  // before the save: modified again
    EXPECT_TRUE(m_window->IsModified());
    m_window->Redo();
    EXPECT_FALSE(m_window->IsModified());

    // A stored change that changes nothing in the file is no edit.
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    EXPECT_FALSE(m_window->IsModified());
    EXPECT_EQ(m_window->UndoStack()->count(), 2);

    // New and Open start an empty history.
    ASSERT_TRUE(m_window->OpenFile(m_path));
    EXPECT_EQ(m_window->UndoStack()->count(), 0);
    m_window->NewSetup(2, 3);
    EXPECT_EQ(m_window->UndoStack()->count(), 0);
    EXPECT_FALSE(m_window->IsModified());
}

TEST_F(EditorUndoTest, TheWheelOverAFieldWithoutFocusChangesNothing) {
    m_window->resize(900, 300);  // small enough that the forms scroll
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/BED/ROUGHNESS"));
    QComboBox* format = Form()->findChild<QComboBox*>();
    ASSERT_TRUE(format);
    const int before = format->currentIndex();
    const std::string text = Text();
    ASSERT_FALSE(format->hasFocus());
    Wheel(format);
    EXPECT_EQ(format->currentIndex(), before);
    EXPECT_EQ(Text(), text);
    EXPECT_FALSE(m_window->IsModified());
    // The wheel does not hand out the focus either, so a second roll changes nothing too.
    EXPECT_EQ(format->focusPolicy(), Qt::StrongFocus);
    Wheel(format);
    EXPECT_EQ(format->currentIndex(), before);

    // A spin box of a host page, and the unit lists of the preferences.
    ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
    auto* steps = Form()->findChild<QSpinBox*>();
    Wheel(steps, 3);
    EXPECT_EQ(steps->value(), 17280);
    EXPECT_FALSE(m_window->IsModified());
    CPreferencesDialog preferences(m_window.get());
    preferences.show();
    for (QComboBox* units : preferences.findChildren<QComboBox*>()) {
        const int index = units->currentIndex();
        Wheel(units);
        EXPECT_EQ(units->currentIndex(), index);
    }

    // With the focus the wheel is the field's: the user asked for it.
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/SOLUTION_TECHNIQUE"));
    QComboBox* scheme = Form()->findChild<QComboBox*>();
    ASSERT_TRUE(scheme);
    scheme->setFocus();
    ASSERT_TRUE(scheme->hasFocus());
    const int index = scheme->currentIndex();
    Wheel(scheme, index == 0 ? -1 : 1);
    EXPECT_NE(scheme->currentIndex(), index);
}

TEST_F(EditorUndoTest, TheWheelOverAFieldScrollsTheForm) {
    m_window->resize(900, 240);
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/BED/ROUGHNESS"));
    QScrollArea* scroll = nullptr;
    for (QWidget* w = Form(); w && !scroll; w = w->parentWidget())
        scroll = qobject_cast<QScrollArea*>(w);
    ASSERT_TRUE(scroll);
    // The layout settles over a few event rounds, later on a busy machine.
    ASSERT_TRUE(QTest::qWaitFor([&] { return scroll->verticalScrollBar()->maximum() > 0; }, 5000))
        << "the form fits; the window is too tall for the test";
    QComboBox* format = Form()->findChild<QComboBox*>();
    ASSERT_TRUE(format);
    const int before = scroll->verticalScrollBar()->value();
    const std::string text = Text();
    Wheel(format);
    EXPECT_EQ(Text(), text);
    EXPECT_GT(scroll->verticalScrollBar()->value(), before);
}

TEST_F(EditorUndoTest, HelpFollowsTheSelection) {
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
    EXPECT_TRUE(m_window->HelpView()->toPlainText().startsWith(FindHelpTopic(5046).title));
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/BED/ROUGHNESS"));
    const QString roughness = m_window->HelpView()->toPlainText();
    EXPECT_TRUE(roughness.startsWith("Bed Roughness")) << roughness.toStdString();
    EXPECT_TRUE(roughness.contains("larger than or equal to 0.0"));
    ASSERT_TRUE(m_window->SelectPath("DOMAIN"));
    EXPECT_TRUE(m_window->HelpView()->toPlainText().startsWith("Domain"));
    // No internal numbers for the user, and the host data branch heads its page only once.
    for (QTreeWidgetItemIterator it(m_window->Tree()); *it; ++it) {
        if ((*it)->text(0) != "Host data")
            continue;
        m_window->Tree()->setCurrentItem(*it);
        for (QLabel* l : m_window->findChildren<QLabel*>()) {
            if (l->isVisibleTo(m_window.get())) {
                EXPECT_FALSE(l->text().contains("<h2>")) << l->text().toStdString();
            }
        }
        EXPECT_TRUE(m_window->HelpView()->toPlainText().startsWith("Host data"));
    }
    for (CZoSEKivBase* node : m_window->ShownNodes()) {
        m_window->SelectTreeItem(node);
        EXPECT_FALSE(m_window->HelpView()->toPlainText().contains("Help topic")) << NodePath(node);
    }
}

TEST_F(EditorUndoTest, TheMessageListFollowsTheSetup) {
    auto* roughness = uitest::FindNodeAs<CMTBedRoughnessKiv>(m_window->Document().Module(), {"BED", "ROUGHNESS"});
    ASSERT_TRUE(roughness);
    CFemInDataKiv* value = roughness->Roughness();
    value->Constant(-1.0);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    ASSERT_TRUE(WaitForMessages([&] { return MessageSections().contains("Bed Parameters > Bed Roughness"); }))
        << MessageSections().join(", ").toStdString();
    QTreeWidgetItem* message = m_window->Messages()->topLevelItem(0);
    EXPECT_EQ(message->toolTip(0), "MUD_TRANSPORT_MODULE/BED/ROUGHNESS");
    message->setSelected(true);
    EXPECT_EQ(m_window->MessagesText(true),
              "MUD_TRANSPORT_MODULE/BED/ROUGHNESS: Constant value must be larger than or equal to 0.0");

    value->Constant(0.002);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    ASSERT_TRUE(WaitForMessages([&] { return MessageSections() == QStringList{"The setup is valid."}; }))
        << MessageSections().join(", ").toStdString();
}

TEST_F(EditorUndoTest, ARefusedValueNamesItsFieldAndStaysOnItsForm) {
    uitest::MessageRecorder messages;
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
    CZoSEKivBase* model = m_window->CurrentNode();
    auto* fractions = uitest::Child<QLineEdit>(Form(), "fractions");
    uitest::Enter(fractions, "9");
    ASSERT_EQ(messages.Messages().size(), 1u);
    EXPECT_EQ(messages.Messages()[0],
              "Number of Fractions (Parameter Selection): Please enter an integer between 1 and 8.");

    // Typed, then the tree clicked: the form stays, with the message about its field.
    fractions = uitest::Child<QLineEdit>(Form(), "fractions");
    fractions->setFocus();
    fractions->selectAll();
    QTest::keyClicks(fractions, "x");
    QTreeWidgetItem* other = nullptr;
    for (QTreeWidgetItemIterator it(m_window->Tree()); *it && !other; ++it)
        if ((*it)->text(0) == "Solution technique")
            other = *it;
    ASSERT_TRUE(other);
    QTest::mouseClick(m_window->Tree()->viewport(), Qt::LeftButton, {},
                      m_window->Tree()->visualItemRect(other).center());
    ASSERT_EQ(messages.Messages().size(), 2u);
    EXPECT_TRUE(messages.Messages()[1].startsWith("Number of Fractions (Parameter Selection): "))
        << messages.Messages()[1].toStdString();
    EXPECT_EQ(m_window->CurrentNode(), model);
    EXPECT_EQ(m_window->Tree()->currentItem()->text(0), "Parameter Selection");
    // Once control is back in the event loop, the tree goes where it is clicked.
    QApplication::processEvents();
    m_window->Tree()->setCurrentItem(other);
    EXPECT_NE(m_window->CurrentNode(), model);
}

TEST_F(EditorUndoTest, GridsShowConstantsWithTheirUnits) {
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/BED/BED_DENSITY"));
    auto* grid = Form()->findChild<CZoGridWnd*>();
    ASSERT_TRUE(grid);
    EXPECT_EQ(grid->CellStyle(1, 1).DisplayText(), "Constant 180 kg/m^3");
    // In the unit chosen in the preferences.
    CUnitUtil::SetUserUnit(100017, CUnitUtil::FindQuantity(100017)->units[1].id);
    m_window->RefreshDialog();
    grid = Form()->findChild<CZoGridWnd*>();
    EXPECT_EQ(grid->CellStyle(1, 1).DisplayText(), "Constant 0.18 g/cm^3");

    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/WATER_COLUMN/SAND_FRACTIONS"));
    grid = Form()->findChild<CZoGridWnd*>();
    EXPECT_EQ(grid->CellStyle(0, 2).DisplayText(), "Mean Settling Velocity [m/s]");
}

TEST_F(EditorUndoTest, SmallThingsAModellerReads) {
    EXPECT_TRUE(m_window->AboutText().contains(QStringLiteral(MUDSETUP_VERSION_TEXT)));
    EXPECT_TRUE(m_window->AboutText().contains(QString::fromLatin1(qVersion())));

    // Preferences list the quantities alphabetically.
    CPreferencesDialog preferences;
    QStringList names;
    for (QFormLayout* form : preferences.findChildren<QFormLayout*>())
        for (int r = 0; r < form->rowCount(); ++r)
            if (auto* label = qobject_cast<QLabel*>(form->itemAt(r, QFormLayout::LabelRole)->widget()))
                names << label->text();
    ASSERT_GT(names.size(), 3);
    QStringList sorted = names;
    std::sort(sorted.begin(), sorted.end(),
              [](const QString& a, const QString& b) { return a.compare(b, Qt::CaseInsensitive) < 0; });
    EXPECT_EQ(names, sorted);

    // A file that is not there is named as such.
    m_prompts.clear();
    EXPECT_FALSE(m_window->OpenFile(m_dir.filePath("missing.setup")));
    ASSERT_EQ(m_prompts.size(), 1u);
    EXPECT_EQ(m_prompts[0], "The file " + m_dir.filePath("missing.setup") + " does not exist.");

    m_window->NewSetup(1, 1);
    EXPECT_EQ(m_window->statusBar()->currentMessage(), "New setup with 1 fraction and 1 bed layer");
}

#ifdef MUDSETUP_EDITOR_EXE
TEST_F(EditorUndoTest, WithoutADisplayTheEditorSaysWhatToDo) {
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    for (const char* name : {"QT_QPA_PLATFORM", "DISPLAY", "WAYLAND_DISPLAY"})
        env.remove(name);
    QProcess p;
    p.setProcessEnvironment(env);
    p.start(MUDSETUP_EDITOR_EXE, {kExample});
    ASSERT_TRUE(p.waitForFinished(60000));
    EXPECT_EQ(p.exitStatus(), QProcess::NormalExit);
    EXPECT_EQ(p.exitCode(), 2);
    const QString err = QString::fromLocal8Bit(p.readAllStandardError());
    EXPECT_TRUE(err.contains("needs a display")) << err.toStdString();
    EXPECT_TRUE(err.contains("--screenshot")) << err.toStdString();

    QProcess shot;
    shot.setProcessEnvironment(env);
    shot.start(MUDSETUP_EDITOR_EXE, {"--screenshot", m_dir.filePath("x.png"), m_dir.filePath("none.setup")});
    ASSERT_TRUE(shot.waitForFinished(60000));
    EXPECT_EQ(shot.exitCode(), 2);
    const QString shotErr = QString::fromLocal8Bit(shot.readAllStandardError());
    EXPECT_TRUE(shotErr.contains("does not exist")) << shotErr.toStdString();
    EXPECT_FALSE(shotErr.contains(":0:0:")) << shotErr.toStdString();
}
#endif
