#include <algorithm>
#include <cmath>
#include <cstdint>
#include <fstream>
#include <numbers>
#include <string>
#include <vector>

#include "artwork.h"

namespace kickvane::artwork {

namespace {

constexpr int kRate = 44100;
constexpr double kLength = 0.35;  // seconds

struct Note {
    double start;      // seconds
    double frequency;  // hertz
    double decay;      // seconds for the level to fall to 1/e
};

// A soft bell: the note with a little of its second and third harmonics, a short rise so that it
// does not click, then an exponential fall.
double NoteAt(const Note& note, double t) {
    const double local = t - note.start;
    if (local < 0) {
        return 0;
    }
    const double rise = std::min(1.0, local / 0.006);
    const double w = 2 * std::numbers::pi * note.frequency * local;
    const double tone = std::sin(w) + 0.22 * std::sin(2 * w) + 0.06 * std::sin(3 * w);
    return rise * std::exp(-local / note.decay) * tone / 1.28;
}

void PutLittleEndian(std::string& out, uint32_t value, int bytes) {
    for (int i = 0; i < bytes; ++i) {
        out.push_back(static_cast<char>((value >> (8 * i)) & 0xFF));
    }
}

}  // namespace

bool WriteChime(const std::filesystem::path& file) {
    // A rising fifth, A5 then E6.
    const Note first{0.0, 880.0, 0.10};
    const Note second{0.11, 1318.51, 0.12};
    const int count = static_cast<int>(kLength * kRate);
    std::string samples;
    for (int i = 0; i < count; ++i) {
        const double t = static_cast<double>(i) / kRate;
        // The last 30 ms fade to silence so the sound ends without a click.
        const double tail = std::min(1.0, (kLength - t) / 0.03);
        const double level = 0.42 * (NoteAt(first, t) + 0.9 * NoteAt(second, t)) * tail;
        const auto value = static_cast<int16_t>(std::lround(std::clamp(level, -1.0, 1.0) * 32767));
        PutLittleEndian(samples, static_cast<uint16_t>(value), 2);
    }

    // The canonical 44-byte header of a PCM WAV file: mono, 16 bits.
    std::string wav = "RIFF";
    PutLittleEndian(wav, static_cast<uint32_t>(36 + samples.size()), 4);
    wav += "WAVEfmt ";
    PutLittleEndian(wav, 16, 4);
    PutLittleEndian(wav, 1, 2);  // PCM
    PutLittleEndian(wav, 1, 2);  // channels
    PutLittleEndian(wav, kRate, 4);
    PutLittleEndian(wav, kRate * 2, 4);  // bytes per second
    PutLittleEndian(wav, 2, 2);          // bytes per frame
    PutLittleEndian(wav, 16, 2);         // bits per sample
    wav += "data";
    PutLittleEndian(wav, static_cast<uint32_t>(samples.size()), 4);
    wav += samples;

    std::ofstream out(file, std::ios::binary | std::ios::trunc);
    out.write(wav.data(), static_cast<std::streamsize>(wav.size()));
    return static_cast<bool>(out.flush());
}

}  // namespace kickvane::artwork
