#include "platform/sound.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

using testing::TempDir;
using testing::WriteFile;

// A valid PCM WAV file: 8 kHz, mono, 8 bits, `samples` samples of silence.
std::string TinyWav(uint32_t samples) {
    std::string wav;
    auto put32 = [&wav](uint32_t v) {
        for (int i = 0; i < 4; ++i) {
            wav += static_cast<char>((v >> (8 * i)) & 0xFF);
        }
    };
    auto put16 = [&wav](uint16_t v) {
        wav += static_cast<char>(v & 0xFF);
        wav += static_cast<char>(v >> 8);
    };
    wav += "RIFF";
    put32(36 + samples);
    wav += "WAVEfmt ";
    put32(16);
    put16(1);     // PCM
    put16(1);     // mono
    put32(8000);  // samples per second
    put32(8000);  // bytes per second
    put16(1);     // block size
    put16(8);     // bits per sample
    wav += "data";
    put32(samples);
    wav.append(samples, static_cast<char>(0x80));
    return wav;
}

// A file goes to the sound system by its absolute path; anything else plays the default sound.
// Whatever the machine has for audio (often nothing on a build server), playing returns and the
// process goes on, and a second call reuses what the first set up.
TEST(PlaySoundAsync, HandsOverRegularFilesAndOtherwiseFallsBackToTheDefaultSound) {
    TempDir dir;
    WriteFile(dir / "sound.wav", TinyWav(800));
    WriteFile(dir / "broken.wav", "RIFF????WAVE");

    EXPECT_EQ(SoundFileToPlay(dir / "sound.wav"), dir / "sound.wav");
    EXPECT_EQ(SoundFileToPlay(dir / "broken.wav"), dir / "broken.wav");  // the player decides
    EXPECT_EQ(SoundFileToPlay(dir / "missing.wav"), std::nullopt);
    EXPECT_EQ(SoundFileToPlay(dir.path()), std::nullopt);  // a folder, not a file
    const std::filesystem::path relative =
        std::filesystem::relative(dir / "sound.wav", std::filesystem::current_path());
    ASSERT_TRUE(relative.is_relative());
    EXPECT_EQ(SoundFileToPlay(relative), std::filesystem::absolute(relative));

    for (const char* name : {"missing.wav", "sound.wav", "broken.wav", "", "sound.wav"}) {
        PlaySoundAsync(dir / name);
    }
}

}  // namespace
}  // namespace kickvane::platform
