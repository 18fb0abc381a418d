// Records through the archive that libraries are kept in.
#include "library/LibraryArchive.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "tests/Foundation/archive/ArchiveTestSupport.h"
#include "tests/library/LibrarySupport.h"
#include "tests/support/MemoryCoder.h"

namespace plume {
namespace {

using Text = std::optional<std::u16string>;

// Any units, unpaired surrogates and zeros among them.
std::u16string randomText() {
    const auto units = *rc::gen::container<std::vector<char16_t>>(
        rc::gen::oneOf(rc::gen::arbitrary<char16_t>(), rc::gen::inRange<char16_t>(u' ', u'~')));
    return {units.begin(), units.end()};
}

Text randomNil() {
    return *rc::gen::inRange(0, 4) == 0 ? Text() : Text(randomText());
}

template <typename Enumeration>
Enumeration randomCode() {
    return static_cast<Enumeration>(*rc::gen::inRange(-2, 6));
}

// Archives hold Return for a line feed, so none is in a random set.
std::optional<CharacterSet> randomSet() {
    if (*rc::gen::inRange(0, 2) == 0) return std::nullopt;
    return CharacterSet::withCharacters(randomText()).subtracting(CharacterSet::withCharacters(u"\n"));
}

AttributedString randomContent() {
    AttributedString content(randomText());
    content.append(randomText(), *rc::gen::inRange(0, 2) == 0 ? test::bold() : nullptr);
    return content;
}

std::shared_ptr<Snippet> randomSnippet() {
    auto snippet = std::make_shared<Snippet>(randomNil(), std::nullopt);
    snippet->setContentType(randomCode<ContentType>());
    if (*rc::gen::inRange(0, 4) != 0) snippet->setRichTextContent(randomContent());
    snippet->setCaseSensitivity(randomCode<CaseSensitivity>());
    snippet->setLabel(randomNil());
    snippet->setNote(randomNil());
    return snippet;
}

std::shared_ptr<SnippetGroup> randomGroup() {
    auto group = SnippetGroup::make();
    group->setName(randomNil());
    group->setAbbreviationPrefix(randomNil());
    group->setExpandAfter(randomCode<ExpandAfter>());
    group->setExpandTrigger(randomCode<ExpandTrigger>());
    group->setExpandAfterDelimiters(randomSet());
    group->setDelimiters(randomSet());
    group->setShowInMenuBar(*rc::gen::arbitrary<bool>());
    group->setSuggestAbbreviations(*rc::gen::arbitrary<bool>());
    group->setResetFormatting(*rc::gen::arbitrary<bool>());
    group->availability() = {*rc::gen::inRange(-1, 4), {{randomText(), randomText()}}, *rc::gen::inRange(-1, 4), {}};
    for (int i = *rc::gen::inRange(0, 5); i > 0; --i) group->addItem(randomSnippet());
    return group;
}

std::vector<test::MemoryArchive> valuesOf(const SnippetGroups& groups) {
    std::vector<test::MemoryArchive> values;
    for (const auto& group : groups) values.push_back(test::MemoryEncoder::encode(*group));
    return values;
}

RC_GTEST_PROP(LibraryArchiveProperty, EveryFieldOfEveryRecordComesBack, ()) {
    LibraryContents written;
    for (int i = *rc::gen::inRange(0, 4); i > 0; --i) written.snippetGroups.push_back(randomGroup());
    written.uuidString = randomNil();
    written.dateInstalled = currentDate();
    const auto read = readLibraryArchive(libraryArchive(written), {});
    RC_ASSERT(read.ok());
    RC_ASSERT(valuesOf(read.value().snippetGroups) == valuesOf(written.snippetGroups));
    RC_ASSERT(read.value().uuidString == written.uuidString);
    RC_ASSERT(read.value().dateInstalled == written.dateInstalled);
}

TEST(LibraryArchive, KeepsTheLayoutOfItsPlatform) {
    LibraryContents library;
    library.snippetGroups = {test::fullGroup(), SnippetGroup::make()};
    library.snippetGroups[1]->addItem(library.snippetGroups[0]->items()[0]);
    library.uuidString = u"identity";
    library.preferences = PropertyList::Dictionary{{"LongTextLength", std::int64_t{200}}, {"UseClipboard", true}};
    const std::string bytes = libraryArchive(library);
    const test::ScriptFolder folder("archives.py");
    folder.write("ours.archive", bytes);
    EXPECT_TRUE(folder.run("check"));
    const auto read = readLibraryArchive(bytes, {});
    ASSERT_TRUE(read) << read.error().message;
    const SnippetGroups& groups = read.value().snippetGroups;
    EXPECT_EQ(groups[0]->items()[0], groups[1]->items()[0]);
    EXPECT_EQ(read.value().preferences, library.preferences);
    EXPECT_FALSE(readLibraryArchive(bytes.substr(0, bytes.size() / 2), {}));
}

}  // namespace
}  // namespace plume
