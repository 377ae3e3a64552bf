// Messages and file choosers of the dialogs go through replaceable hooks, so that tests can
// observe them without a modal window.
#pragma once

#include <QString>

#include <functional>

class QWidget;

// Shows a message about the widget's input (a refused value, for example). By default a
// warning box, posted to the event loop so that it never runs inside a focus change.
void ZoShowMessage(QWidget* where, const QString& text);

using ZoMessageSink = std::function<void(QWidget* where, const QString& text)>;
// Replaces the sink; an empty function restores the default. Returns the previous sink.
ZoMessageSink ZoSetMessageSink(ZoMessageSink sink);

// Asks the user for an existing file; an empty result means cancelled.
QString ZoGetOpenFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter);

// Asks the user for a file to write (it need not exist); the same hook answers it.
QString ZoGetSaveFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter);

using ZoOpenFileHook = std::function<QString(QWidget* parent, const QString& caption,
                                             const QString& startPath, const QString& filter)>;
// Replaces the file chooser; an empty function restores QFileDialog. Returns the previous.
ZoOpenFileHook ZoSetOpenFileHook(ZoOpenFileHook hook);
