#include "input/SRKeyCodeTransformer.h"

#include <gtest/gtest.h>

#include "input/KeyCodes.h"
#include "ports/simulated/SimulatedInputSources.h"

namespace plume {
namespace {

// The US layout with the keys of V and K changed for one another, and none on the key of Y.
class OtherLayout final : public InputSources {
  public:
    const std::optional<std::u16string>& currentInputSourceIdentifier() const override {
        return us_.currentInputSourceIdentifier();
    }
    std::optional<std::u16string> translateKey(std::uint16_t keyCode, std::uint64_t flags) const override {
        if (!changed) return us_.translateKey(keyCode, flags);
        if (keyCode == 16) return std::nullopt;
        return us_.translateKey(keyCode == 9 ? 40 : keyCode == 40 ? 9 : keyCode, flags);
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
        std::int64_t keyCode;
        std::optional<std::u16string> name;
    };
    const Case cases[] = {
        {0, u"A"},
        {9, u"V"},
        {18, u"1"},
        {49, u"Leertaste"},
        {51, u"\u232B"},
        {36, u"\u21A9"},
        {76, u"\u2305"},
        {122, u"F1"},
        {80, u"F19"},
        {83, u"Ziffernblock 1"},
        {114, u"?"},
        {65535, std::nullopt},
        {-1, std::nullopt},
        {10, std::nullopt},
        {40000, std::nullopt},
    };
    for (const Case& c : cases) EXPECT_EQ(transformer.transformedValue(c.keyCode), c.name) << c.keyCode;
}

TEST(SRKeyCodeTransformer, FindsKeysByTheirNames) {
    const SimulatedInputSources us;
    const SRKeyCodeTransformer transformer(us);
    EXPECT_EQ(transformer.keyCodeForString(u"V"), 9);
    EXPECT_EQ(transformer.keyCodeForString(u"v"), KeyCode::None);
    EXPECT_EQ(transformer.keyCodeForString(u"Pad 1"), 83);
    EXPECT_EQ(transformer.keyCodeForString(u"1"), 18);
    EXPECT_EQ(transformer.keyCodeForString(u"Space"), 49);
    EXPECT_EQ(transformer.reverseTransformedValue(u"nothing"), std::nullopt);
    for (std::uint16_t code = 0; code < 128; ++code) {
        const auto name = transformer.transformedValue(code);
        if (!name) continue;
        EXPECT_EQ(transformer.transformedValue(transformer.keyCodeForString(*name)), name) << code;
    }
}

TEST(SRKeyCodeTransformer, FollowsTheLayout) {
    OtherLayout layout;
    SRKeyCodeTransformer transformer(layout);
    EXPECT_EQ(transformer.keyCodeForString(u"V"), 9);
    layout.changed = true;
    transformer.regenerateStringToKeyCodeMapping();
    EXPECT_EQ(transformer.keyCodeForString(u"V"), 40);
    EXPECT_EQ(transformer.keyCodeForString(u"K"), 9);
    EXPECT_EQ(transformer.keyCodeForString(u"Y"), KeyCode::None) << "a name of the layout before";
}

}  // namespace
}  // namespace plume
