#include "content/scripts/ShellScriptRunner.h"

#include <gmock/gmock.h>
#include <sys/wait.h>

#include <cerrno>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <thread>

#include "Foundation/Strings.h"
#include "content/scripts/ScriptProcess.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume {
namespace {

namespace fs = std::filesystem;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using Seconds = std::chrono::duration<double>;

std::size_t openDescriptors() {
    return static_cast<std::size_t>(std::distance(fs::directory_iterator("/proc/self/fd"), {}));
}

// Whether the process is there and not merely waiting for somebody to note its end.
bool isAlive(pid_t pid) {
    std::ifstream stat("/proc/" + std::to_string(pid) + "/stat");
    std::string number;
    std::string name;
    std::string state;
    return (stat >> number >> name >> state) && state != "Z";
}

template <typename Condition>
bool becomesTrue(Condition condition) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::yield();
    }
    return true;
}

class ShellScriptRunnerTest : public testing::Test {
  protected:
    ShellScriptRunnerTest() {
        std::string pattern = "/tmp/PlumeTest-XXXXXX";
        folder_ = mkdtemp(pattern.data());
        setenv("TMPDIR", folder_.c_str(), 1);
        descriptorsBefore_ = openDescriptors();
        launcher_ = std::make_unique<PosixProcessLauncher>();
        setLimits({});
    }

    // Whatever a test did, nothing of it may stay behind.
    ~ShellScriptRunnerTest() override {
        runner_.reset();
        launcher_.reset();
        EXPECT_EQ(openDescriptors(), descriptorsBefore_);
        EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1) << "a child was not waited for";
        EXPECT_EQ(errno, ECHILD);
        EXPECT_TRUE(leftFiles().empty()) << leftFiles().front();
        unsetenv("TMPDIR");
        fs::remove_all(folder_);
    }

    void setLimits(ScriptLimits limits) {
        runner_ = std::make_unique<ShellScriptRunner>(
            *launcher_, [this](const std::string& sentence) { reports_.push_back(sentence); }, limits);
    }

    // "(nothing)" where there is no output.
    std::string run(std::string_view script) {
        const auto output = runner_->run(fromUtf8(script), false);
        return output ? toUtf8(*output) : "(nothing)";
    }

    std::vector<std::string> leftFiles() const {
        std::vector<std::string> files;
        for (const auto& entry : fs::recursive_directory_iterator(folder_)) {
            if (entry.path().filename().string().starts_with("Plume")) files.push_back(entry.path().string());
            if (entry.path().filename().string().starts_with("Stream")) files.push_back(entry.path().string());
        }
        return files;
    }

    std::string file(const std::string& name) const { return folder_ + "/" + name; }

    std::string folder_;
    std::size_t descriptorsBefore_ = 0;
    std::unique_ptr<PosixProcessLauncher> launcher_;
    std::unique_ptr<ShellScriptRunner> runner_;
    std::vector<std::string> reports_;
};

struct ScriptCase {
    const char* name;
    std::string script;
    std::string output;
};

