// The settings reader and writer on any bytes: parsing never fails badly, every key of the
// catalog reads, a value that was set reads back, and what is written parses to itself.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "catalog/catalog.h"
#include "catalog/ini.h"
#include "catalog/settings.h"
#include "fuzz_check.h"
#include "text/utf.h"

namespace {

using kickvane::catalog::IniDocument;

// A value that the file keeps exactly as given: one line, valid UTF-8, without surrounding
// blanks or quotes.
bool KeptExactly(std::string_view value) {
    if (!kickvane::text::IsValidUtf8(value) ||
        value.find_first_of(std::string_view("\r\n\0", 3)) != std::string_view::npos) {
        return false;
    }
    if (!value.empty() && (value.front() == ' ' || value.front() == '\t' || value.back() == ' ' ||
                           value.back() == '\t')) {
        return false;
    }
    return value.size() < 2 ||
           !((value.front() == '"' || value.front() == '\'') && value.back() == value.front());
}

void ReadEveryKey(const IniDocument& document) {
    (void)document.Get("Thiet lap", "DuongDan");
    (void)document.Get("Thiet lap", "PhimTat");
    for (const auto& category : kickvane::catalog::Categories()) {
        if (auto value = document.Get(kickvane::catalog::kCategorySection, category.key)) {
            (void)kickvane::catalog::ParseWholeNumber(*value);
        }
    }
    for (const auto& group : kickvane::catalog::Groups()) {
        for (const auto& option : group.options) {
            if (auto value = document.Get(group.section, option.key)) {
                (void)kickvane::catalog::ParseTruthValue(*value);
            }
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    // The first bytes name a section, a key and a value to set; the rest is the file.
    const size_t first = input.find('\x01');
    const size_t second = first == std::string_view::npos ? first : input.find('\x01', first + 1);
    const size_t third = second == std::string_view::npos ? second : input.find('\x01', second + 1);
    std::string_view file = input;
    std::string_view section = "Thiet lap";
    std::string_view key = "DuongDan";
    std::string_view value = "C:\\Games";
    if (third != std::string_view::npos) {
        section = input.substr(0, first);
        key = input.substr(first + 1, second - first - 1);
        value = input.substr(second + 1, third - second - 1);
        file = input.substr(third + 1);
    }

    std::optional<IniDocument> document = IniDocument::Parse(file);
    if (!document) {
        return 0;
    }
    ReadEveryKey(*document);
    const std::string written = document->Serialize();
    const std::optional<IniDocument> reparsed = IniDocument::Parse(written);
    FUZZ_CHECK(reparsed && reparsed->Serialize() == written);

    if (document->Set(section, key, value).ok()) {
        if (KeptExactly(value)) {
            FUZZ_CHECK(document->Get(section, key) == std::string(value));
        }
        const std::string saved = document->Serialize();
        const std::optional<IniDocument> reloaded = IniDocument::Parse(saved);
        FUZZ_CHECK(reloaded && reloaded->Serialize() == saved);
        FUZZ_CHECK(reloaded->Get(section, key) == document->Get(section, key));
        ReadEveryKey(*reloaded);
    }
    return 0;
}
