#include "library/SnippetGroup.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using test::snippet;
using testing::ElementsAre;
using testing::IsEmpty;

// Writes down what it is told.
class Listener final : public SnippetGroupObserver {
  public:
    void abbreviationChanged(SnippetGroup& group, Snippet& snippet, const Snippet::Text& previous) override {
        EXPECT_EQ(snippet.parentGroup().get(), &group);
        heard.push_back("abbreviation " + toUtf8(previous.value_or(u"(nil)")) + " " +
                        toUtf8(snippet.abbreviation().value_or(u"(nil)")));
    }
    void itemsAdded(SnippetGroup& group, std::size_t first, std::size_t count) override {
        EXPECT_LE(first + count, group.items().size());
        heard.push_back("added " + std::to_string(first) + "+" + std::to_string(count));
        if (whenAdded) whenAdded();
    }
    void itemRemoved(SnippetGroup&, Snippet& snippet, std::size_t index) override {
        heard.push_back("removed " + toUtf8(*snippet.abbreviation()) + " " + std::to_string(index));
    }
    void matchingSettingsChanged(SnippetGroup&) override { heard.emplace_back("settings"); }

    std::function<void()> whenAdded;
    std::vector<std::string> take() { return std::exchange(heard, {}); }

    std::vector<std::string> heard;
};

std::vector<std::string> abbreviationsOf(const SnippetGroup& group) {
    std::vector<std::string> result;
    for (const auto& item : group.items()) result.push_back(toUtf8(item->abbreviation().value_or(u"(nil)")));
    return result;
}

class SnippetGroupTest : public testing::Test {
  protected:
    SnippetGroupTest() { group->addGroupObserver(&listener); }

    std::shared_ptr<SnippetGroup> group = SnippetGroup::make();
    Listener listener;
};

TEST_F(SnippetGroupTest, ListsItsItemsInUserOrder) {
    const auto b = snippet(u"b");
    group->addItem(b);
    group->addItems({snippet(u"c"), snippet(u"d")});
    group->insertItem(snippet(u"a"), 0);
    group->insertItem(snippet(u"e"), 99);
    group->removeItem(b);
    EXPECT_THAT(abbreviationsOf(*group), ElementsAre("a", "c", "d", "e"));
    EXPECT_THAT(listener.take(), ElementsAre("added 0+1", "added 1+2", "added 0+1", "added 4+1", "removed b 1"));
    for (const auto& item : group->items()) EXPECT_EQ(item->parentGroup(), group);
    EXPECT_EQ(b->parentGroup(), nullptr);
    group->addItems({});
    group->addItems({nullptr});
    group->insertItem(nullptr, 0);
    group->removeItem(nullptr);
    group->removeItem(b);
    EXPECT_THAT(listener.take(), IsEmpty());
}

TEST_F(SnippetGroupTest, CanAddItsOwnItemsAndRemoveAnItemByItsOwnReference) {
    group->addItems({snippet(u"a"), snippet(u"b")});
    group->addItems(group->items());
    EXPECT_THAT(abbreviationsOf(*group), ElementsAre("a", "b", "a", "b"));
    listener.take();
    group->removeItem(group->items().front());
    EXPECT_THAT(abbreviationsOf(*group), ElementsAre("b", "b")) << "a removed snippet is not listed any more";
    EXPECT_THAT(listener.take(), ElementsAre("removed a 0", "removed a 1"));
}

TEST_F(SnippetGroupTest, AnItemMovedAwayKeepsItsNewGroup) {
    const auto to = SnippetGroup::make();
    const auto item = snippet(u"a");
    group->addItem(item);
    to->addItem(item);
    group->removeItem(item);
    EXPECT_EQ(item->parentGroup(), to);
}

TEST_F(SnippetGroupTest, TellsOfRealChangesOfAbbreviations) {
    const auto item = snippet(u"a");
    group->addItem(item);
    listener.take();
    item->setAbbreviation(u"a");
    const auto copy = item->copySnippet();
    EXPECT_THAT(listener.take(), IsEmpty());
    item->setAbbreviation(u"A");
    item->setAbbreviation(std::nullopt);
    item->setAbbreviation(u"");
    EXPECT_THAT(listener.take(), ElementsAre("abbreviation a A", "abbreviation A (nil)", "abbreviation (nil) "));
    group->removeItem(item);
    listener.take();
    item->setAbbreviation(u"b");
    EXPECT_THAT(listener.take(), IsEmpty());
}

