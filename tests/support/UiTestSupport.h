// Helpers for tests that drive dialogs and grids the way a user does, without a display.
//
//   CSetupDocument doc;
//   uitest::CRecordingHost host;
//   auto dlg = uitest::OpenDialog(uitest::FindNode(doc.Module(), {"MODEL_DEFINITION"}), host);
//   uitest::Type(uitest::Child<QLineEdit>(dlg.get(), "fractions"), "5");
//   EXPECT_EQ(host.hints, (std::vector<int>{2}));
//
// Messages to the user and file choosers never open a window in these tests: an unexpected
// one fails the test; a MessageRecorder or FileChooserStub takes them over where expected.
#pragma once

#include "widgets/ZoPrompts.h"
#include "widgets/ZoSEDlgBase.h"

#include <QComboBox>
#include <QLineEdit>
#include <QSize>
#include <QString>

#include <gtest/gtest.h>

#include <initializer_list>
#include <ostream>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace uitest {

// Stands in for the editor: records what dialogs tell it and, like the editor, refreshes the
// dialog (SetData) after every UpdateDoc.
class CRecordingHost : public CDialogHost {
public:
    std::vector<int> hints;                // every UpdateDoc hint, in order
    std::vector<CZoSEKivBase*> selected;   // nodes asked for with SelectTreeItem
    std::vector<unsigned long> helpIds;    // topics asked for with ShowHelp
    bool refreshOnUpdate = true;
    std::string setupDir = "/setups";      // relative paths are made absolute against it

    void Clear();

    void UpdateDoc(CZoSEDlgBase* dialog, int hint) override;
    void SelectTreeItem(CZoSEKivBase* node) override;
    void ShowHelp(unsigned long helpId) override;
    CString AbsoluteFilePath(const CString& path) override;
};

// Creates the dialog the node names (GetDlgRuntimeClass(2555)), attaches it to the node and
// host, initialises and shows it. Null, with a test failure, when there is none.
std::unique_ptr<CZoSEDlgBase> OpenDialog(CZoSEKivBase* node, CRecordingHost& host,
                                         QSize size = QSize(640, 480));

// The node reached by section names from node downwards (items by their expanded names).
CZoSEKivBase* FindNode(CZoSEKivBase* node, std::initializer_list<std::string_view> sections);

template <class T>
T* FindNodeAs(CZoSEKivBase* node, std::initializer_list<std::string_view> sections) {
    T* found = dynamic_cast<T*>(FindNode(node, sections));
    EXPECT_NE(found, nullptr);
    return found;
}

// A child widget by object name; fails the test when it is missing.
template <class W>
W* Child(QObject* parent, const char* name) {
    W* w = parent->findChild<W*>(name);
    EXPECT_NE(w, nullptr) << "no widget named " << name;
    return w;
}

// Replaces a field's text key by key, as typed over a selection (textEdited per key).
void Type(QLineEdit* field, const QString& text);
// Type, then Return (editingFinished).
void Enter(QLineEdit* field, const QString& text);
// Picks an entry of a drop-down list with the arrow keys (activated per step).
void Choose(QComboBox* box, const QString& entry);

// Takes the messages shown to the user while it lives.
class MessageRecorder {
public:
    MessageRecorder();
    ~MessageRecorder();
    MessageRecorder(const MessageRecorder&) = delete;
    MessageRecorder& operator=(const MessageRecorder&) = delete;
    const std::vector<QString>& Messages() const { return m_messages; }

private:
    std::vector<QString> m_messages;
    ZoMessageSink m_previous;
};

// Answers the file chooser with a fixed path while it lives.
class FileChooserStub {
public:
    explicit FileChooserStub(QString answer);
    ~FileChooserStub();
    FileChooserStub(const FileChooserStub&) = delete;
    FileChooserStub& operator=(const FileChooserStub&) = delete;
    int Calls() const { return m_calls; }
    const QString& LastStartPath() const { return m_lastStart; }

private:
    QString m_answer;
    int m_calls = 0;
    QString m_lastStart;
    ZoOpenFileHook m_previous;
};

}  // namespace uitest

// Readable QStrings in test failures.
inline void PrintTo(const QString& text, std::ostream* os) { *os << '"' << text.toStdString() << '"'; }
