#include "platform/sound.h"

#include <gtest/gtest.h>

#include <string>

#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

using testing::TempDir;
using testing::WriteFile;

// A file goes to the sound system by its absolute path, whatever its content (the player
// decides); anything else plays the default sound. Whatever the machine has for audio (often
// nothing on a build server), playing returns and the process goes on, and a second call reuses
// what the first set up: without audio every call plays nothing, with it the file plays again.
TEST(PlaySoundAsync, HandsOverRegularFilesAndOtherwiseFallsBackToTheDefaultSound) {
    TempDir dir;
    // 8 kHz, mono, 8 bits: eight samples of silence.
    WriteFile(dir / "sound.wav",
              std::string("RIFF\x2c\0\0\0WAVEfmt \x10\0\0\0\1\0\1\0\x40\x1f\0\0\x40"
                          "\x1f\0\0\1\0\x08\0data\x08\0\0\0",
                          44) +
                  std::string(8, '\x80'));
    WriteFile(dir / "broken.wav", "RIFF????WAVE");

    EXPECT_EQ(SoundFileToPlay(dir / "broken.wav"), dir / "broken.wav");
    EXPECT_EQ(SoundFileToPlay(dir / "missing.wav"), std::nullopt);
    EXPECT_EQ(SoundFileToPlay(dir.path()), std::nullopt);  // a folder, not a file
    const std::filesystem::path relative =
        std::filesystem::relative(dir / "broken.wav", std::filesystem::current_path());
    ASSERT_TRUE(relative.is_relative());
    EXPECT_EQ(SoundFileToPlay(relative), std::filesystem::absolute(relative));

    const SoundPlayed first = PlaySoundAsync(dir / "sound.wav");
    if (first == SoundPlayed::Nothing) {
        for (const char* name : {"missing.wav", "sound.wav", ""}) {
            EXPECT_EQ(PlaySoundAsync(dir / name), SoundPlayed::Nothing) << name;
        }
        return;
    }
    EXPECT_EQ(first, SoundPlayed::File);
    EXPECT_EQ(PlaySoundAsync(dir / "sound.wav"), SoundPlayed::File);
    for (const char* name : {"missing.wav", ""}) {
        EXPECT_NE(PlaySoundAsync(dir / name), SoundPlayed::File) << name;  // never the file
    }
}

}  // namespace
}  // namespace kickvane::platform
