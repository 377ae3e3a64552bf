// mudsetup-editor: the desktop editor of setups.
//   mudsetup-editor [FILE]
//   mudsetup-editor --screenshot OUT.png [--select PATH] FILE
#include "EditorWindow.h"
#include "PreferencesDialog.h"
#include "fileio/GuardedFile.h"

#include <QApplication>
#include <QBuffer>
#include <QIcon>
#include <QStyleFactory>
#include <QTimer>

#include <csignal>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

namespace {

const char* const kUsage =
    "usage: mudsetup-editor [FILE]\n"
    "       mudsetup-editor --screenshot OUT.png [--select PATH] FILE\n"
    "       mudsetup-editor --version\n"
    "\n"
    "Opens FILE (a new setup without one). With --screenshot the window is drawn without a\n"
    "display, with the node at PATH selected (as 'mudsetup validate' prints paths, e.g.\n"
    "MUD_TRANSPORT_MODULE/MODEL_DEFINITION or DOMAIN), saved as a PNG, and the editor exits.\n";

struct Options {
    std::string file;
    std::string screenshot;
    std::string select;
    bool platformGiven = false;
};

// Reads the editor's own options; Qt's options (-platform ...) are left to Qt.
bool ParseOptions(int argc, char** argv, Options& o, std::string& error) {
    for (int i = 1; i < argc; ++i) {
        const std::string a = argv[i];
        const bool hasValue = i + 1 < argc;
        if (a == "--screenshot" && hasValue) {
            o.screenshot = argv[++i];
        } else if (a == "--select" && hasValue) {
            o.select = argv[++i];
        } else if ((a == "-platform" || a == "--platform") && hasValue) {
            o.platformGiven = true;
            ++i;
        } else if (a == "--screenshot" || a == "--select") {
            error = a + " needs a value";
            return false;
        } else if (!a.empty() && a[0] == '-' && a != "-") {
            if (a.rfind("-style", 0) == 0 || a.rfind("--style", 0) == 0 || a == "-reverse")
                continue;  // Qt's own
            error = "unknown option '" + a + "'";
            return false;
        } else if (o.file.empty()) {
            o.file = a;
        } else {
            error = "more than one FILE";
            return false;
        }
    }
    if (!o.select.empty() && o.screenshot.empty()) {
        error = "--select goes with --screenshot";
        return false;
    }
    if (!o.screenshot.empty() && o.file.empty()) {
        error = "--screenshot needs a FILE";
        return false;
    }
    return true;
}

const char* const kNoDisplay =
    "mudsetup-editor: needs a display (neither DISPLAY nor WAYLAND_DISPLAY is set).\n"
    "Without one, --screenshot draws the editor into a PNG:\n"
    "  mudsetup-editor --screenshot OUT.png [--select PATH] FILE\n";

bool HasDisplay() {
#if defined(__APPLE__) || defined(_WIN32)
    return true;
#else
    return !qEnvironmentVariableIsEmpty("DISPLAY") || !qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
#endif
}

int TakeScreenshot(CEditorWindow& window, const Options& o) {
    window.SetPrompter([](const CEditorWindow::Prompt& p) {
        std::fprintf(stderr, "mudsetup-editor: %s\n", p.text.toStdString().c_str());
        return QMessageBox::Cancel;
    });
    if (!window.OpenFile(QString::fromStdString(o.file)))
        return 2;
    if (!o.select.empty() && !window.SelectPath(QString::fromStdString(o.select))) {
        std::fprintf(stderr, "mudsetup-editor: no section at '%s'\n", o.select.c_str());
        return 2;
    }
    window.resize(1280, 800);
    window.show();
    for (int i = 0; i < 5; ++i)
        QApplication::processEvents();
    // Encoded in memory, then written as every file is: only over a regular file, atomically.
    QByteArray png;
    QBuffer buffer(&png);
    buffer.open(QIODevice::WriteOnly);
    std::string error = "cannot write '" + o.screenshot + "'";
    if (!window.grab().toImage().save(&buffer, "PNG") ||
        !fileio::WriteFileAtomic(o.screenshot, std::string_view(png.constData(), static_cast<size_t>(png.size())),
                                 &error)) {
        std::fprintf(stderr, "mudsetup-editor: %s\n", error.c_str());
        return 2;
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    // Past a file-size limit a save then fails with a message instead of killing the editor.
    std::signal(SIGXFSZ, SIG_IGN);
    for (int i = 1; i < argc; ++i)
        if (!std::strcmp(argv[i], "--help") || !std::strcmp(argv[i], "-h")) {
            std::fputs(kUsage, stdout);
            return 0;
        } else if (!std::strcmp(argv[i], "--version")) {
            std::fputs("mudsetup-editor " MUDSETUP_VERSION "\n", stdout);
            return 0;
        }
    Options options;
    std::string error;
    if (!ParseOptions(argc, argv, options, error)) {
        std::fprintf(stderr, "mudsetup-editor: %s\n%s", error.c_str(), kUsage);
        return 2;
    }
    // Screenshots need no display unless a platform was chosen.
    const bool platformChosen = options.platformGiven || !qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM");
    if (!options.screenshot.empty() && !platformChosen)
        qputenv("QT_QPA_PLATFORM", "offscreen");
    // Without a display Qt would abort with a message about plug-ins; say what helps instead.
    if (options.screenshot.empty() && !platformChosen && !HasDisplay()) {
        std::fputs(kNoDisplay, stderr);
        return 2;
    }

    QApplication app(argc, argv);
    QApplication::setOrganizationName("mudsetup");
    QApplication::setApplicationName("mudsetup-editor");
    QApplication::setApplicationVersion(QStringLiteral(MUDSETUP_VERSION));
    // The installed icon and desktop entry, so that the desktop groups the windows under them.
    QApplication::setDesktopFileName(QStringLiteral("mudsetup-editor"));
    QApplication::setWindowIcon(QIcon::fromTheme(QStringLiteral("mudsetup-editor")));
    if (QStyle* fusion = QStyleFactory::create("Fusion"))
        QApplication::setStyle(fusion);
    CPreferencesDialog::LoadRemembered();

    CEditorWindow window;
    if (!options.screenshot.empty())
        return TakeScreenshot(window, options);
    window.RestoreLayout();
    if (!options.file.empty())
        window.OpenFile(QString::fromStdString(options.file));
    window.show();
    return app.exec();
}
