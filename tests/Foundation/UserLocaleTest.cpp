#include "Foundation/UserLocale.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <map>
#include <optional>

namespace plume {
namespace {

// The variables that say the locale, as they were before the test when it has ended.
class LocaleEnvironment {
  public:
    LocaleEnvironment() {
        for (const char* name : {"LC_ALL", "LC_MESSAGES", "LC_TIME", "LC_NUMERIC", "LANG"}) {
            const char* const value = std::getenv(name);
            before_[name] = value ? std::optional<std::string>(value) : std::nullopt;
        }
    }
    ~LocaleEnvironment() { set(before_); }
    LocaleEnvironment(const LocaleEnvironment&) = delete;
    LocaleEnvironment& operator=(const LocaleEnvironment&) = delete;

    void setOnly(const std::map<std::string, std::string>& values) {
        for (const auto& [name, value] : before_) unsetenv(name.c_str());
        for (const auto& [name, value] : values) setenv(name.c_str(), value.c_str(), 1);
    }

  private:
    static void set(const std::map<std::string, std::optional<std::string>>& values) {
        for (const auto& [name, value] : values) {
            value ? setenv(name.c_str(), value->c_str(), 1) : unsetenv(name.c_str());
        }
    }

    std::map<std::string, std::optional<std::string>> before_;
};

TEST(UserLocale, IsTheFirstThatIsSet) {
    const struct {
        std::map<std::string, std::string> environment;
        const char* dates;
        const char* numbers;
    } cases[] = {
        {{}, "en_US_POSIX", "en_US_POSIX"},
        {{{"LANG", "fr_FR.UTF-8"}}, "fr_FR", "fr_FR"},
        {{{"LANG", "fr_FR.UTF-8"}, {"LC_TIME", "de_DE.UTF-8"}}, "de_DE", "fr_FR"},
        {{{"LANG", "fr_FR.UTF-8"}, {"LC_NUMERIC", "de_DE.UTF-8"}}, "fr_FR", "de_DE"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", "de_DE"}, {"LC_NUMERIC", "it_IT"}, {"LC_ALL", "ja_JP"}}, "ja_JP", "ja_JP"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", ""}, {"LC_NUMERIC", ""}, {"LC_ALL", ""}}, "fr_FR", "fr_FR"},
        {{{"LANG", "fr_FR"}, {"LC_MESSAGES", "de_DE"}}, "fr_FR", "fr_FR"},
        {{{"LANG", "fr_FR"}, {"LC_TIME", "C"}, {"LC_NUMERIC", "POSIX"}}, "en_US_POSIX", "en_US_POSIX"},
    };
    LocaleEnvironment environment;
    for (const auto& c : cases) {
        environment.setOnly(c.environment);
        EXPECT_EQ(userLocale(LocaleCategory::Dates), c.dates) << testing::PrintToString(c.environment);
        EXPECT_EQ(userLocale(LocaleCategory::Numbers), c.numbers) << testing::PrintToString(c.environment);
    }
}

TEST(UserLocale, IsNamedAsIcuDoes) {
    const struct {
        std::string value;
        const char* name;
    } cases[] = {{"de_DE@euro", "de_DE_EURO"}, {"ca_ES.utf8@valencia", "ca_ES_VALENCIA"},
                 {"C.UTF-8", "en_US_POSIX"},   {"eo.ISO-8859-3", "eo"},
                 {"zh_Hant_TW", "zh_Hant_TW"}, {std::string(100'000, 'x'), "en_US_POSIX"}};
    LocaleEnvironment environment;
    for (const auto& c : cases) {
        environment.setOnly({{"LC_ALL", c.value}});
        EXPECT_EQ(userLocale(LocaleCategory::Dates), c.name) << c.value.substr(0, 40);
    }
}

}  // namespace
}  // namespace plume
