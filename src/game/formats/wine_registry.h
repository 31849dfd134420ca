#pragma once

#include <string>
#include <string_view>
#include <vector>

// Wine's registry files (system.reg, user.reg: "WINE REGISTRY Version 2").
namespace kickvane::game {

// One string value: the key is as written between the brackets, with single backslashes
// ("Software\Microsoft\..."), and the value is decoded to UTF-8.
struct RegistryValue {
    std::string key;
    std::string name;
    std::string value;
};

struct RegistryFile {
    std::vector<RegistryValue> values;
    std::string arch;     // "win32" or "win64" when the file records it ("#arch=win64")
    std::string problem;  // empty when the file was read
};

// The architecture that the file's header records ("#arch=win64", before the first key); empty
// when it records none. Reading the start of the file is enough.
std::string RegistryArch(std::string_view text);

// Reads the string values (plain and str(2)) whose key starts with one of `keyPrefixes`
// (compared without regard to case). Escapes: \\ \" \n \r \t \0, \xHHHH and \uHHHH for any
// character; a line that ends inside a value with a backslash continues on the next one.
RegistryFile ParseWineRegistry(std::string_view text, const std::vector<std::string>& keyPrefixes);

}  // namespace kickvane::game
