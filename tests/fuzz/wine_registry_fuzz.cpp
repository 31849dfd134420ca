// Wine's registry reader on any bytes: it ends, keeps only values under the keys asked for, and
// finds the same architecture as the header reader.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz_check.h"
#include "game/formats/wine_registry.h"
#include "platform/text.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    const std::string wanted = "Software\\";
    const kickvane::game::RegistryFile file = kickvane::game::ParseWineRegistry(input, {wanted});
    if (!file.problem.empty()) {
        FUZZ_CHECK(file.values.empty());
        return 0;
    }
    FUZZ_CHECK(file.arch == kickvane::game::RegistryArch(input));
    for (const kickvane::game::RegistryValue& value : file.values) {
        FUZZ_CHECK(
            value.key.size() >= wanted.size() &&
            kickvane::platform::NamesEqualIgnoringCase(value.key.substr(0, wanted.size()), wanted));
    }
    return 0;
}
