// The window's code is part of the program.
#include "window_entry.h"

namespace kickvane::app {

std::optional<WindowEntry> FindWindowEntry(std::string&) {
    return WindowEntry{&kickvane_open_window, &kickvane_draw_skin_gallery};
}

}  // namespace kickvane::app
