#include "app/ReportLog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace plume {
namespace {

using namespace std::chrono_literals;
using ::testing::ElementsAre;

class ReportLogTest : public ::testing::Test {
  protected:
    // Each as its sentence and how often it was reported, the newest one last.
    std::vector<std::string> reports() const {
        std::vector<std::string> lines;
        for (const auto& each : log.reports()) lines.push_back(each.sentence + " " + std::to_string(each.count));
        return lines;
    }

    Date now{std::chrono::seconds(1'700'000'000)};
    ScopedDateSource dates{[this] { return now; }};
    ReportLog log;
};

TEST_F(ReportLogTest, CountsASentenceThatComesAgainWithinAMinute) {
    log.add("The disk is full.");
    log.add("The folder is gone.");
    now += 59s;
    log.add("The disk is full.");
    EXPECT_THAT(reports(), ElementsAre("The folder is gone. 1", "The disk is full. 2"));
    now += 59s;
    log.add("The disk is full.");
    log.add("The folder is gone.");
    EXPECT_THAT(reports(), ElementsAre("The folder is gone. 1", "The disk is full. 3", "The folder is gone. 1"));
    EXPECT_EQ(log.reports().back().time, now);
}

TEST_F(ReportLogTest, KeepsTheLastHundred) {
    for (int i = 1; i <= 250; ++i) log.add(std::to_string(i));
    ASSERT_EQ(log.reports().size(), 100U);
    EXPECT_EQ(log.reports().front().sentence, "151");
    EXPECT_EQ(log.reports().back().sentence, "250");
}

TEST_F(ReportLogTest, TellsOfEveryChange) {
    struct Listener {
        int heard = 0;
        void changed(ReportLogEvent& /*event*/) { ++heard; }
    } listener;
    const auto subscription = log.changedEvent.addObserver(&listener, &Listener::changed);
    log.add("a");
    log.add("a");
    log.clear();
    EXPECT_EQ(listener.heard, 3);
    EXPECT_TRUE(log.reports().empty());
}

}  // namespace
}  // namespace plume
