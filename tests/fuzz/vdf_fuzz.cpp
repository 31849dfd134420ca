// Valve's KeyValues reader on any bytes: it ends, a refused text gives no values, and a text it
// reads reads the same with blank lines and a comment after it.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz_check.h"
#include "game/formats/vdf.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    const kickvane::game::Parsed parsed = kickvane::game::ParseVdf(input);
    if (!parsed.ok()) {
        FUZZ_CHECK(parsed.values.entries().empty());
        return 0;
    }
    const kickvane::game::Parsed again =
        kickvane::game::ParseVdf(std::string(input) + "\n\n// written by hand\n");
    FUZZ_CHECK(again.ok());
    FUZZ_CHECK(again.values.entries() == parsed.values.entries());
    return 0;
}
