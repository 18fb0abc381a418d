#include "input/GeneralHotKey.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

TEST(GeneralHotKey, IsValidWithAKeyOrWithModifiers) {
    EXPECT_FALSE(GeneralHotKey().isValid());
    EXPECT_TRUE((GeneralHotKey{KeyModifier::Shift, KeyCode::None}).isValid());
    EXPECT_TRUE((GeneralHotKey{{}, KeyCode::A}).isValid());
}

struct PackedCase {
    GeneralHotKey hotKey;
    std::int64_t packed;
};

TEST(GeneralHotKey, PacksModifiersAboveTheKeyCode) {
    const PackedCase cases[] = {
        {{}, 65535},
        {{KeyModifier::Control, KeyCode::Delete}, (std::int64_t{2} << 32) + 51},
        {{KeyModifier::Control | KeyModifier::Option, KeyCode::None}, 25769869311},
    };
    for (const PackedCase& one : cases) {
        EXPECT_EQ(one.hotKey.getValue(), one.packed);
        GeneralHotKey read;
        read.setValue(one.packed);
        EXPECT_EQ(read, one.hotKey);
    }
}

TEST(GeneralHotKey, IsNoneWithACodeThatNoKeyHas) {
    for (const std::int64_t packed : {(std::int64_t{2} << 32) + 65536, std::int64_t{-1}}) {
        GeneralHotKey read{KeyModifier::Control, KeyCode::A};
        read.setValue(packed);
        EXPECT_FALSE(read.isValid()) << packed;
    }
}

TEST(Modifiers, AreFourBitsOfTheEventFlags) {
    constexpr auto Keypad = EventFlags::fromBits(0x200000);
    EXPECT_EQ(modifiersFromFlags(EventFlag::Shift | EventFlag::CapsLock | Keypad), KeyModifier::Shift);
    EXPECT_EQ(modifiersFromFlags(ModifierFlags).bits(), 15);
}

}  // namespace
}  // namespace plume
