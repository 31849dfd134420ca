#pragma once

#include <QString>
#include <filesystem>
#include <string>
#include <string_view>

#include "platform/filesystem.h"

// Text between the core (UTF-8 strings, native paths) and Qt. Paths go through their UTF-8 form:
// a path made from or read as a plain string is in the ANSI code page on Windows, which has no
// room for most Vietnamese letters.
namespace kickvane::shell {

inline QString toQString(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

inline std::string toUtf8(const QString& text) {
    return text.toStdString();
}

inline QString pathToQString(const std::filesystem::path& path) {
    return toQString(platform::PathToUtf8(path));
}

inline std::filesystem::path qStringToPath(const QString& text) {
    return platform::PathFromUtf8(text.toStdString());
}

}  // namespace kickvane::shell
