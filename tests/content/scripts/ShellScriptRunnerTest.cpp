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
    std::string number, name, state;
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
        {"a command", "echo hi", "hi"},
        {"nothing at all", "", "(nothing)"},
        {"no output", "true", "(nothing)"},
        {"an empty line", "echo", ""},
        {"one line feed is taken off", "printf 'a\\n\\n'", "a\n"},
        {"no line feed at the end", "printf 'a\\nb'", "a\nb"},
        {"several lines", "for i in 1 2 3\ndo\n  echo $i\ndone\n", "1\n2\n3"},
        {"a here-document", "cat <<END\nfirst\n'second' \"$((1+1))\"\nEND", "first\n'second' \"2\""},
        {"a here-document without an end", "cat <<END\nfirst", "first"},
        {"a backslash at the end", "echo a \\", "a"},
        {"a comment at the end", "echo a # and no more", "a"},
        {"any text", "echo 'naïve 日本語 😀 【】'", "naïve 日本語 😀 【】"},
        {"a NUL", "echo a\0b; echo c"s, "ab\nc"},
        {"an interpreter line for sh", "#!/bin/sh\necho sh", "sh"},
        {"an interpreter line for bash", "#!/bin/bash -e\necho bash", "bash"},
        {"errors alone", "echo oops >&2", "oops"},
        {"output and errors", "echo oops >&2; echo fine", "fine"},
        {"an unknown command", "no_such_command_here", "/bin/sh: 1: no_such_command_here: not found"},
        {"not UTF-8", "printf 'a\\377'", "(nothing)"},
        {"output not UTF-8, errors fine", "printf '\\377'; echo oops >&2", "(nothing)"},
        {"input is empty", "read x; echo \"[$x]\"; cat; wc -c", "[]\n0"},
        {"return", "echo a; return 3; echo b", "a"},
        {"a failing command", "false; echo $?", "1"},
        {"its own redirection", "exec >/dev/null; echo gone", "(nothing)"},
        {"its own signals", "trap '' TERM; kill -TERM $$; echo alive; trap - TERM", "alive"},
        {"SIGPIPE is not ignored", "yes | head -n 1", "y"},
    };
    for (const ScriptCase& c : cases) EXPECT_EQ(run(c.script), c.output) << c.name;
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, RunsOtherInterpretersInAProcessOfTheirOwn) {
    const ScriptCase cases[] = {
        {"perl", "#!/usr/bin/perl\nprint 6 * 7, \"\\n\";", "42"},
        {"perl with an argument", "#!/usr/bin/perl -w\nmy $x; print 'a' . $x", "a"},
        {"python by name", "#!/usr/bin/env python3\nprint('é' * 3)", "ééé"},
        {"input is empty", "#!/usr/bin/python3\nimport sys\nprint(repr(sys.stdin.read()))", "''"},
        {"errors alone", "#!/usr/bin/perl\nprint STDERR 'oops'", "oops"},
        {"output and errors", "#!/usr/bin/perl\nprint STDERR 'oops'; print 'fine'", "fine"},
        {"no output", "#!/usr/bin/perl", "(nothing)"},
        {"output that closed early",
         "#!/usr/bin/perl\n$|=1; print 'a'; close STDOUT; close STDERR; select undef,undef,undef,0.05", "a"},
        {"killed", "#!/usr/bin/perl\n$|=1; print 'until then'; kill 9, $$", "until then"},
    };
    for (const ScriptCase& c : cases) EXPECT_EQ(run(c.script), c.output) << c.name;
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, TellsWhenAnInterpreterIsMissing) {
    EXPECT_EQ(run("#!/no/such/interpreter\nsecret"), "(nothing)");
    ASSERT_THAT(reports_, SizeIs(1));
    EXPECT_THAT(reports_[0], HasSubstr("could not be run"));
    EXPECT_THAT(reports_[0], Not(HasSubstr("secret")));
}

