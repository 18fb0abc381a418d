// What one Plume asks of another arrives whole and is answered; visitors who behave badly harm nobody.
#include "app/session/CommandSocket.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>

#include <cstring>
#include <fstream>
#include <thread>

#include "ports/posix/PollRunLoop.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class CommandSocketTest : public testing::Test {
  protected:
    CommandSocketTest() {
        auto opened = open();
        if (opened) socket_ = std::move(opened).value();
    }
    Result<std::unique_ptr<CommandSocket>> open() {
        return CommandSocket::open(path_, loop_, [this](const CommandRequest& request) {
            requests_.push_back(request);
            return reply_;
        });
    }
    // What the running Plume answers to one that asks from another process.
    Result<std::optional<CommandReply>> ask(const CommandRequest& request) {
        std::optional<Result<std::optional<CommandReply>>> answer;
        std::thread other([&] {
            answer = handOver(path_, request);
            loop_.stop();
        });
        loop_.run();
        other.join();
        return *answer;
    }
    // A visitor who knows nothing of the manners here.
    FileDescriptor visit() const {
        FileDescriptor visitor(::socket(AF_UNIX, SOCK_STREAM, 0));
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::strncpy(address.sun_path, path_.c_str(), sizeof address.sun_path - 1);
        EXPECT_EQ(connect(visitor.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
        return visitor;
    }

    TemporaryFolder folder_;
    const std::filesystem::path path_ = folder_.path() / "plume.socket";
    PollRunLoop loop_;
    std::vector<CommandRequest> requests_;
    CommandReply reply_{3, "done\n", "but\n"};
    std::unique_ptr<CommandSocket> socket_;
};

}  // namespace

TEST_F(CommandSocketTest, CarriesARequestAndItsReply) {
    reply_.output = std::string(3'000'000, 'x') + "ü";
    const auto answer = ask({"/home/ann", {"add", "", "Grüße 😀\nzweite"}});
    ASSERT_TRUE(answer);
    ASSERT_TRUE(answer.value());
    EXPECT_EQ(answer.value()->status, 3);
    EXPECT_EQ(answer.value()->output, reply_.output);
    EXPECT_EQ(answer.value()->error, "but\n");
    ASSERT_EQ(requests_.size(), 1U);
    EXPECT_EQ(requests_.front().folder, "/home/ann");
    EXPECT_THAT(requests_.front().arguments, ElementsAre("add", "", "Grüße 😀\nzweite"));
}

TEST_F(CommandSocketTest, OnlyTheUserCanOpenIt) {
    struct stat status {};
    ASSERT_EQ(stat(path_.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600U);
}

TEST_F(CommandSocketTest, WhereNobodyListensNothingIsAnswered) {
    socket_ = nullptr;
    EXPECT_FALSE(std::filesystem::exists(path_));
    const auto answer = handOver(path_, {"/", {"toggle"}});
    ASSERT_TRUE(answer);
    EXPECT_FALSE(answer.value());
}

TEST_F(CommandSocketTest, TakesThePlaceOfOneThatWasLeftBehind) {
    socket_ = nullptr;
    std::ofstream(path_) << "left behind";
    auto again = open();
    ASSERT_TRUE(again) << again.error().message;
    socket_ = std::move(again).value();
    EXPECT_TRUE(ask({"/", {"toggle"}}).value());
}

TEST_F(CommandSocketTest, DropsVisitorsWhoSayTooMuchOrNothing) {
    FileDescriptor silent = visit();
    FileDescriptor gone = visit();
    gone.close();
    FileDescriptor endless = visit();
    std::thread talker([&endless] {
        const std::string much(100'000, 'a');
        while (send(endless.get(), much.data(), much.size(), MSG_NOSIGNAL) > 0) {
        }
    });
    // Meanwhile others are served.
    EXPECT_TRUE(ask({"/", {"toggle"}}).value());
    const Timer end = loop_.performAfterDelay(1.2, [this] { loop_.stop(); });
    loop_.run();
    talker.join();
    char byte = 0;
    EXPECT_EQ(recv(silent.get(), &byte, 1, 0), 0);
    EXPECT_EQ(requests_.size(), 1U);
}

TEST_F(CommandSocketTest, RefusesAPathThatIsTooLong) {
    const auto opened = CommandSocket::open(folder_.path() / std::string(200, 'x'), loop_, {});
    ASSERT_FALSE(opened);
    EXPECT_THAT(opened.error().message, HasSubstr("too long"));
}

}  // namespace plume
