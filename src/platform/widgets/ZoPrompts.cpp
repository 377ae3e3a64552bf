#include "ZoPrompts.h"

#include <QApplication>
#include <QFileDialog>
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
}  // namespace

void ZoShowMessage(QWidget* where, const QString& text) {
    if (Sink())
        Sink()(where, text);
    else
        DefaultMessage(where, text);
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
                          const QString& filter) {
    if (FileHook())
        return FileHook()(parent, caption, startPath, filter);
    return QFileDialog::getSaveFileName(parent, caption, startPath, filter);
}

ZoOpenFileHook ZoSetOpenFileHook(ZoOpenFileHook hook) {
    ZoOpenFileHook previous = std::move(FileHook());
    FileHook() = std::move(hook);
    return previous;
}
