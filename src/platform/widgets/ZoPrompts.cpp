#include "ZoPrompts.h"

#include "ZoSEDlgBase.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QApplication>
#include <QComboBox>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QFileDialog>
#include <QFileInfo>
#include <QMessageBox>
#include <QMetaObject>
#include <QPointer>

namespace {
ZoMessageSink& Sink() {
    static ZoMessageSink sink;
    return sink;
}
ZoOpenFileHook& FileHook() {
    static ZoOpenFileHook hook;
    return hook;
}

void DefaultMessage(QWidget* where, const QString& text) {
    QPointer<QWidget> parent = where ? where->window() : nullptr;
    QMetaObject::invokeMethod(
        qApp,
        [parent, text] {
            QMessageBox::warning(parent, QApplication::applicationDisplayName(), text);
        },
        Qt::QueuedConnection);
}

QPointer<QWidget>& JustRefused() {
    static QPointer<QWidget> widget;
    return widget;
}

QString Clean(QString text) {
    text.remove('&');
    text = text.trimmed();
    while (text.endsWith(':'))
        text.chop(1);
    return text;
}

// The label of the widget in a layout: a form row's label, or a label left of it in a grid.
QString LayoutLabel(const QLayout* layout, const QWidget* field) {
    if (!layout)
        return {};
    if (const auto* form = qobject_cast<const QFormLayout*>(layout)) {
        if (auto* label = qobject_cast<QLabel*>(form->labelForField(const_cast<QWidget*>(field))))
            return Clean(label->text());
    }
    if (const auto* grid = qobject_cast<const QGridLayout*>(layout)) {
        const int index = grid->indexOf(const_cast<QWidget*>(field));
        if (index >= 0) {
            int row = 0, col = 0, rowSpan = 0, colSpan = 0;
            grid->getItemPosition(index, &row, &col, &rowSpan, &colSpan);
            for (int c = col - 1; c >= 0; --c)
                if (QLayoutItem* item = grid->itemAtPosition(row, c))
                    if (auto* label = qobject_cast<QLabel*>(item->widget()))
                        if (!Clean(label->text()).isEmpty())
                            return Clean(label->text());
        }
    }
    for (int i = 0; i < layout->count(); ++i)
        if (const QLayout* inner = layout->itemAt(i)->layout()) {
            const QString text = LayoutLabel(inner, field);
            if (!text.isEmpty())
                return text;
        }
    return {};
}

}  // namespace

QString ZoFieldLabel(const QWidget* field) {
    if (!field)
        return {};
    if (auto* box = qobject_cast<const QAbstractSpinBox*>(field->parentWidget()))
        field = box;
    else if (auto* combo = qobject_cast<const QComboBox*>(field->parentWidget()))
        field = combo;
    if (const auto* button = qobject_cast<const QAbstractButton*>(field); button && !button->text().isEmpty())
        return Clean(button->text());
    if (QWidget* window = field->window())
        for (const QLabel* label : window->findChildren<QLabel*>())
            if (label->buddy() == field && !Clean(label->text()).isEmpty())
                return Clean(label->text());
    if (const QWidget* parent = field->parentWidget()) {
        const QString text = LayoutLabel(parent->layout(), field);
        if (!text.isEmpty())
            return text;
    }
    for (const QWidget* w = field->parentWidget(); w; w = w->parentWidget()) {
        if (const auto* group = qobject_cast<const QGroupBox*>(w); group && !group->title().isEmpty())
            return Clean(group->title());
        if (qobject_cast<const CZoSEDlgBase*>(w))
            break;
    }
    return {};
}

QString ZoInputContext(const QWidget* where) {
    QString field;
    const CZoSEDlgBase* form = nullptr;
    for (const QWidget* w = where; w && !form; w = w->parentWidget()) {
        form = qobject_cast<const CZoSEDlgBase*>(w);
        // A grid names its column; the row's item is the section.
        if (const auto* view = qobject_cast<const QAbstractItemView*>(w); view && field.isEmpty()) {
            const QModelIndex current = view->currentIndex();
            if (current.isValid() && view->model())
                field = Clean(view->model()->headerData(current.column(), Qt::Horizontal).toString());
        }
    }
    if (field.isEmpty())
        field = ZoFieldLabel(where);
    QString section;
    if (form && form->GetSection())
        section = QString::fromStdString(form->GetSection()->GetTitle());
    if (field.isEmpty())
        return section;
    return section.isEmpty() || section == field ? field : QStringLiteral("%1 (%2)").arg(field, section);
}

QWidget* ZoJustRefused() { return JustRefused().data(); }

void ZoShowMessage(QWidget* where, const QString& text) {
    const QString context = ZoInputContext(where);
    const QString full = context.isEmpty() ? text : QStringLiteral("%1: %2").arg(context, text);
    if (!JustRefused()) {
        // Cleared when the current event is done.
        QMetaObject::invokeMethod(qApp, [] { JustRefused() = nullptr; }, Qt::QueuedConnection);
    }
    JustRefused() = where;
    if (Sink())
        Sink()(where, full);
    else
        DefaultMessage(where, full);
}

ZoMessageSink ZoSetMessageSink(ZoMessageSink sink) {
    ZoMessageSink previous = std::move(Sink());
    Sink() = std::move(sink);
    return previous;
}

QString ZoGetOpenFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter) {
    if (FileHook())
        return FileHook()(parent, caption, startPath, filter);
    return QFileDialog::getOpenFileName(parent, caption, startPath, filter);
}

QString ZoGetSaveFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter, const QString& defaultExt) {
    QString chosen = FileHook() ? FileHook()(parent, caption, startPath, filter)
                                : QFileDialog::getSaveFileName(parent, caption, startPath, filter);
    if (!chosen.isEmpty() && !defaultExt.isEmpty() && QFileInfo(chosen).suffix().isEmpty())
        chosen += '.' + defaultExt;
    return chosen;
}

ZoOpenFileHook ZoSetOpenFileHook(ZoOpenFileHook hook) {
    ZoOpenFileHook previous = std::move(FileHook());
    FileHook() = std::move(hook);
    return previous;
}
