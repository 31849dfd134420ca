#pragma once

#include <QString>
#include <filesystem>
#include <string>
#include <string_view>

// Text between the core (UTF-8 strings, native paths) and Qt.
namespace kickvane::shell {

inline QString toQString(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

inline std::string toUtf8(const QString& text) {
    return text.toStdString();
}

inline QString pathToQString(const std::filesystem::path& path) {
    return toQString(path.string());
}

inline std::filesystem::path qStringToPath(const QString& text) {
    return std::filesystem::path(text.toStdString());
}

}  // namespace kickvane::shell
