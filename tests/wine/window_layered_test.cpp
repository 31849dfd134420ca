// The window on Windows stays a layered window from translucent to opaque and back: Wine without a
// window manager draws another title bar for a window that stops being layered.
#include <windows.h>

#include "shell/window_fixture.h"

namespace kickvane::testing {
namespace {

bool IsLayered(QWidget& window) {
    const auto hwnd = reinterpret_cast<HWND>(window.winId());
    return (GetWindowLongPtrW(hwnd, GWL_EXSTYLE) & WS_EX_LAYERED) != 0;
}

using WindowLayeredTest = WindowFixture;

TEST_F(WindowLayeredTest, StaysLayeredAtFullOpacity) {
    auto window = Open();
    window->show();
    window->makeTranslucent(160);
    EXPECT_TRUE(IsLayered(*window));
    window->makeTranslucent(255);
    EXPECT_TRUE(IsLayered(*window));
    EXPECT_GT(window->windowOpacity(), 0.99);
    window->makeTranslucent(160);
    EXPECT_TRUE(IsLayered(*window));
}

}  // namespace
}  // namespace kickvane::testing
