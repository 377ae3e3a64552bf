#include "UiTestSupport.h"

#include <QTest>

namespace uitest {

void CRecordingHost::Clear() {
    hints.clear();
    selected.clear();
    helpIds.clear();
}

void CRecordingHost::UpdateDoc(CZoSEDlgBase* dialog, int hint) {
    hints.push_back(hint);
    if (refreshOnUpdate && dialog)
        dialog->SetData();
}

void CRecordingHost::SelectTreeItem(CZoSEKivBase* node) { selected.push_back(node); }

void CRecordingHost::ShowHelp(unsigned long helpId) { helpIds.push_back(helpId); }

CString CRecordingHost::AbsoluteFilePath(const CString& path) {
    if (path.empty() || path[0] == '/')
        return path;
    return setupDir + "/" + path;
}

std::unique_ptr<CZoSEDlgBase> OpenDialog(CZoSEKivBase* node, CRecordingHost& host, QSize size) {
    EXPECT_NE(node, nullptr);
    if (!node)
        return nullptr;
    const char* name = node->GetDlgRuntimeClass(kDlgRuntimeClassRequest);
    EXPECT_NE(name, nullptr) << NodePath(node) << " names no dialog";
    std::unique_ptr<CZoSEDlgBase> dialog(CreateDialogFromClass(name));
    EXPECT_NE(dialog, nullptr) << (name ? name : "") << " is not registered";
    if (!dialog)
        return nullptr;
    dialog->Attach(node, &host);
    dialog->Initialize();
    dialog->resize(size);
    dialog->show();
    EXPECT_TRUE(QTest::qWaitForWindowExposed(dialog.get()));
    return dialog;
}

CZoSEKivBase* FindNode(CZoSEKivBase* node, std::initializer_list<std::string_view> sections) {
    for (std::string_view name : sections) {
        CZoSEKivBase* next = nullptr;
        POSITION pos = 0;
        for (CZoSEKivBase* c = node ? node->GetFirstChild(pos) : nullptr; c && !next;
             c = node->GetNextChild(pos))
            if (c->GetSectionName() == name)
                next = c;
        node = next;
    }
    return node;
}

void Type(QLineEdit* field, const QString& text) {
    ASSERT_NE(field, nullptr);
    QTest::keyClick(field, Qt::Key_A, Qt::ControlModifier);
    if (text.isEmpty())
        QTest::keyClick(field, Qt::Key_Delete);
    else
        QTest::keyClicks(field, text);
}

void Enter(QLineEdit* field, const QString& text) {
    Type(field, text);
    QTest::keyClick(field, Qt::Key_Return);
}

void Choose(QComboBox* box, const QString& entry) {
    ASSERT_NE(box, nullptr);
    const int target = box->findText(entry);
    ASSERT_GE(target, 0) << entry.toStdString();
    for (int guard = 0; box->currentIndex() != target && guard < box->count() + 1; ++guard)
        QTest::keyClick(box, box->currentIndex() < target ? Qt::Key_Down : Qt::Key_Up);
    EXPECT_EQ(box->currentIndex(), target);
}

MessageRecorder::MessageRecorder()
    : m_previous(ZoSetMessageSink(
          [this](QWidget*, const QString& text) { m_messages.push_back(text); })) {}

MessageRecorder::~MessageRecorder() { ZoSetMessageSink(std::move(m_previous)); }

FileChooserStub::FileChooserStub(QString answer)
    : m_answer(std::move(answer)),
      m_previous(ZoSetOpenFileHook([this](QWidget*, const QString&, const QString& start,
                                          const QString&) {
          ++m_calls;
          m_lastStart = start;
          return m_answer;
      })) {}

FileChooserStub::~FileChooserStub() { ZoSetOpenFileHook(std::move(m_previous)); }

}  // namespace uitest
