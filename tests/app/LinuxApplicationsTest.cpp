#include "app/linux/LinuxApplications.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

TEST(LinuxApplications, AreThoseThatWereCompiledInWhereTheFileCannotBeRead) {
    for (const Result<std::string>& text : {Result<std::string>(std::string(R"({"default": {"longestTyped": -1}})")),
                                            Result<std::string>(Error{"applications.json: there is no such file"})}) {
        const LinuxApplications read = readLinuxApplications(text, "applications.json");
        ASSERT_TRUE(read.problem);
        EXPECT_EQ(read.problem->message.find("applications.json: "), 0U);
        EXPECT_TRUE(read.table->find(u"Debian-XTerm")->pastesPrimary);
        EXPECT_TRUE(read.table->otherwise().has(InputFlag::UseClipboardIfHasNewLine));
    }
    const LinuxApplications own = readLinuxApplications(std::string(R"({"applications": {"x": {}}})"), "file");
    EXPECT_FALSE(own.problem || own.table->find(u"xterm"));
}

}  // namespace
}  // namespace plume
