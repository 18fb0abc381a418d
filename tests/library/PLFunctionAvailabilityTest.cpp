#include "library/PLFunctionAvailability.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace plume {
namespace {

// What a list of "a" and "b" admits: "b", "B" and nothing (0); and whether a missing list admits "b" (!).
TEST(PLFunctionAvailability, AdmitsByItsOption) {
    using List = std::optional<std::vector<std::u16string>>;
    const auto admitted = [](auto admits) {
        const List list = {{u"a", u"b"}};
        std::string names = admits(list, u"b") ? "b" : "";
        if (admits(list, u"B")) names += "B";
        if (admits(list, std::nullopt)) names += "0";
        return names + (admits(std::nullopt, u"b") ? "!" : "");
    };
    const struct {
        std::int64_t option;
        const char* applications;
        const char* inputSources;
    } cases[] = {{0, "bB0!", "bB0!"}, {1, "B0!", "B0!"}, {2, "b", "b"}, {3, "", "b"}, {-1, "", "b"}};
    for (const auto& c : cases) {
        using Identifier = std::optional<std::u16string>;
        const auto application = [&](const List& list, const Identifier& identifier) {
            return PLFunctionAvailability{c.option, list, 0, {}}.admitsApplication(identifier);
        };
        const auto inputSource = [&](const List& list, const Identifier& identifier) {
            return PLFunctionAvailability{0, {}, c.option, list}.admitsInputSource(identifier);
        };
        EXPECT_EQ(admitted(application), c.applications) << c.option;
        EXPECT_EQ(admitted(inputSource), c.inputSources) << c.option;
    }
}

}  // namespace
}  // namespace plume
