// Messages and file choosers of the dialogs go through replaceable hooks, so that tests can
// observe them without a modal window.
#pragma once

#include <QString>

#include <functional>

class QWidget;

// Shows a message about the widget's input (a refused value, for example). By default a
// warning box, posted to the event loop so that it never runs inside a focus change. The
// text is led by the field and the section it belongs to ("Number of Fractions (Model
// definition): ..."), where they are known.
void ZoShowMessage(QWidget* where, const QString& text);

// The name a user knows a field by: its label (a buddy label, the label of its form row or
// the label left of it in a grid layout), a button's own text, or its group box's title;
// empty when there is none. A spin box's or a combo box's inner line edit counts as the box.
QString ZoFieldLabel(const QWidget* field);
// The field and the section of a widget as they lead a message; empty when neither is known.
QString ZoInputContext(const QWidget* where);

// The widget of a message shown while the current event is handled, null once control is
// back in the event loop: a refused value that a click elsewhere made the field store.
QWidget* ZoJustRefused();

using ZoMessageSink = std::function<void(QWidget* where, const QString& text)>;
// Replaces the sink; an empty function restores the default. Returns the previous sink.
ZoMessageSink ZoSetMessageSink(ZoMessageSink sink);

// Asks the user for an existing file; an empty result means cancelled.
QString ZoGetOpenFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter);

// Asks the user for a file to write (it need not exist); the same hook answers it. A name
// chosen without an extension gets defaultExt (without the dot), where one is given.
QString ZoGetSaveFileName(QWidget* parent, const QString& caption, const QString& startPath,
                          const QString& filter, const QString& defaultExt = QString());

using ZoOpenFileHook = std::function<QString(QWidget* parent, const QString& caption,
                                             const QString& startPath, const QString& filter)>;
// Replaces the file chooser; an empty function restores QFileDialog. Returns the previous.
ZoOpenFileHook ZoSetOpenFileHook(ZoOpenFileHook hook);
