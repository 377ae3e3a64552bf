// What names the editor and its file to the desktop: the window title and --version.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "fem/SimulationPeriodKiv.h"
#include "fem/UnitUtil.h"

#include <QCoreApplication>
#include <QProcess>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <memory>

namespace {

const QString kExample = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");
const QString kSuffix = QStringLiteral("[*] - Mud Transport Setup Editor " MUDSETUP_VERSION_TEXT);

class EditorTitleTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, m_dir.filePath("settings"));
        EditorSettings().clear();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([](const CEditorWindow::Prompt&) { return QMessageBox::Discard; });
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        CUnitUtil::ResetUserUnits();
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
};

}  // namespace

TEST_F(EditorTitleTest, TitleNamesTheFileTheVersionAndTheModifiedMark) {
    EXPECT_EQ(m_window->windowTitle(), "Untitled" + kSuffix);
    ASSERT_TRUE(m_window->OpenFile(kExample));
    EXPECT_EQ(m_window->windowTitle(), "estuary.setup" + kSuffix);
    EXPECT_FALSE(m_window->isWindowModified());

    m_window->Document().GetPeriod()->TimeStepCount(10);
    m_window->UpdateDoc(nullptr, kHintValueChanged);
    EXPECT_TRUE(m_window->isWindowModified());
    m_window->Undo();
    EXPECT_FALSE(m_window->isWindowModified());

    m_window->NewSetup(2, 3);
    EXPECT_EQ(m_window->windowTitle(), "Untitled" + kSuffix);
    EXPECT_FALSE(m_window->isWindowModified());
}

#ifdef MUDSETUP_EDITOR_EXE
// --version and --help answer before the editor looks for a display.
TEST_F(EditorTitleTest, VersionAndHelpNeedNoDisplay) {
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    for (const char* name : {"QT_QPA_PLATFORM", "DISPLAY", "WAYLAND_DISPLAY"})
        env.remove(name);
    const struct {
        QString option;
        QString out;
    } cases[] = {
        {"--version", "mudsetup-editor " MUDSETUP_VERSION_TEXT "\n"},
        {"--help", "usage: mudsetup-editor [FILE]\n"},
    };
    for (const auto& c : cases) {
        QProcess p;
        p.setProcessEnvironment(env);
        p.start(MUDSETUP_EDITOR_EXE, {c.option});
        ASSERT_TRUE(p.waitForFinished(60000)) << c.option.toStdString();
        EXPECT_EQ(p.exitStatus(), QProcess::NormalExit);
        EXPECT_EQ(p.exitCode(), 0) << c.option.toStdString();
        EXPECT_TRUE(QString::fromUtf8(p.readAllStandardOutput()).startsWith(c.out)) << c.option.toStdString();
    }
}
#endif
