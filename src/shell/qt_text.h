#pragma once

#include <QString>
#include <filesystem>
#include <string>
#include <string_view>

// Text between the core (UTF-8 strings, native paths) and Qt.
namespace kickvane::shell {

inline QString ToQString(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

inline std::string ToUtf8(const QString& text) {
    return text.toStdString();
}

inline QString PathToQString(const std::filesystem::path& path) {
    return ToQString(path.string());
}

inline std::filesystem::path QStringToPath(const QString& text) {
    return std::filesystem::path(text.toStdString());
}

}  // namespace kickvane::shell
