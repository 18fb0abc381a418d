#include "content/SystemTimeZone.h"

#include <gtest/gtest.h>
#include <unicode/timezone.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>

namespace plume {
namespace {

namespace fs = std::filesystem;

std::string defaultZone() {
    const std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::createDefault());
    icu::UnicodeString id;
    std::string name;
    return zone->getID(id).toUTF8String(name);
}

// The computer's zone is put on by TZ here: /etc belongs to the computer that runs the tests. Which file is watched is
// another matter.
class SystemTimeZoneTest : public testing::Test {
  protected:
    SystemTimeZoneTest() {
        std::string pattern = (fs::temp_directory_path() / "plume-zone-XXXXXX").string();
        folder_ = mkdtemp(pattern.data());
        for (const char* name : {"one", "other"}) std::ofstream(folder_ / name) << name;
        fs::create_symlink(folder_ / "one", link());
        const char* const zone = std::getenv("TZ");
        if (zone) before_ = zone;
    }
    ~SystemTimeZoneTest() override {
        before_ ? setenv("TZ", before_->c_str(), 1) : unsetenv("TZ");
        SystemTimeZone().follow();
        fs::remove_all(folder_);
    }

    static void travelTo(const char* zone) { setenv("TZ", zone, 1); }
    fs::path link() const { return folder_ / "localtime"; }

    fs::path folder_;
    std::optional<std::string> before_;
};

TEST_F(SystemTimeZoneTest, IsDetectedAtTheFirstLookWhateverIcuKnew) {
    travelTo("Asia/Tokyo");
    SystemTimeZone(link()).follow();
    EXPECT_EQ(defaultZone(), "Asia/Tokyo");
    travelTo("Europe/Berlin");
    SystemTimeZone(link()).follow();
    EXPECT_EQ(defaultZone(), "Europe/Berlin");
}

TEST_F(SystemTimeZoneTest, IsDetectedAgainWhenTheFileHasChangedAndOnlyThen) {
    const struct {
        const char* what;
        void (*change)(const fs::path& folder, const fs::path& link);
        bool isSeen;
    } cases[] = {
        {"nothing", [](const fs::path&, const fs::path&) {}, false},
        {"another file beside it",
         [](const fs::path& folder, const fs::path&) { std::ofstream(folder / "third") << "x"; }, false},
        {"a new link in the old one's place",
         [](const fs::path& folder, const fs::path& link) {
             fs::create_symlink(folder / "other", folder / "new");
             fs::rename(folder / "new", link);
         },
         true},
        {"a new link to the same file",
         [](const fs::path& folder, const fs::path& link) {
             fs::create_symlink(fs::read_symlink(link), folder / "new");
             fs::rename(folder / "new", link);
         },
         true},
        {"another file where the link leads",
         [](const fs::path& folder, const fs::path& link) {
             std::ofstream(folder / "new") << "new";
             fs::rename(folder / "new", fs::canonical(link));
         },
         true},
        {"a file in place of the link",
         [](const fs::path& folder, const fs::path& link) {
             fs::copy_file(folder / "other", folder / "new");
             fs::rename(folder / "new", link);
         },
         true},
        {"gone", [](const fs::path&, const fs::path& link) { fs::remove(link); }, true},
    };
    for (const auto& c : cases) {
        travelTo("Europe/Berlin");
        SystemTimeZone zone(link());
        zone.follow();
        ASSERT_EQ(defaultZone(), "Europe/Berlin") << c.what;
        travelTo("Asia/Tokyo");
        c.change(folder_, link());
        zone.follow();
        EXPECT_EQ(defaultZone(), c.isSeen ? "Asia/Tokyo" : "Europe/Berlin") << c.what;
    }
}

}  // namespace
}  // namespace plume