TEST_F(ShellScriptRunnerTest, DeliversTheOutputOfScripts) {
    using namespace std::string_literals;
    const ScriptCase cases[] = {
        {"nothing at all", "", "(nothing)"},
        {"an empty line", "echo", ""},
        {"one line feed is taken off", "printf 'a\\n\\n'", "a\n"},
        {"no line feed at the end", "printf 'a\\nb'", "a\nb"},
        {"a here-document without an end", "cat <<END\nfirst", "first"},
        {"a backslash at the end", "echo a \\", "a"},
        {"any text", "echo 'naïve 日本語 😀 【】'", "naïve 日本語 😀 【】"},
        {"a NUL", "echo a\0b; echo c"s, "ab\nc"},
        {"errors alone", "echo oops >&2", "oops"},
        {"output and errors", "echo oops >&2; echo fine", "fine"},
        {"not UTF-8", "printf 'a\\377'", "(nothing)"},
        {"output not UTF-8, errors fine", "printf '\\377'; echo oops >&2", "(nothing)"},
        {"input is empty", "read x; echo \"[$x]\"; cat; wc -c", "[]\n0"},
        {"return", "echo a; return 3; echo b", "a"},
        {"its own redirection", "exec >/dev/null; echo gone", "(nothing)"},
        {"its own signals", "trap '' TERM; kill -TERM $$; echo alive; trap - TERM", "alive"},
        {"SIGPIPE is not ignored", "yes | head -n 1", "y"},
        {"slow output", "for i in 1 2 3 4; do printf $i; sleep 0.03; done; echo end", "1234end"},
        // In a process of their own.
        {"perl with an argument", "#!/usr/bin/perl -w\nmy $x; print 'a' . $x", "a"},
        {"python by name", "#!/usr/bin/env python3\nprint('é' * 3)", "ééé"},
        {"perl's input is empty", "#!/usr/bin/perl\nprint '[', <STDIN>, ']'", "[]"},
        {"output that closed early",
         "#!/usr/bin/perl\n$|=1; print 'a'; close STDOUT; close STDERR; select undef,undef,undef,0.05", "a"},
        {"perl killed", "#!/usr/bin/perl\n$|=1; print 'until then'; kill 9, $$", "until then"},
        {"slow perl", "#!/usr/bin/perl\n$|=1; for (1..4) { print; select undef,undef,undef,0.03 } print 'end'",
         "1234end"},
        // With bash, whatever /bin/sh is.
        {"an array", "#!/bin/bash\nwords=(one two); echo ${words[1]} ${#words[@]}", "two 2"},
        {"an option", "#!/bin/bash -e\n[[ abc == a* ]] && echo yes", "yes"},
        {"a blank after it", "#!/bin/bash \necho ${BASH_VERSION:+bash}", "bash"},
        {"a tab after it", "#!/bin/bash\t\necho ${BASH_VERSION:+bash}", "bash"},
        {"nothing but the line", "#!/bin/bash", "(nothing)"},
    };
    for (const ScriptCase& c : cases) EXPECT_EQ(run(c.script), c.output) << c.name;
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, TellsWhatCannotRunAndRepeatsNothingOfIt) {
    EXPECT_EQ(run("#!/no/such/interpreter\nsecret"), "(nothing)");
    EXPECT_THAT(reports_, ElementsAre(AllOf(HasSubstr("could not be run"), Not(HasSubstr("secret")))));
    if (fs::exists(AppleScriptRunner)) GTEST_SKIP() << "this system runs AppleScript";
    EXPECT_EQ(runner_->run(u"return 1", true), std::nullopt);
    EXPECT_EQ(runner_->run(u"return 2", true), std::nullopt);
    ASSERT_THAT(reports_, SizeIs(2)) << "AppleScript is told of once";
    EXPECT_THAT(reports_[1], HasSubstr("AppleScript"));
}

TEST_F(ShellScriptRunnerTest, TheSharedShellRemembers) {
    EXPECT_EQ(run("cd /usr/bin; name=value; greet() { echo \"hello $1\"; }; umask 027"), "(nothing)");
    EXPECT_EQ(run("pwd; echo $name; greet you; umask"), "/usr/bin\nvalue\nhello you\n0027");
    const std::string shell = run("echo $$");
    EXPECT_EQ(run("#!/bin/sh\necho $$"), shell);
    EXPECT_EQ(run("#!/bin/bashful\necho $$"), shell);
    EXPECT_EQ(run("#!/bin/bash\necho $$") == shell, fs::equivalent("/bin/sh", "/bin/bash"));
}

TEST_F(ShellScriptRunnerTest, AFaultyScriptTellsItsMessageAndTheShellGoesOn) {
    for (const char* faulty :
         {"no_such_command_here", "true\nif then", "echo 'unterminated", ": ${unset?is missing}"}) {
        run("name=value");
        const std::string message = run(faulty);
        EXPECT_TRUE(message.starts_with("/bin/sh: ")) << message;
        EXPECT_THAT(message, Not(HasSubstr("Plume"))) << "the file's name";
        EXPECT_EQ(run("echo $name"), "value") << faulty;
    }
    EXPECT_EQ(run("echo before\n)"), "before");
}

