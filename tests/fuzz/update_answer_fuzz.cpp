// The update host's answers on any bytes: the text is valid UTF-8 in CR LF lines, a version is
// one version number, and a download link is one web address without blanks around it.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz_check.h"
#include "text/update_answer.h"
#include "text/utf.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    using namespace kickvane::text;
    const std::string_view input(reinterpret_cast<const char*>(data), size);

    const std::string text = ReadFetchedText(input);
    FUZZ_CHECK(IsValidUtf8(text));
    FUZZ_CHECK(text.empty() || text.ends_with("\r\n"));
    for (const std::string_view answer : {input, std::string_view(text)}) {
        if (const auto version = VersionFromAnswer(answer)) {
            FUZZ_CHECK(!version->empty() && version->size() <= kMaxVersionLength);
            for (const char c : *version) {
                FUZZ_CHECK((c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') ||
                           (c >= 'A' && c <= 'Z') || c == '.' || c == '-');
            }
            FUZZ_CHECK(VersionFromAnswer(*version) == version);
        }
    }

    for (const std::string_view answer : {input, std::string_view(text)}) {
        if (const auto link = DownloadLink(answer)) {
            std::string scheme = link->substr(0, link->find("://"));
            for (char& c : scheme) {
                c = (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c;
            }
            FUZZ_CHECK(scheme == "http" || scheme == "https");
            for (const char c : *link) {
                FUZZ_CHECK(static_cast<unsigned char>(c) >= 0x20 && c != 0x7F);
            }
            FUZZ_CHECK(link->front() != ' ' && link->back() != ' ');
            FUZZ_CHECK(DownloadLink(*link) == link);
        }
    }
    return 0;
}
