#pragma once

#include <QSettings>

// Where the editor remembers the user's choices (units, recent files, window layout).
inline QSettings EditorSettings() { return QSettings(QStringLiteral("mudsetup"), QStringLiteral("mudsetup-editor")); }
