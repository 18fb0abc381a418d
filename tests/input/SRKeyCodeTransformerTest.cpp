#include "input/SRKeyCodeTransformer.h"

#include <gtest/gtest.h>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "ports/simulated/SimulatedInputSources.h"

namespace plume {
namespace {

// The US layout, until the keys of V and K are changed for one another and none is on the key of Y.
class OtherLayout final : public InputSources {
  public:
    const std::optional<std::u16string>& currentInputSourceIdentifier() const override {
        return us_.currentInputSourceIdentifier();
    }
    std::optional<std::u16string> translateKey(KeyCode keyCode, EventFlags flags) const override {
        if (changed && keyCode == KeyCode::Y) return std::nullopt;
        if (changed && keyCode == KeyCode::V) return us_.translateKey(KeyCode::K, flags);
        if (changed && keyCode == KeyCode::K) return us_.translateKey(KeyCode::V, flags);
        return us_.translateKey(keyCode, flags);
    }
    void setChangeListener(std::function<void()>) override {}

    bool changed = false;

  private:
    SimulatedInputSources us_;
};

TEST(SRKeyCodeTransformer, NamesKeys) {
    const SimulatedInputSources us;
    const SRKeyCodeTransformer transformer(us, {u"Leertaste", u"Ziffernblock %@"});
    struct Case {
        KeyCode keyCode;
        std::optional<std::u16string> name;
    };
    const Case cases[] = {
        {KeyCode::A, u"A"},
        {KeyCode::V, u"V"},
        {KeyCode::Digit1, u"1"},
        {KeyCode::Space, u"Leertaste"},
        {KeyCode::Delete, u"\u232B"},
        {KeyCode::Return, u"\u21A9"},
        {KeyCode::KeypadEnter, u"\u2305"},
        {KeyCode::F1, u"F1"},
        {KeyCode::F19, u"F19"},
        {KeyCode::Keypad1, u"Ziffernblock 1"},
        {KeyCode::Help, u"?"},
        {KeyCode::None, std::nullopt},
        {KeyCode::Section, std::nullopt},
        {KeyCode{40000}, std::nullopt},
    };
    for (const Case& c : cases) EXPECT_EQ(transformer.transformedValue(c.keyCode), c.name) << numberOf(c.keyCode);
}

TEST(SRKeyCodeTransformer, FindsKeysByTheirNames) {
    const SimulatedInputSources us;
    const SRKeyCodeTransformer transformer(us);
    EXPECT_EQ(transformer.keyCodeForString(u"V"), KeyCode::V);
    EXPECT_EQ(transformer.keyCodeForString(u"v"), KeyCode::None);
    EXPECT_EQ(transformer.keyCodeForString(u"Pad 1"), KeyCode::Keypad1);
    EXPECT_EQ(transformer.keyCodeForString(u"1"), KeyCode::Digit1);
    EXPECT_EQ(transformer.keyCodeForString(u"Space"), KeyCode::Space);
    EXPECT_EQ(transformer.reverseTransformedValue(u"nothing"), std::nullopt);
    for (std::uint16_t code = 0; code < 128; ++code) {
        const auto name = transformer.transformedValue(KeyCode{code});
        if (!name) continue;
        EXPECT_EQ(transformer.transformedValue(transformer.keyCodeForString(*name)), name) << code;
    }
}

TEST(SRKeyCodeTransformer, FollowsTheLayout) {
    OtherLayout layout;
    SRKeyCodeTransformer transformer(layout);
    EXPECT_EQ(transformer.keyCodeForString(u"V"), KeyCode::V);
    layout.changed = true;
    transformer.regenerateStringToKeyCodeMapping();
    EXPECT_EQ(transformer.keyCodeForString(u"V"), KeyCode::K);
    EXPECT_EQ(transformer.keyCodeForString(u"K"), KeyCode::V);
    EXPECT_EQ(transformer.keyCodeForString(u"Y"), KeyCode::None) << "a name of the layout before";
}

}  // namespace
}  // namespace plume
