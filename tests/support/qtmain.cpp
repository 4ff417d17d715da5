#include <gtest/gtest.h>

#include "ui/application.h"

// Test programs with windows: the program's own application, so that fonts and style are the ones users see.
int main(int argc, char** argv) {
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    testing::InitGoogleTest(&argc, argv);
    QCoreApplication::setAttribute(Qt::AA_DontUseNativeDialogs);  // no test can press the keys of the system's own
    const kdx::Application application(argc, argv);
    return RUN_ALL_TESTS();
}
