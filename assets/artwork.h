#pragma once

#include <filesystem>

// The files the build lays out in the tool folder. Each writer returns false when a file could not
// be written.
namespace kickvane::artwork {

// skin/skin1_*.jpg (light) and skin/skin2_*.jpg (dark): window background, panel and tab heads.
bool WriteSkins(const std::filesystem::path& toolFolder);

// img/t1_img_*.jpg to img/t4_img_*.jpg: one preview picture per category and variant.
bool WritePreviews(const std::filesystem::path& toolFolder);

// icons/kickvane-16.png, -32 and -64.
bool WriteIcons(const std::filesystem::path& toolFolder);

// sound.wav: the signal played after the sets are copied.
bool WriteChime(const std::filesystem::path& file);

}  // namespace kickvane::artwork
