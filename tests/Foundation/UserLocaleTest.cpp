#include "Foundation/UserLocale.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <map>

namespace plume {
namespace {

using Environment = std::map<std::string, std::string>;

void setLocaleVariables(const Environment& values) {
    for (const char* name : {"LC_ALL", "LC_MESSAGES", "LC_TIME", "LC_NUMERIC", "LANG"}) unsetenv(name);
    for (const auto& [name, value] : values) setenv(name.c_str(), value.c_str(), 1);
}

TEST(UserLocale, IsTheFirstThatIsSet) {
    const struct {
        Environment environment;
        const char* dates;
        const char* numbers;
    } cases[] = {
        {{}, "en_US_POSIX", "en_US_POSIX"},
        {{{"LANG", "fr_FR.UTF-8"}, {"LC_TIME", "de_DE.UTF-8"}}, "de_DE", "fr_FR"},
        {{{"LANG", "fr_FR.UTF-8"}, {"LC_NUMERIC", "de_DE.UTF-8"}}, "fr_FR", "de_DE"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", "de_DE"}, {"LC_NUMERIC", "it_IT"}, {"LC_ALL", "ja_JP"}}, "ja_JP", "ja_JP"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", ""}, {"LC_NUMERIC", ""}, {"LC_ALL", ""}}, "fr_FR", "fr_FR"},
        {{{"LANG", "fr_FR"}, {"LC_MESSAGES", "de_DE"}}, "fr_FR", "fr_FR"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", "C"}, {"LC_NUMERIC", "POSIX"}}, "en_US_POSIX", "en_US_POSIX"},
    };
    for (const auto& c : cases) {
        setLocaleVariables(c.environment);
        EXPECT_EQ(userLocale(LocaleCategory::Dates), c.dates) << testing::PrintToString(c.environment);
        EXPECT_EQ(userLocale(LocaleCategory::Numbers), c.numbers) << testing::PrintToString(c.environment);
    }
}

TEST(UserLocale, IsNamedAsIcuDoes) {
    const Environment names = {{"de_DE@euro", "de_DE_EURO"}, {"ca_ES.utf8@valencia", "ca_ES_VALENCIA"},
                               {"C.UTF-8", "en_US_POSIX"},   {"eo.ISO-8859-3", "eo"},
                               {"zh_Hant_TW", "zh_Hant_TW"}, {std::string(100'000, 'x'), "en_US_POSIX"}};
    for (const auto& [value, name] : names) {
        setLocaleVariables({{"LC_ALL", value}});
        EXPECT_EQ(userLocale(LocaleCategory::Dates), name) << value.substr(0, 40);
    }
}

}  // namespace
}  // namespace plume
