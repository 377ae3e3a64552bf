// The editor's Save does not silently replace a setup another program saved meanwhile.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "host/SetupDocument.h"

#include <QFile>
#include <QSettings>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <cstdio>
#include <memory>

namespace {

QByteArray Slurp(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

// Another program's save: a new file renamed over the old one.
void SaveAsAnotherProgram(const QString& path, const QByteArray& text) {
    QFile f(path + ".theirs");
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    f.write(text);
    f.close();
    ASSERT_EQ(std::rename((path + ".theirs").toLocal8Bit().constData(), path.toLocal8Bit().constData()), 0);
}

class EditorFileGuard : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, m_dir.filePath("settings"));
        EditorSettings().clear();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([this](const CEditorWindow::Prompt& p) {
            m_prompts.push_back(p.text);
            return m_answer;
        });
    }
    QString Write(const QString& name, const QByteArray& text) {
        QFile f(m_dir.filePath(name));
        f.open(QIODevice::WriteOnly);
        f.write(text);
        return f.fileName();
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
    std::vector<QString> m_prompts;
    QMessageBox::StandardButton m_answer = QMessageBox::Cancel;
};

}  // namespace

TEST_F(EditorFileGuard, SaveAsksBeforeReplacingAFileChangedOnDisk) {
    const QString path = Write("a.setup", "MUD_TRANSPORT_MODULE {\n    mode = 2\n}\n");
    ASSERT_TRUE(m_window->OpenFile(path));
    const QByteArray theirs = "MUD_TRANSPORT_MODULE {\n    mode = 1\n}\n";
    SaveAsAnotherProgram(path, theirs);

    m_prompts.clear();
    EXPECT_FALSE(m_window->SaveFile(path));
    ASSERT_EQ(m_prompts.size(), 1u);
    EXPECT_TRUE(m_prompts[0].contains("was changed by another program")) << m_prompts[0].toStdString();
    EXPECT_EQ(Slurp(path), theirs);

    m_answer = QMessageBox::Save;
    EXPECT_TRUE(m_window->SaveFile(path));
    EXPECT_EQ(Slurp(path).toStdString(), m_window->Document().ToText());
    // Its own save is the file it knows now: the next save asks nothing.
    m_prompts.clear();
    EXPECT_TRUE(m_window->SaveFile(path));
    EXPECT_TRUE(m_prompts.empty());
}
