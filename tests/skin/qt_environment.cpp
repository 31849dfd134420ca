// Text and the cursor need a QGuiApplication; one runs for all tests of the skin.
#include <QGuiApplication>

#include "support/qt_app.h"

[[maybe_unused]] static ::testing::Environment* const kQtEnvironment =
    ::testing::AddGlobalTestEnvironment(
        new kickvane::testing::QtAppEnvironment<QGuiApplication>("skin_tests"));