TEST_F(ShellScriptRunnerTest, TellsOnceThatThereIsNoAppleScript) {
    if (fs::exists(AppleScriptRunner)) GTEST_SKIP() << "this system runs AppleScript";
    EXPECT_EQ(runner_->run(u"return 1", true), std::nullopt);
    EXPECT_EQ(runner_->run(u"return 2", true), std::nullopt);
    ASSERT_THAT(reports_, SizeIs(1));
    EXPECT_THAT(reports_[0], HasSubstr("AppleScript"));
}

TEST_F(ShellScriptRunnerTest, TheSharedShellRemembers) {
    EXPECT_EQ(run("cd /usr/bin; name=value; greet() { echo \"hello $1\"; }; umask 027"), "(nothing)");
    EXPECT_EQ(run("pwd; echo $name; greet you; umask"), "/usr/bin\nvalue\nhello you\n0027");
    const std::string shell = run("echo $$");
    EXPECT_EQ(run("#!/bin/sh\necho $$"), shell);
    EXPECT_EQ(run("#!/bin/bashful\necho $$"), shell);
    EXPECT_EQ(run("#!/bin/bash\necho $$") == shell, fs::equivalent("/bin/sh", "/bin/bash"));
}

TEST_F(ShellScriptRunnerTest, BashScriptsSpeakBash) {
    const ScriptCase cases[] = {
        {"an array", "#!/bin/bash\nwords=(one two); echo ${words[1]} ${#words[@]}", "two 2"},
        {"a condition", "#!/bin/bash\n[[ abc == a* ]] && echo yes", "yes"},
        {"an option", "#!/bin/bash -e\n[[ abc == a* ]] && echo yes", "yes"},
        {"a blank after it", "#!/bin/bash \necho ${BASH_VERSION:+bash}", "bash"},
        {"a tab after it", "#!/bin/bash\t\necho ${BASH_VERSION:+bash}", "bash"},
        {"input is empty", "#!/bin/bash\ncat; echo end", "end"},
    };
    for (const ScriptCase& c : cases) EXPECT_EQ(run(c.script), c.output) << c.name;
    EXPECT_EQ(run("#!/bin/bash"), "(nothing)");
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, ASyntaxErrorTellsItsMessageAndTheShellGoesOn) {
    EXPECT_EQ(run("name=value"), "(nothing)");
    EXPECT_EQ(run("true\nif then"), "/bin/sh: 2: Syntax error: \"then\" unexpected");
    EXPECT_THAT(run("echo 'unterminated"), HasSubstr("Syntax error: Unterminated quoted string"));
    EXPECT_EQ(run("echo before\n)"), "before");
    EXPECT_EQ(run("echo $name"), "value");
    EXPECT_EQ(run(": ${unset?is missing}; echo no"), "/bin/sh: 1: unset: is missing");
    EXPECT_EQ(run("echo $name"), "value");
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
        {"exit", "echo a; exit 3", "a"},
        {"a trap at the exit", "trap 'echo b' EXIT; echo a; exit", "a\nb"},
        {"killed", "echo a; kill -9 $$; echo b", "a"},
        {"set -e", "set -e; echo a; false; echo b", "a"},
        {"replaced", "exec /usr/bin/printf a", "a"},
        {"a replacement that is not there", "exec /no/such/program", "/bin/sh: 1: exec: /no/such/program: not found"},
        {"its group killed", "echo a; kill -9 0", "a"},
    };
    for (const ScriptCase& c : cases) {
        run("left=yes");
        EXPECT_EQ(run(c.script), c.output) << c.name;
        EXPECT_EQ(run("echo ${left-no}"), "no") << c.name;
    }
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(ShellScriptRunnerTest, AShellKilledBetweenScriptsIsStartedAgain) {
    const pid_t shell = std::stoi(run("echo $$"));
    kill(shell, SIGKILL);
    ASSERT_TRUE(becomesTrue([&] { return !isAlive(shell); }));
    EXPECT_EQ(run("echo again"), "again");
}

TEST_F(ShellScriptRunnerTest, DeliversTheWholeOutputHoweverLong) {
    constexpr std::size_t Length = 10'000'000;
    const auto shared = runner_->run(u"head -c 10000000 /dev/zero | tr '\\0' x", false);
    ASSERT_TRUE(shared);
    EXPECT_TRUE(*shared == std::u16string(Length, u'x'));
    const auto own = runner_->run(u"#!/usr/bin/perl\nprint 'x' x 10000000; print STDERR 'y' x 1000000", false);
    ASSERT_TRUE(own);
    EXPECT_TRUE(*own == std::u16string(Length, u'x'));
}

