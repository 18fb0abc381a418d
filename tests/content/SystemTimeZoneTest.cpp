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

TEST_F(SystemTimeZoneTest, IsDetectedAtTheFirstLookAndWhenTheFileHasChanged) {
    // In a shell, in the folder of the link.
    const struct {
        const char* what;
        const char* change;
        bool isSeen;
    } cases[] = {
        {"nothing", "true", false},
        {"another file beside it", "echo x >third", false},
        {"a new link in the old one's place", "ln -s other new; mv -T new localtime", true},
        {"a new link to the same file", "ln -s $(readlink localtime) new; mv -T new localtime", true},
        {"another file where the link leads", "echo new >new; mv new $(readlink localtime)", true},
        {"a file in place of the link", "cp other new; mv -T new localtime", true},
        {"gone", "rm localtime", true},
    };
    for (const auto& c : cases) {
        travelTo("Europe/Berlin");
        SystemTimeZone zone(link());
        zone.follow();
        ASSERT_EQ(defaultZone(), "Europe/Berlin") << c.what;
        travelTo("Asia/Tokyo");
        ASSERT_EQ(std::system(("cd '" + folder_.string() + "' && " + c.change).c_str()), 0);
        zone.follow();
        EXPECT_EQ(defaultZone(), c.isSeen ? "Asia/Tokyo" : "Europe/Berlin") << c.what;
    }
}

}  // namespace
}  // namespace plume
