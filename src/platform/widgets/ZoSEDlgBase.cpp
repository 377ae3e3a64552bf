#include "ZoSEDlgBase.h"

#include "ZoNumberEdit.h"
#include "ZoWheelGuard.h"

#include <QAbstractItemDelegate>
#include <QKeyEvent>
#include <QKeySequence>
#include <QLineEdit>

#include <map>
#include <string>

namespace {
std::map<std::string, DialogFactory>& Factories() {
    static std::map<std::string, DialogFactory> factories;
    return factories;
}
QWidget*& EditSource() {
    static QWidget* source = nullptr;
    return source;
}
}  // namespace

QWidget* ZoEditSource() { return EditSource(); }

ZoEditSourceScope::ZoEditSourceScope(QWidget* field) : m_previous(EditSource()) {
    EditSource() = field;
}

ZoEditSourceScope::~ZoEditSourceScope() { EditSource() = m_previous; }

bool RegisterDialogClass(const char* className, DialogFactory factory) {
    Factories()[className] = std::move(factory);
    return true;
}

CZoSEDlgBase* CreateDialogFromClass(const char* className) {
    if (!className)
        return nullptr;
    auto it = Factories().find(className);
    return it == Factories().end() ? nullptr : it->second();
}

bool IsDialogClassRegistered(const char* className) {
    return className && Factories().count(className) > 0;
}

CZoSEDlgBase::CZoSEDlgBase(QWidget* parent) : QWidget(parent) { ZoInstallWheelGuard(); }

void CZoSEDlgBase::keyPressEvent(QKeyEvent* event) {
    // F1 reaches the innermost dialog around the focus (a page inside a sheet), never two.
    if (event->matches(QKeySequence::HelpContents)) {
        event->accept();
        ShowHelp();
        return;
    }
    QWidget::keyPressEvent(event);
}

CZoSEDlgBase::~CZoSEDlgBase() {
    // A visible window closes, and a field being edited loses the focus, only after this:
    // what the field would store then must not reach back into a dialog that is gone.
    for (QLineEdit* edit : findChildren<QLineEdit*>())
        QObject::disconnect(edit, &QLineEdit::editingFinished, nullptr, nullptr);
    for (QAbstractItemDelegate* delegate : findChildren<QAbstractItemDelegate*>())
        QObject::disconnect(delegate, &QAbstractItemDelegate::commitData, nullptr, nullptr);
}

void CZoSEDlgBase::Attach(CZoSEKivBase* node, CDialogHost* host) {
    m_node = node;
    m_host = host;
}

void CZoSEDlgBase::Initialize() { SetData(); }

void CZoSEDlgBase::SetData() { RefreshFields(); }

void CZoSEDlgBase::RefreshFields() {
    for (CZoNumberEdit* field : findChildren<CZoNumberEdit*>())
        if (field->IsBound())
            field->Refresh();
}

void CZoSEDlgBase::SelectTreeItem(CZoSEKivBase* node) {
    if (m_host && node)
        m_host->SelectTreeItem(node);
}

CString CZoSEDlgBase::AbsoluteFilePath(const CString& path) const {
    return m_host ? m_host->AbsoluteFilePath(path) : path;
}

void CZoSEDlgBase::UpdateDoc(int hint) {
    if (m_node)
        m_node->SetHasBeenTouched(true);
    if (m_host)
        m_host->UpdateDoc(this, hint);
}

void CZoSEDlgBase::ShowHelp() {
    if (m_host)
        m_host->ShowHelp(CurrentHelpID());
}

void CZoSEDlgBase::AddAlignRight(QWidget*) {}

void CZoSEDlgBase::HideCaption(int) {}
