// Widgets need a QApplication; one runs for all tests of the window.
#include <QApplication>

#include "support/qt_app.h"

[[maybe_unused]] static ::testing::Environment* const kQtApplication =
    ::testing::AddGlobalTestEnvironment(
        new kickvane::testing::QtAppEnvironment<QApplication>("shell_tests"));
