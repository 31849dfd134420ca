// The desktop entry reader on any bytes: it ends, and a value it gives is one line of the text.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz_check.h"
#include "game/formats/desktop_entry.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    for (const std::string_view key : {"Exec", "Name"}) {
        const std::string value = kickvane::game::DesktopEntryValue(input, key);
        FUZZ_CHECK(value.find('\n') == std::string::npos);
        FUZZ_CHECK(value.empty() || input.find(value) != std::string_view::npos);
    }
    return 0;
}
