#include "input/BundleIdentifierResolver.h"

#include <gtest/gtest.h>

#include "ports/simulated/SimulatedProcessManager.h"

namespace plume {
namespace {

struct NameCase {
    const char* about;
    std::optional<std::u16string> bundleIdentifier;
    std::optional<std::u16string> localizedName;
    std::optional<std::u16string> answer;
};

TEST(BundleIdentifierResolver, PrefersTheIdentifierToTheName) {
    const NameCase cases[] = {
        {"both", u"org.example.editor", u"Editor", u"org.example.editor"},
        {"name alone", std::nullopt, u"wine.bin", u"wine.bin"},
        {"neither", std::nullopt, std::nullopt, std::nullopt},
    };
    SimulatedProcessManager processes;
    BundleIdentifierResolver resolver(processes);
    for (const NameCase& one : cases) {
        const auto process = processes.launch(one.bundleIdentifier, one.localizedName);
        EXPECT_EQ(resolver.getBundleIdentifier(process), one.answer) << one.about;
    }
}

TEST(BundleIdentifierResolver, RemembersWhatItKnowsAlsoOfProcessesThatAreGone) {
    SimulatedProcessManager processes;
    BundleIdentifierResolver resolver(processes);
    const auto editor = processes.launch(u"org.example.editor");
    const auto& first = resolver.getBundleIdentifier(editor);
    // The table grows past the first answer, which stays where it is.
    for (int i = 0; i < 100; ++i) resolver.getBundleIdentifier(processes.launch(u"org.example.other"));
    processes.terminate(editor);
    const int queries = processes.queries();
    EXPECT_EQ(&resolver.getBundleIdentifier(editor), &first);
    EXPECT_EQ(first, u"org.example.editor");
    EXPECT_EQ(processes.queries(), queries);
}

TEST(BundleIdentifierResolver, AsksAgainWhereItGotNoAnswer) {
    SimulatedProcessManager processes;
    BundleIdentifierResolver resolver(processes);
    const auto nameless = processes.launch(std::nullopt);
    resolver.getBundleIdentifier(nameless);
    resolver.getBundleIdentifier(nameless);
    EXPECT_EQ(processes.queries(), 2);
    EXPECT_FALSE(resolver.getBundleIdentifier(ProcessSerialNumber{}));
}

TEST(ProcessSerialNumbers, ArePackedWithTheHighHalfAbove) {
    for (const auto& [process, number] : {std::pair(ProcessSerialNumber{1, 2}, std::int64_t{0x1'0000'0002}),
                                          std::pair(ProcessSerialNumber{0xFFFFFFFF, 0xFFFFFFFF}, std::int64_t{-1}),
                                          std::pair(ProcessSerialNumber{}, std::int64_t{0})}) {
        EXPECT_EQ(BundleIdentifierResolver::processSerialNumberToNumber(process), number);
        EXPECT_EQ(BundleIdentifierResolver::numberToProcessSerialNumber(number), process);
    }
    EXPECT_EQ(BundleIdentifierResolver::numberToProcessSerialNumber(std::nullopt), ProcessSerialNumber{});
}

TEST(ForegroundApplication, IsWhoeverHasTheKeyboard) {
    SimulatedProcessManager processes;
    EXPECT_FALSE(foregroundApplication(processes));
    const auto editor = processes.launch(u"org.example.editor");
    processes.setFrontProcess(editor);
    EXPECT_EQ(foregroundApplication(processes).value().bundleIdentifier, u"org.example.editor");
    processes.terminate(editor);
    EXPECT_FALSE(foregroundApplication(processes));
}

}  // namespace
}  // namespace plume
