// The main of the UI tests: one QApplication for all of them, no display needed.
#include "support/PrivateTempDir.h"
#include "widgets/ZoPrompts.h"

#include <QApplication>

#include <gtest/gtest.h>

int main(int argc, char** argv) {
    testsupport::PrivateTempDir temp;
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    ::testing::InitGoogleTest(&argc, argv);
    // A message box or file dialog would wait for a user who is not there.
    ZoSetMessageSink([](QWidget*, const QString& text) {
        ADD_FAILURE() << "unexpected message: " << text.toStdString();
    });
    ZoSetOpenFileHook([](QWidget*, const QString&, const QString&, const QString&) {
        ADD_FAILURE() << "unexpected file chooser";
        return QString();
    });
    return RUN_ALL_TESTS();
}
