#include "library/MemoryUserDefaults.h"

#include <gmock/gmock.h>

#include <cmath>
#include <fstream>
#include <iterator>

#include "library/KnownSettings.h"
#include "library/SettingsFile.h"

namespace plume {

namespace {

struct Changes {
    explicit Changes(WritableUserDefaults& defaults)
        : subscription(defaults.changedEvent.addObserver(this, &Changes::add)) {}
    void add(UserDefaultsChange& change) { keys.insert(keys.end(), change.keys.begin(), change.keys.end()); }
    std::vector<std::string> keys;
    Subscription subscription;
};

}  // namespace

TEST(UserDefaultsTest, ReadsNumbersAndBooleansAsOneAnother) {
    constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
    const struct {
        PropertyList value;
        std::int64_t integer;
        double number;
        bool boolean;
    } cases[] = {
        {true, 1, 1, true},          {std::int64_t{-3}, -3, -3, true},    {Most, Most, 9223372036854775807.0, true},
        {2.9, 2, 2.9, true},         {1e300, Most, 1e300, true},          {-1e300, -Most - 1, -1e300, true},
        {std::nan(""), 0, 0, false}, {std::u16string(u"5"), 0, 0, false}, {PropertyList::Array{}, 0, 0, false},
    };
    for (const auto& [value, integer, number, boolean] : cases) {
        MemoryUserDefaults defaults;
        defaults.set("key", value);
        EXPECT_EQ(defaults.integerForKey("key"), integer);
        EXPECT_EQ(defaults.doubleForKey("key"), number);
        EXPECT_EQ(defaults.boolForKey("key"), boolean);
    }
}

TEST(UserDefaultsTest, ReadsListsOfStringsWhole) {
    MemoryUserDefaults defaults;
    defaults.set("strings", PropertyList::Array{std::u16string(u"a"), std::u16string(u"b")});
    defaults.set("mixed", PropertyList::Array{std::u16string(u"a"), true});
    EXPECT_EQ(defaults.stringArrayForKey("strings"), (std::vector<std::u16string>{u"a", u"b"}));
    EXPECT_EQ(defaults.stringArrayForKey("mixed"), std::nullopt);
    EXPECT_EQ(defaults.stringArrayForKey("none"), std::nullopt);
    EXPECT_FALSE(defaults.hasKey("none"));
}

TEST(MemoryUserDefaultsTest, OwnValuesStandOverRegisteredOnes) {
    MemoryUserDefaults defaults;
    defaults.registerDefaults({{"IsEnabled", true}, {"LongTextLength", std::int64_t{100}}});
    Changes changes(defaults);
    EXPECT_TRUE(defaults.boolForKey("IsEnabled"));
    EXPECT_THAT(defaults.ownKeys(), testing::IsEmpty());

    defaults.set("IsEnabled", true);  // as it was
    EXPECT_THAT(changes.keys, testing::IsEmpty());
    defaults.set("LongTextLength", std::int64_t{7});
    EXPECT_EQ(defaults.integerForKey("LongTextLength"), 7);
    EXPECT_THAT(defaults.ownKeys(), testing::ElementsAre("IsEnabled", "LongTextLength"));
    EXPECT_TRUE(defaults.removeObject("LongTextLength"));
    EXPECT_TRUE(defaults.removeObject("LongTextLength"));
    EXPECT_EQ(defaults.integerForKey("LongTextLength"), 100);
    EXPECT_THAT(changes.keys, testing::ElementsAre("LongTextLength", "LongTextLength"));
}

TEST(KnownSettingsTest, ReadsDatesAndDictionaries) {
    const auto settings = SettingsFile::read(R"({"LastBackupTime": "2026-01-31T18:30:05Z",
        "DefaultSnippetEditorFont": {"NSFontNameAttribute": "Courier", "NSFontSizeAttribute": 9}})",
                                             "s.json");
    ASSERT_TRUE(settings) << settings.error().message;
    using namespace std::chrono;
    EXPECT_EQ(settings.value()->dateForKey("LastBackupTime"), Date(sys_days(2026y / January / 31)) + 18h + 30min + 5s);
    const auto font = settings.value()->objectForKey("DefaultSnippetEditorFont");
    EXPECT_EQ(*font->find<std::int64_t>("NSFontSizeAttribute"), 9);
    for (const char* wrong : {"2026-02-30T00:00:00Z", "2026-01-31T24:00:00Z", "2026-01-31", "2026-01-31T18:30:05Zx"}) {
        EXPECT_FALSE(SettingsFile::read(R"({"LastBackupTime": ")" + std::string(wrong) + "\"}", "s.json")) << wrong;
    }
}

TEST(KnownSettingsTest, AreAllOnTheirPage) {
    std::ifstream file("docs/settings.md");
    const std::string page{std::istreambuf_iterator<char>(file), {}};
    for (const KnownSetting& setting : knownSettings()) {
        EXPECT_THAT(page, testing::HasSubstr("`" + std::string(setting.name) + "`"));
    }
}

TEST(KnownSettingsTest, RegistersTheFolderForBackupsWhereThereIsOne) {
    EXPECT_FALSE(registeredSettings().contains("BackupDirectory"));
    EXPECT_EQ(registeredSettings("/b").at("BackupDirectory"), PropertyList(std::u16string(u"/b")));
}

}  // namespace plume
