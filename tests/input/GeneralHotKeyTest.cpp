#include "input/GeneralHotKey.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

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

RC_GTEST_PROP(GeneralHotKeyValue, IsReadBackAsItWas, (std::int32_t modifiers, std::uint16_t keyCode)) {
    const GeneralHotKey hotKey{KeyModifiers::fromBits(modifiers), KeyCode{keyCode}};
    GeneralHotKey read;
    read.setValue(hotKey.getValue());
    RC_ASSERT(read == hotKey);
}

TEST(GeneralHotKey, IsNoneWithACodeThatNoKeyHas) {
    for (const std::int64_t packed : {(std::int64_t{2} << 32) + 65536, std::int64_t{-1}}) {
        GeneralHotKey read{KeyModifier::Control, KeyCode::A};
        read.setValue(packed);
        EXPECT_FALSE(read.isValid()) << packed;
    }
}

struct FlagCase {
    std::uint64_t flags;
    std::int32_t modifiers;
};

TEST(Modifiers, AreFourBitsOfTheEventFlags) {
    const FlagCase cases[] = {
        {0x20000, 1}, {0x40000, 2}, {0x80000, 4}, {0x100000, 8}, {0x1E0000, 15}, {0x10000, 0},  // Caps Lock
        {0x20102, 1},  // the left Shift key, as a device reports it
        {0x200000, 0}  // keypad
    };
    for (const FlagCase& one : cases) {
        EXPECT_EQ(modifiersFromFlags(EventFlags::fromBits(one.flags)).bits(), one.modifiers) << one.flags;
    }
}

}  // namespace
}  // namespace plume
