#pragma once

#include <optional>

#include "skin/surface.h"

namespace kickvane::skin {

// Finds the window under the mouse cursor: the innermost one, so over a child window the answer
// is the child, not its parent.
class PointerProbe {
public:
    virtual ~PointerProbe() = default;

    // The window under the cursor, 0 when the cursor is over no window of ours; nullopt when the
    // cursor position cannot be read.
    virtual std::optional<WindowHandle> windowAtCursor() const = 0;
};

// Asks Qt: the cursor position and the deepest visible QWindow that contains it. A handle is the
// QWindow's winId(). Without a running QGuiApplication the cursor cannot be read.
class QtPointerProbe final : public PointerProbe {
public:
    std::optional<WindowHandle> windowAtCursor() const override;
};

}  // namespace kickvane::skin
