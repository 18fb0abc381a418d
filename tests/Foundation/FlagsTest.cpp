#include "Foundation/Flags.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace plume {
namespace {

enum class Key : std::uint8_t { Shift = 1, Control = 2, Both = 3, Option = 4 };
using Keys = Flags<Key>;

TEST(FlagsTest, AreSetsOfBits) {
    const Keys keys = Keys(Key::Shift) | Key::Option;
    EXPECT_TRUE(keys.contains(Key::Shift));
    EXPECT_FALSE(keys.contains(Key::Both));
    EXPECT_TRUE(keys.containsAny(Key::Both));
    EXPECT_FALSE(keys.containsAny(Key::Control));
    EXPECT_TRUE(keys.contains(Keys()) && !keys.containsAny(Keys()));
    EXPECT_EQ(keys - Key::Both, Key::Option);
    EXPECT_EQ(keys & Key::Both, Key::Shift);
    EXPECT_TRUE((keys & Key::Control).isEmpty());
}

TEST(FlagsTest, KeepBitsThatNobodyHasNamed) {
    Keys keys = Keys::fromBits(0x81);
    keys |= Key::Control;
    EXPECT_EQ(keys.bits(), 0x83);
    keys &= Keys::fromBits(0xF0);
    EXPECT_EQ(keys.bits(), 0x80);
}

}  // namespace
}  // namespace plume
