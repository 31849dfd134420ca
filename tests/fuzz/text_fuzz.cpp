// The VNI converter and the text decoders on any bytes: their output is always valid UTF-8.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz_check.h"
#include "text/utf.h"
#include "text/vni.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    using namespace kickvane::text;
    const std::string_view input(reinterpret_cast<const char*>(data), size);

    const std::string legacy = LegacyTextToUtf8(input);
    FUZZ_CHECK(IsValidUtf8(legacy));
    if (IsValidUtf8(input)) {
        FUZZ_CHECK(legacy == input);
        FUZZ_CHECK(Utf16ToUtf8(Utf8ToUtf16(input)) == input);
    }
    FUZZ_CHECK(IsValidUtf8(Utf16ToUtf8(Utf8ToUtf16(input))));

    // The input's bytes taken as UTF-16 units, unpaired surrogates included.
    std::u16string units(size / 2, u'\0');
    for (size_t i = 0; i < units.size(); ++i) {
        units[i] = static_cast<char16_t>(data[2 * i] | data[2 * i + 1] << 8);
    }
    FUZZ_CHECK(IsValidUtf8(Utf16ToUtf8(units)));
    (void)VniToUnicode(units);

    FUZZ_CHECK(IsValidUtf8(VniToUnicodeUtf8(input)));
    FUZZ_CHECK(IsValidUtf8(VniToUnicodeUtf8(legacy)));
    return 0;
}