TEST_F(ShellScriptRunnerTest, ScriptsCannotDisturbHowTheNextOneIsRead) {
    for (const char* disturbance :
         {"alias command=false printf=false; alias .=false", "set -f; IFS=/; set -C", "set -v", "set -x", "exec >&-",
          "exec 0<&- 1>&- 2>&-", "trap 'echo trap' EXIT", "PATH=/nowhere", "command() { :; }", "printf() { :; }",
          "exec 3>/dev/null 4>/dev/null 9>/dev/null"}) {
        run(disturbance);
        EXPECT_EQ(run("echo fine"), "fine") << disturbance;
    }
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, AShellThatEndedIsStartedAgain) {
    const ScriptCase cases[] = {
        {"a trap at the exit", "trap 'echo b' EXIT; echo a; exit 3", "a\nb"},
        {"killed", "echo a; kill -9 $$; echo b", "a"},
        {"set -e", "set -e; echo a; false; echo b", "a"},
        {"replaced", "exec /usr/bin/printf a", "a"},
        {"its group killed", "echo a; kill -9 0", "a"},
    };
    for (const ScriptCase& c : cases) {
        run("left=yes");
        EXPECT_EQ(run(c.script), c.output) << c.name;
        EXPECT_EQ(run("echo ${left-no}"), "no") << c.name;
    }
    EXPECT_THAT(run("exec /no/such/program"), HasSubstr("/no/such/program"));
    const pid_t shell = std::stoi(run("echo $$"));
    kill(shell, SIGKILL);
    ASSERT_TRUE(becomesTrue([&] { return !isAlive(shell); }));
    EXPECT_EQ(run("echo again"), "again") << "killed between scripts";
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, DeliversTheWholeOutputAndRunsTheWholeScriptHoweverLong) {
    const auto expected = std::string().append(10'000'000, 'x');
    EXPECT_TRUE(run("head -c 10000000 /dev/zero | tr '\\0' x") == expected);
    EXPECT_TRUE(run("#!/usr/bin/perl\nprint 'x' x 10000000; print STDERR 'y' x 1000000") == expected);
    std::string script;
    for (int i = 0; i < 100'000; ++i) script += ": do nothing\n";
    EXPECT_EQ(run(script + "echo end"), "end");
}

TEST_F(ShellScriptRunnerTest, WhatRunsInTheBackgroundIsNotWaitedFor) {
    const auto start = std::chrono::steady_clock::now();
    const pid_t first = std::stoi(run("sleep 60 & echo $!"));
    const pid_t second =
        std::stoi(run("#!/usr/bin/perl\n$|=1; my $pid = fork; if (!$pid) { sleep 60; exit } print $pid"));
    EXPECT_LT(Seconds(std::chrono::steady_clock::now() - start).count(), 10);
    runner_.reset();
    EXPECT_TRUE(isAlive(first)) << "went away with the runner";
    EXPECT_TRUE(isAlive(second)) << "went away with its parent";
    kill(first, SIGKILL);
    kill(second, SIGKILL);
}

TEST_F(ShellScriptRunnerTest, LateOutputOfOneScriptIsNotDeliveredByAnother) {
    EXPECT_EQ(run("cd \"$TMPDIR\" && mkfifo gate && echo made"), "made");
    EXPECT_EQ(run("(read x <gate; echo late; echo late >&2) & echo one"), "one");
    EXPECT_EQ(run("echo go >gate; echo two"), "two");
    EXPECT_EQ(run("wait; echo three"), "three");
}

TEST_F(ShellScriptRunnerTest, AScriptThatNeverEndsIsEndedWithItsChildren) {
    setLimits({.time = 0.3});
    const char* const scripts[] = {
        "sleep 60 & echo $!; wait",
        "#!/usr/bin/perl\n$|=1; my $pid = fork; if (!$pid) { sleep 60; exit } print \"$pid\\n\"; sleep 60",
        "#!/usr/bin/perl\n$|=1; $SIG{TERM}=$SIG{INT}=$SIG{HUP}='IGNORE'; print \"$$\\n\"; sleep 60",
        "set -n",
        "kill -STOP $$",
    };
    for (const char* script : scripts) {
        reports_.clear();
        const std::string output = run(script);
        ASSERT_THAT(reports_, SizeIs(1)) << script;
        EXPECT_THAT(reports_[0], HasSubstr("longer than"));
        if (output != "(nothing)") {
            const pid_t child = std::stoi(output);
            EXPECT_TRUE(becomesTrue([&] { return !isAlive(child); })) << script;
        }
        EXPECT_EQ(run("echo next"), "next") << script;
    }
    EXPECT_THAT(leftFiles(), ElementsAre(HasSubstr("/Plume-"))) << "files of ended scripts stayed";
}

TEST_F(ShellScriptRunnerTest, AScriptThatWritesWithoutEndIsEnded) {
    setLimits({.time = 30, .output = 1'000'000});
    for (const char* script : {"yes", "yes >&2", "#!/usr/bin/perl\nprint 'x' x 1000 while 1"}) {
        reports_.clear();
        EXPECT_EQ(run(script), "(nothing)") << script;
        ASSERT_THAT(reports_, SizeIs(1));
        EXPECT_THAT(reports_[0], HasSubstr("more than 1 million"));
    }
    // In the background it may have reached the limit or not when the script ends; nobody waits for it either way.
    run("yes & echo started");
    EXPECT_EQ(run("echo next"), "next");
}

TEST_F(ShellScriptRunnerTest, FilesArePrivateAndStandWhereverTheyCan) {
    EXPECT_EQ(run("cd \"$TMPDIR\" && stat -c %a Plume-* Plume-*/*"), "700\n600\n600\n600");
    const std::string ownFile =
        "#!/usr/bin/perl\nprintf '%o %s', (stat $0)[2] & 07777, $0 =~ m{/Plume[^/]*$} ? 'yes' : $0";
    EXPECT_EQ(run(ownFile), "700 yes");
    EXPECT_THAT(leftFiles(), SizeIs(1)) << "only the folder may stay";

    for (const std::string& path : leftFiles()) fs::remove_all(path);
    EXPECT_EQ(run("echo again"), "again") << "the folder was cleaned away";
    EXPECT_EQ(run(ownFile), "700 yes");

    const std::string odd = file("it's \"odd\" $HOME `x`");
    fs::create_directory(odd);
    setenv("TMPDIR", odd.c_str(), 1);
    runner_.reset();
    launcher_ = std::make_unique<PosixProcessLauncher>();
    setLimits({});
    EXPECT_EQ(run("echo fine"), "fine");
    EXPECT_EQ(run(ownFile), "700 yes");
    EXPECT_TRUE(run("no_such_command_here").starts_with("/bin/sh: "));
}

TEST_F(ShellScriptRunnerTest, SharesTheShellAmongThreads) {
    constexpr int Rounds = 25;
    const auto work = [&](const std::string& name) {
        for (int i = 0; i < Rounds; ++i) {
            const std::string expected = name + std::to_string(i);
            EXPECT_EQ(run("value=" + expected + "; : | :; echo $value"), expected);
            if (i % 10 != 0) continue;
            EXPECT_EQ(run("#!/usr/bin/perl\nprint '" + expected + "'"), expected);
        }
    };
    std::thread first(work, "a");
    std::thread second(work, "b");
    first.join();
    second.join();
}

TEST_F(ShellScriptRunnerTest, StopsWhatRunsOnAnotherThread) {
    const std::string shellStarted = file("shell");
    const std::string perlStarted = file("perl");
    std::thread shell([&] { EXPECT_EQ(run("echo a; : >'" + shellStarted + "'; sleep 60"), "(nothing)"); });
    std::thread waiting([&] { EXPECT_EQ(run("sleep 60"), "(nothing)"); });
    std::thread perl(
        [&] { EXPECT_EQ(run("#!/usr/bin/perl\nopen F, '>', '" + perlStarted + "'; close F; sleep 60"), "(nothing)"); });
    EXPECT_TRUE(becomesTrue([&] { return fs::exists(perlStarted); }));
    runner_->stop();
    shell.join();
    waiting.join();
    perl.join();
    EXPECT_EQ(run("echo no more"), "(nothing)");
    EXPECT_THAT(reports_, IsEmpty());
}

// ---- Preparing ----

TEST_F(ShellScriptRunnerTest, PreparesAFileForAScriptThatIsText) {
    const struct {
        const char* script;
        bool isAppleScript;
        const char* content;
    } cases[] = {
        {"echo hi", false, "#!/bin/sh\necho hi"},
        {"#!/usr/bin/perl\nprint 1", false, "#!/usr/bin/perl\nprint 1\n"},
        {"#!/usr/bin/perl\n", false, "#!/usr/bin/perl\n"},
        {"beep", true, "beep"},
        {"~", false, "#!/bin/sh\n~"},
        {"/no/such/file", false, "#!/bin/sh\n/no/such/file"},
        {"/tmp", false, "#!/bin/sh\n/tmp"},
    };
    for (const auto& c : cases) {
        const auto task = newTaskForScript(c.script, c.isAppleScript, *launcher_);
        ASSERT_TRUE(task);
        ASSERT_TRUE(task.value().file);
        const std::string path = task.value().file->path();
        std::ifstream stream(path);
        const std::string content((std::istreambuf_iterator<char>(stream)), {});
        EXPECT_EQ(content, c.content);
        EXPECT_EQ((fs::status(path).permissions() & fs::perms::owner_exec) != fs::perms::none, !c.isAppleScript);
        EXPECT_EQ(task.value().request.program, c.isAppleScript ? AppleScriptRunner : path);
        EXPECT_THAT(task.value().request.arguments, SizeIs(c.isAppleScript ? 1 : 0));
    }
}

TEST_F(ShellScriptRunnerTest, PreparesAnExistingFileForTheDefaultInterpreter) {
    const std::string path = file("script.pl");
    std::ofstream(path) << "#!/usr/bin/perl\nprint 1";
    const char* const homeBefore = std::getenv("HOME");
    const std::string home = homeBefore ? homeBefore : "/";
    setenv("HOME", folder_.c_str(), 1);
    for (const std::string& script : {path, std::string("~/script.pl")}) {
        for (const bool isAppleScript : {false, true}) {
            const auto task = newTaskForScript(script, isAppleScript, *launcher_);
            ASSERT_TRUE(task);
            EXPECT_EQ(task.value().request.program, isAppleScript ? AppleScriptRunner : "/bin/sh");
            EXPECT_THAT(task.value().request.arguments, ElementsAre(path));
            EXPECT_FALSE(task.value().file);
        }
    }
    setenv("HOME", home.c_str(), 1);
    EXPECT_TRUE(fs::exists(path));
}

}  // namespace
}  // namespace plume
