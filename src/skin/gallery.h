#pragma once

#include <filesystem>
#include <iosfwd>

namespace kickvane::skin {

// Renders every painter in each of its states, and every picture of the skin, into one labelled
// sheet and saves it as a PNG. Works without a Qt application object (it then runs one on the
// offscreen platform for as long as it draws). Returns 0 on success; otherwise writes why to `err`
// and returns 1.
int runSkinGallery(const std::filesystem::path& outPng, std::ostream& err);

}  // namespace kickvane::skin