TEST_F(ShellScriptRunnerTest, DeliversTheWholeOutputHoweverSlow) {
    EXPECT_EQ(run("for i in 1 2 3 4; do printf $i; sleep 0.03; done; echo end"), "1234end");
    EXPECT_EQ(run("#!/usr/bin/perl\n$|=1; for (1..4) { print; select undef,undef,undef,0.03 } print 'end'"), "1234end");
}

TEST_F(ShellScriptRunnerTest, RunsALongScript) {
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
        "sh -c 'echo $$; exec sleep 60'",
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

TEST_F(ShellScriptRunnerTest, FilesArePrivateAndNamedAfterPlume) {
    EXPECT_EQ(run("cd \"$TMPDIR\" && stat -c %a Plume-* Plume-*/*"), "700\n600\n600\n600");
    EXPECT_THAT(run("ls \"$TMPDIR\"/Plume-*"), HasSubstr("Plume"));
    EXPECT_EQ(run("#!/usr/bin/perl\nprintf '%o %s', (stat $0)[2] & 07777, $0 =~ m{/Plume[^/]*$} ? 'yes' : $0"),
              "700 yes");
    EXPECT_THAT(leftFiles(), SizeIs(1)) << "only the folder may stay";
}

TEST_F(ShellScriptRunnerTest, AFolderThatWasCleanedAwayIsMadeAgain) {
    EXPECT_EQ(run("echo one"), "one");
    for (const std::string& path : leftFiles()) fs::remove_all(path);
    EXPECT_EQ(run("echo two"), "two");
    EXPECT_EQ(run("#!/usr/bin/perl\nprint 'three'"), "three");
}

TEST_F(ShellScriptRunnerTest, PathsWithOddCharactersWork) {
    const std::string odd = file("it's \"odd\" $HOME `x`");
    fs::create_directory(odd);
    setenv("TMPDIR", odd.c_str(), 1);
    EXPECT_EQ(run("echo fine"), "fine");
    EXPECT_EQ(run("#!/usr/bin/perl\nprint 'fine'"), "fine");
    EXPECT_EQ(run("no_such_command_here"), "/bin/sh: 1: no_such_command_here: not found");
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
    std::thread first(work, "a"), second(work, "b");
    first.join();
    second.join();
}

TEST_F(ShellScriptRunnerTest, StopsWhatRunsOnAnotherThread) {
    const std::string shellStarted = file("shell"), perlStarted = file("perl");
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
    struct Case {
        const char* script;
        bool isAppleScript;
        const char* content;
    };
    const Case cases[] = {
        {"echo hi", false, "#!/bin/sh\necho hi"},
        {"#!/usr/bin/perl\nprint 1", false, "#!/usr/bin/perl\nprint 1\n"},
        {"#!/usr/bin/perl\n", false, "#!/usr/bin/perl\n"},
        {"beep", true, "beep"},
        {"~", false, "#!/bin/sh\n~"},
        {"/no/such/file", false, "#!/bin/sh\n/no/such/file"},
        {"/tmp", false, "#!/bin/sh\n/tmp"},
    };
    for (const Case& c : cases) {
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
        const auto shell = newTaskForScript(script, false, *launcher_);
        ASSERT_TRUE(shell);
        EXPECT_EQ(shell.value().request.program, "/bin/sh");
        EXPECT_THAT(shell.value().request.arguments, ElementsAre(path));
        EXPECT_FALSE(shell.value().file);
        const auto apple = newTaskForScript(script, true, *launcher_);
        ASSERT_TRUE(apple);
        EXPECT_EQ(apple.value().request.program, AppleScriptRunner);
        EXPECT_THAT(apple.value().request.arguments, ElementsAre(path));
    }
    setenv("HOME", home.c_str(), 1);
    EXPECT_TRUE(fs::exists(path));
}

}  // namespace
}  // namespace plume
