#pragma once

#include "platform/status.h"
#include "skin/surface.h"

namespace kickvane::skin {

// Finds the window under the mouse cursor: the innermost one, so over a child window the answer
// is the child, not its parent.
class PointerProbe {
public:
    virtual ~PointerProbe() = default;

    // Sets `window` to the window under the cursor, 0 when the cursor is over no window of ours.
    // Fails when the cursor position cannot be read.
    virtual Status windowAtCursor(WindowHandle& window) const = 0;
};

// Asks Qt: the cursor position and the deepest visible QWindow that contains it. A handle is the
// QWindow's winId(). Fails without a running QGuiApplication.
class QtPointerProbe final : public PointerProbe {
public:
    Status windowAtCursor(WindowHandle& window) const override;
};

}  // namespace kickvane::skin
