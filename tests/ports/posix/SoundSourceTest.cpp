#include "ports/posix/SoundSource.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace plume {
namespace {

TEST(SoundSource, IsAShortAndQuietFileOfOurOwnForWhatPlumePlays) {
    const auto folder = std::filesystem::read_symlink("/proc/self/exe").parent_path() / "../share/plume/sounds";
    for (const char* name : {"Click", "Tink", "Pop"}) {
        std::ifstream file(soundSourceOf(name, folder).file, std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(file), {}};
        ASSERT_TRUE(bytes.starts_with("RIFF") && bytes.size() > 500 && bytes.size() < 10'000) << name;
        int loudest = 0;
        for (std::size_t i = 44; i + 1 < bytes.size(); i += 2) {
            const int sample = static_cast<signed char>(bytes[i + 1]) * 256 + static_cast<unsigned char>(bytes[i]);
            loudest = std::max(loudest, std::abs(sample));
        }
        EXPECT_TRUE(loudest > 1000 && loudest < 10'000) << name << ' ' << loudest;
    }
    EXPECT_EQ(soundSourceOf("Glass", folder).event, "complete");
    EXPECT_EQ(soundSourceOf("zebra", folder).event, "zebra") << "which no theme has: silence";
}

}  // namespace
}  // namespace plume
