// Writes Plume's own sounds as WAV files into the folder that is its argument: short, quiet sines whose pitch may fall.
#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <numbers>
#include <string>
#include <string_view>
#include <vector>

namespace {

struct Sound {
    const char* name;
    double length;      // seconds
    double firstPitch;  // hertz
    double lastPitch;   // hertz
    double loudness;    // of 1
};

constexpr std::array Sounds = {
    Sound{"Click", 0.012, 1900, 1500, 0.14},
    Sound{"Pop", 0.060, 620, 240, 0.22},
    Sound{"Tink", 0.050, 2700, 2700, 0.10},
};

constexpr std::uint32_t Rate = 44100;    // samples a second
constexpr double Attack = 0.001;         // seconds; a sine that starts at once would crackle
constexpr double LargestSample = 32767;  // of 16 bits
constexpr double Decay = 5;              // how far it has faded at its end, as a power of e

std::vector<std::int16_t> samplesOf(const Sound& sound) {
    const auto count = static_cast<std::size_t>(sound.length * Rate);
    std::vector<std::int16_t> samples;
    double phase = 0;
    for (std::size_t i = 0; i < count; ++i) {
        const double done = static_cast<double>(i) / static_cast<double>(count);
        const double begun = std::min(1.0, static_cast<double>(i) / (Attack * Rate));
        phase += 2 * std::numbers::pi * std::lerp(sound.firstPitch, sound.lastPitch, done) / Rate;
        const double value = sound.loudness * begun * std::exp(-Decay * done) * (1 - done) * std::sin(phase);
        samples.push_back(static_cast<std::int16_t>(std::lround(value * LargestSample)));
    }
    return samples;
}

void append(std::string& bytes, std::uint32_t number, int length) {
    for (int i = 0; i < length; ++i) bytes += static_cast<char>(number >> (8 * i) & 0xFFU);
}

// One channel of 16 bits.
std::string waveFile(const std::vector<std::int16_t>& samples) {
    constexpr std::uint32_t SampleLength = 2;
    const auto length = static_cast<std::uint32_t>(samples.size()) * SampleLength;
    std::string bytes = "RIFF";
    append(bytes, 36 + length, 4);
    bytes += "WAVEfmt ";
    append(bytes, 16, 4);
    append(bytes, 1, 2);  // plain samples
    append(bytes, 1, 2);  // channels
    append(bytes, Rate, 4);
    append(bytes, Rate * SampleLength, 4);
    append(bytes, SampleLength, 2);
    append(bytes, SampleLength * 8, 2);
    bytes += "data";
    append(bytes, length, 4);
    for (const std::int16_t sample : samples) append(bytes, static_cast<std::uint16_t>(sample), 2);
    return bytes;
}

}  // namespace

int main(int argc, const char* const* argv) {
    if (argc != 2) return 2;
    const std::filesystem::path folder = argv[1];
    std::filesystem::create_directories(folder);
    for (const Sound& sound : Sounds) {
        std::ofstream file(folder / (std::string(sound.name) + ".wav"), std::ios::binary);
        if (!(file << waveFile(samplesOf(sound)) << std::flush)) return 1;
    }
    return 0;
}