TEST_F(SnippetGroupTest, TellsOfRealChangesOfMatchingSettings) {
    for (const bool changes : {true, false}) {
        group->setAbbreviationPrefix(u";");
        group->setExpandTrigger(ExpandTrigger::DelimiterKept);
        group->setDelimiters(CharacterSet::withCharacters(u"."));
        EXPECT_EQ(listener.take().size(), changes ? 3U : 0U);
    }
    group->setName(u"name");
    group->setShowInMenuBar(false);
    EXPECT_THAT(listener.take(), IsEmpty());
    for (const bool changes : {true, false}) {
        group->copySettingsFromGroup(*test::fullGroup());
        EXPECT_EQ(listener.take().size(), changes ? 1U : 0U);
    }
}

TEST_F(SnippetGroupTest, ObserversMayLeaveWhileTheyAreTold) {
    Listener goes;
    Listener stays;
    group->addGroupObserver(&goes);
    group->addGroupObserver(&stays);
    listener.whenAdded = [&] {
        group->removeGroupObserver(&listener);
        group->removeGroupObserver(&goes);
    };
    for (int i = 0; i < 2; ++i) group->addItem(snippet(u"a"));
    EXPECT_THAT(listener.take(), ElementsAre("added 0+1"));
    EXPECT_THAT(goes.take(), IsEmpty());
    EXPECT_THAT(stays.take(), ElementsAre("added 0+1", "added 1+1"));
}

TEST_F(SnippetGroupTest, CopyingSettingsLeavesIdentityNamePrefixAndItems) {
    const auto source = test::fullGroup();
    group->setName(u"Mine");
    const auto uuid = group->uuid();
    group->copySettingsFromGroup(*source);
    EXPECT_EQ(test::settingsOf(*group), test::settingsOf(*source));
    EXPECT_EQ(group->uuid(), uuid);
    EXPECT_EQ(group->name(), u"Mine");
    EXPECT_EQ(group->abbreviationPrefix(), std::nullopt);
    EXPECT_TRUE(group->items().empty());
}

TEST_F(SnippetGroupTest, DuplicatesWithAndWithoutItems) {
    const auto source = test::fullGroup();
    const auto copy = source->copySnippetGroup(true);
    EXPECT_EQ(test::fieldsOf(*copy), test::fieldsOf(*source));
    EXPECT_NE(copy->uuid(), source->uuid());
    for (std::size_t i = 0; i < source->items().size(); ++i) {
        EXPECT_NE(copy->items()[i]->uuid(), source->items()[i]->uuid());
        EXPECT_EQ(copy->items()[i]->parentGroup(), copy);
        EXPECT_EQ(source->items()[i]->parentGroup(), source);
    }
    copy->availability().applications->push_back(u"org.other");
    EXPECT_EQ(source->availability().applications->size(), 2U);
    const auto empty = source->copySnippetGroup(false);
    EXPECT_TRUE(empty->items().empty());
    EXPECT_EQ(empty->abbreviationPrefix(), u";");
    EXPECT_EQ(test::settingsOf(*empty), test::settingsOf(*source));
}

TEST_F(SnippetGroupTest, FindsTheFirstWithExactlyTheAbbreviation) {
    group->setAbbreviationPrefix(u";");
    const auto first = snippet(u"sig");
    group->addItems({std::make_shared<Snippet>(), first, snippet(u"sig")});
    EXPECT_EQ(group->findSnippetWithAbbreviation(u"sig"), first);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u"Sig"), nullptr);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u";sig"), nullptr);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u""), nullptr) << "no abbreviation is not an empty one";
}

TEST_F(SnippetGroupTest, LineFeedBecomesReturnInASet) {
    const auto convert = SnippetGroup::replaceNewlineCharacterByCarriageReturnCharacter;
    EXPECT_EQ(convert(std::nullopt), std::nullopt);
    EXPECT_EQ(convert(CharacterSet()), CharacterSet());
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\u2028 ")), CharacterSet::withCharacters(u"\u2028 "));
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\n")), CharacterSet::withCharacters(u"\r"));
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\r\n.")), CharacterSet::withCharacters(u"\r."));
}

}  // namespace
}  // namespace plume
