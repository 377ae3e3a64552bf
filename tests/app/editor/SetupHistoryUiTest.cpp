// The undo history on a setup of 1,000 boundaries: every kind of stored change comes back to
// the exact text, in any order of undo and redo, and the history keeps within its memory.
#include "EditorWindow.h"
#include "SetupHistory.h"
#include "bed/MTBedRoughnessKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/FemInDataKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "setupeditor/NavigationTree.h"
#include "support/UiTestSupport.h"

#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QTemporaryDir>
#include <QTest>
#include <QUndoStack>

#include <gtest/gtest.h>

#include <fstream>

namespace {

class SetupHistoryTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        CSetupDocument doc;
        ModelDefinition(doc.Module())->NumberOfFractions(3);
        doc.GetBoundaryNames()->SetItemCount(1000, 1);
        doc.GetSources()->SetItemCount(100, 1);
        for (int i = 1; i <= 1000; ++i)
            doc.GetBoundaryNames()->GetItem(i)->Identifier("Boundary " + std::to_string(i));
        const QString path = m_dir.filePath("large.setup");
        std::ofstream(path.toStdString()) << doc.ToText();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([](const CEditorWindow::Prompt&) { return QMessageBox::Cancel; });
        m_window->show();
        ASSERT_TRUE(m_window->OpenFile(path));
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    std::string Text() { return m_window->Document().ToText(); }
    CZoSEDlgBase* Form() { return m_window->CurrentDialog(); }
    QUndoStack* Stack() { return m_window->UndoStack(); }
    // A value stored as a form stores it.
    void SetTimeSteps(int n) {
        if (m_window->CurrentNode() != m_window->Document().GetPeriod()) {
            ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
        }
        m_window->Document().GetPeriod()->TimeStepCount(n);
        m_window->UpdateDoc(Form(), kHintValueChanged);
    }
    void SetFractions(const char* n) {
        ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION"));
        auto* fractions = uitest::Child<QLineEdit>(Form(), "fractions");
        fractions->setFocus();
        uitest::Enter(fractions, n);
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
};

}  // namespace

TEST_F(SetupHistoryTest, EveryKindOfEditUndoesAndRedoesToTheExactText) {
    std::vector<std::string> states{Text()};
    // Values in a form of the host and of the module, as the user types them.
    ASSERT_TRUE(m_window->SelectPath("SIMULATION_PERIOD"));
    auto* steps = Form()->findChild<QSpinBox*>();
    steps->setFocus();
    steps->setValue(2880);
    QTest::keyClick(steps, Qt::Key_Return);
    states.push_back(Text());
    ASSERT_TRUE(m_window->SelectPath("MUD_TRANSPORT_MODULE/BED/ROUGHNESS"));
    auto* roughness = dynamic_cast<CMTBedRoughnessKiv*>(m_window->CurrentNode());
    ASSERT_TRUE(roughness);
    roughness->Roughness()->Constant(0.25);
    m_window->UpdateDoc(Form(), kHintValueChanged);
    states.push_back(Text());
    // A value edit keeps what it changed, not the setup.
    EXPECT_LT(m_window->History().MemoryBytes(), states.back().size() / 20);

    // A row operation among the boundaries, then a value, then a count that changes every list.
    ASSERT_TRUE(m_window->SelectPath("DOMAIN/BOUNDARY_NAMES"));
    for (QPushButton* b : Form()->findChildren<QPushButton*>())
        if (b->text() == "Add")
            b->click();
    ASSERT_EQ(m_window->Document().GetBoundaryNames()->GetItemCount(), 1001);
    states.push_back(Text());
    SetTimeSteps(99);
    states.push_back(Text());
    SetFractions("1");
    EXPECT_EQ(Stack()->undoText(), "Number of Fractions");
    states.push_back(Text());
    ASSERT_EQ(Stack()->count(), static_cast<int>(states.size()) - 1);

    for (size_t i = states.size() - 1; i > 0; --i) {
        m_window->Undo();
        ASSERT_EQ(Text(), states[i - 1]) << "undo to state " << i - 1;
    }
    EXPECT_FALSE(m_window->IsModified());
    for (size_t i = 1; i < states.size(); ++i) {
        m_window->Redo();
        ASSERT_EQ(Text(), states[i]) << "redo to state " << i;
    }
    // Back and forth across the count change, then a new edit in the middle of the history.
    m_window->Undo();
    m_window->Undo();
    m_window->Redo();
    EXPECT_EQ(Text(), states[4]);
    SetTimeSteps(7);
    const std::string branched = Text();
    EXPECT_EQ(Stack()->count(), 5);
    m_window->Undo();
    EXPECT_EQ(Text(), states[4]);
    m_window->Undo();
    EXPECT_EQ(Text(), states[3]);
    m_window->Redo();
    m_window->Redo();
    EXPECT_EQ(Text(), branched);
    // A count change after value edits that were undone and redone.
    SetFractions("2");
    const std::string two = Text();
    m_window->Undo();
    EXPECT_EQ(Text(), branched);
    m_window->Redo();
    EXPECT_EQ(Text(), two);
}

TEST_F(SetupHistoryTest, TheHistoryStaysWithinItsBudgetOldestStepsDroppedFirst) {
    // Straight to the history: the window's tree refresh would dominate the time.
    SetTimeSteps(1);
    CSimulationPeriodKiv* period = m_window->Document().GetPeriod();
    for (int i = 2; i <= 1000; ++i) {
        period->TimeStepCount(i);
        m_window->History().Record(period, kHintValueChanged, [] { return QStringLiteral("Number of time steps"); });
    }
    EXPECT_EQ(Stack()->count(), 1000);
    EXPECT_LE(m_window->History().MemoryBytes(), m_window->History().Budget());
    m_window->Undo();
    m_window->Undo();
    EXPECT_EQ(m_window->Document().GetPeriod()->TimeStepCount(), 998);

    // Count changes keep the whole text; a few fill a budget of three texts.
    const size_t whole = Text().size();
    m_window->History().SetBudget(3 * whole);
    std::vector<std::string> states;
    for (int i = 0; i < 6; ++i) {
        SetFractions(i % 2 ? "3" : "1");
        states.push_back(Text());
        ASSERT_LE(m_window->History().MemoryBytes(), m_window->History().Budget()) << i;
    }
    EXPECT_GE(Stack()->count(), 2);
    EXPECT_LE(Stack()->count(), 4);
    EXPECT_EQ(Stack()->undoText(), "Number of Fractions");
    EXPECT_TRUE(m_window->IsModified());
    // The newest steps undo exactly; the opened state is gone, so the setup stays modified.
    m_window->Undo();
    EXPECT_EQ(Text(), states[4]);
    while (Stack()->canUndo())
        m_window->Undo();
    EXPECT_EQ(Text(), states[5 - Stack()->count()]);
    EXPECT_TRUE(m_window->IsModified());
    m_window->Redo();
    EXPECT_EQ(Text(), states[6 - Stack()->count()]);
}
