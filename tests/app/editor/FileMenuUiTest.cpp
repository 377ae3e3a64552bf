// The File menu as a user meets it: keys, the recent setups told apart by their folders, and
// files that are not setups refused as such.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "fem/UnitUtil.h"

#include <QAction>
#include <QCoreApplication>
#include <QEvent>
#include <QDir>
#include <QFile>
#include <QMenu>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <memory>

namespace {

const QString kExample = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");

class FileMenu : public ::testing::Test {
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
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    QAction* Action(const QString& text) {
        for (QAction* a : m_window->findChildren<QAction*>())
            if (a->text() == text)
                return a;
        ADD_FAILURE() << "no action " << text.toStdString();
        return nullptr;
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
    std::vector<QString> m_prompts;
};

}  // namespace

TEST_F(FileMenu, SaveAsHasItsKeyWhateverTheDesktop) {
    QAction* saveAs = Action("Save &As...");
    ASSERT_TRUE(saveAs);
    EXPECT_EQ(saveAs->shortcut(), QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_S));
}

TEST_F(FileMenu, RecentSetupsOfTheSameNameAreToldApartByTheirFolders) {
    QDir root(m_dir.path());
    for (const char* folder : {"spring", "neap & spring"}) {
        ASSERT_TRUE(root.mkpath(folder));
        ASSERT_TRUE(QFile::copy(kExample, root.filePath(QString(folder) + "/estuary.setup")));
    }
    ASSERT_TRUE(m_window->OpenFile(root.filePath("spring/estuary.setup")));
    ASSERT_TRUE(m_window->OpenFile(root.filePath("neap & spring/estuary.setup")));
    QMenu* recent = nullptr;
    for (QMenu* m : m_window->findChildren<QMenu*>())
        if (m->title() == "Open &Recent")
            recent = m;
    ASSERT_TRUE(recent);
    QStringList texts;
    for (QAction* a : recent->actions())
        texts << a->text();
    // The latest first; an '&' of a folder is shown, not taken as a key.
    EXPECT_EQ(texts, (QStringList{
                         "&1 estuary.setup  (" + QDir::toNativeSeparators(root.filePath("neap && spring")) + ")",
                         "&2 estuary.setup  (" + QDir::toNativeSeparators(root.filePath("spring")) + ")"}));
}

TEST_F(FileMenu, AFileThatIsNoSetupIsRefusedAsSuch) {
    const struct {
        const char* name;
        QByteArray bytes;
        int line;
    } cases[] = {
        {"picture.png", QByteArray("\x89PNG\r\n\x1a\n\0\0\0\rIHDR", 16), 1},
        {"levels.qrd0", "# levels at the mouth\nqrd0 1\ntitle \"Levels\"\n", 2},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        const QString path = m_dir.filePath(c.name);
        QFile f(path);
        ASSERT_TRUE(f.open(QIODevice::WriteOnly));
        f.write(c.bytes);
        f.close();
        m_prompts.clear();
        EXPECT_FALSE(m_window->OpenFile(path));
        ASSERT_EQ(m_prompts.size(), 1u);
        EXPECT_TRUE(m_prompts[0].endsWith(
            QString("%1 is not a setup file: no section at line %2").arg(path).arg(c.line)))
            << m_prompts[0].toStdString();
    }
}
