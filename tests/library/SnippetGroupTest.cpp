#include "library/SnippetGroup.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

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
    }
    void itemRemoved(SnippetGroup&, Snippet& snippet, std::size_t index) override {
        heard.push_back("removed " + toUtf8(*snippet.abbreviation()) + " " + std::to_string(index));
    }
    void matchingSettingsChanged(SnippetGroup&) override { heard.push_back("settings"); }

    std::vector<std::string> take() { return std::exchange(heard, {}); }

    std::vector<std::string> heard;
};

std::vector<std::string> abbreviationsOf(const SnippetGroup& group) {
    std::vector<std::string> result;
    for (const auto& item : group.items()) result.push_back(toUtf8(item->abbreviation().value_or(u"(nil)")));
    return result;
}

TEST(SnippetGroup, ListsItsItemsInUserOrder) {
    const auto group = SnippetGroup::make();
    Listener listener;
    group->addGroupObserver(&listener);
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
}

TEST(SnippetGroup, ChangesNothingForNothing) {
    const auto group = SnippetGroup::make();
    Listener listener;
    group->addGroupObserver(&listener);
    group->addItems({});
    group->addItem(nullptr);
    group->addItems({nullptr});
    group->removeItem(nullptr);
    group->removeItem(snippet(u"a"));
    EXPECT_THAT(listener.take(), IsEmpty());
    EXPECT_TRUE(group->items().empty());
}

TEST(SnippetGroup, CanAddItsOwnItemsAndRemoveAnItemByItsOwnReference) {
    const auto group = SnippetGroup::make();
    group->addItems({snippet(u"a"), snippet(u"b")});
    group->addItems(group->items());
    EXPECT_THAT(abbreviationsOf(*group), ElementsAre("a", "b", "a", "b"));
    Listener listener;
    group->addGroupObserver(&listener);
    group->removeItem(group->items().front());
    EXPECT_THAT(abbreviationsOf(*group), ElementsAre("b", "b")) << "a removed snippet is not listed any more";
    EXPECT_THAT(listener.take(), ElementsAre("removed a 0", "removed a 1"));
}

TEST(SnippetGroup, AnItemMovedAwayKeepsItsNewGroup) {
    const auto from = SnippetGroup::make();
    const auto to = SnippetGroup::make();
    const auto item = snippet(u"a");
    from->addItem(item);
    to->addItem(item);
    from->removeItem(item);
    EXPECT_EQ(item->parentGroup(), to);
}

TEST(SnippetGroup, ManyItemsAreOneNews) {
    const auto group = SnippetGroup::make();
    Listener listener;
    group->addGroupObserver(&listener);
    group->addItems(std::vector<std::shared_ptr<Snippet>>(100'000, snippet(u"a")));
    EXPECT_THAT(listener.take(), ElementsAre("added 0+100000"));
}

TEST(SnippetGroup, TellsOfRealChangesOfAbbreviations) {
    const auto group = SnippetGroup::make();
    const auto item = snippet(u"a");
    group->addItem(item);
    Listener listener;
    group->addGroupObserver(&listener);
    item->setAbbreviation(u"a");
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

TEST(SnippetGroup, DuplicatingASnippetIsNoChange) {
    const auto group = SnippetGroup::make();
    group->addItem(snippet(u"a"));
    Listener listener;
    group->addGroupObserver(&listener);
    const auto copy = group->items().front()->copySnippet();
    EXPECT_THAT(listener.take(), IsEmpty());
}

TEST(SnippetGroup, TellsOfRealChangesOfMatchingSettings) {
    const auto group = SnippetGroup::make();
    Listener listener;
    group->addGroupObserver(&listener);
    group->setAbbreviationPrefix(u";");
    group->setExpandTrigger(ExpandTrigger::DelimiterKept);
    group->setDelimiters(CharacterSet::withCharacters(u"."));
    EXPECT_THAT(listener.take(), ElementsAre("settings", "settings", "settings"));
    group->setAbbreviationPrefix(u";");
    group->setExpandTrigger(ExpandTrigger::DelimiterKept);
    group->setDelimiters(CharacterSet::withCharacters(u"."));
    group->setName(u"name");
    group->setShowInMenuBar(false);
    EXPECT_THAT(listener.take(), IsEmpty());
}

TEST(SnippetGroup, CopiedSettingsAreOneChangeOrNone) {
    const auto group = SnippetGroup::make();
    const auto other = SnippetGroup::make();
    other->setExpandTrigger(ExpandTrigger::Never);
    other->setDelimiters(CharacterSet::withCharacters(u"."));
    Listener listener;
    group->addGroupObserver(&listener);
    group->copySettingsFromGroup(*other);
    EXPECT_THAT(listener.take(), ElementsAre("settings"));
    group->copySettingsFromGroup(*other);
    EXPECT_THAT(listener.take(), IsEmpty());
}

// Leaves, and takes another one with it, when first told of something.
class LeavingListener final : public SnippetGroupObserver {
  public:
    explicit LeavingListener(SnippetGroupObserver* other) : other_(other) {}
    void abbreviationChanged(SnippetGroup&, Snippet&, const Snippet::Text&) override {}
    void itemsAdded(SnippetGroup& group, std::size_t, std::size_t) override {
        group.removeGroupObserver(this);
        group.removeGroupObserver(other_);
    }
    void itemRemoved(SnippetGroup&, Snippet&, std::size_t) override {}
    void matchingSettingsChanged(SnippetGroup&) override {}

  private:
    SnippetGroupObserver* other_;
};

TEST(SnippetGroup, ObserversMayLeaveWhileTheyAreTold) {
    const auto group = SnippetGroup::make();
    Listener goes;
    Listener stays;
    LeavingListener leaving(&goes);
    group->addGroupObserver(&leaving);
    group->addGroupObserver(&goes);
    group->addGroupObserver(&stays);
    group->addItem(snippet(u"a"));
    EXPECT_THAT(goes.take(), IsEmpty());
    EXPECT_THAT(stays.take(), ElementsAre("added 0+1"));
}

std::shared_ptr<SnippetGroup> groupWithSettings() {
    const auto group = SnippetGroup::make();
    group->setName(u"Letters");
    group->setAbbreviationPrefix(u";");
    group->setExpandAfter(ExpandAfter::Digits);
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u","));
    group->setExpandTrigger(ExpandTrigger::DelimiterSwallowed);
    group->setDelimiters(CharacterSet::withCharacters(u"."));
    group->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    group->setResetFormatting(true);
    group->setShowInMenuBar(false);
    group->setSuggestAbbreviations(false);
    group->availability() = {1, std::vector<std::u16string>{u"org.mail"}, 2, std::vector<std::u16string>{u"us"}};
    group->addItems({snippet(u"a"), snippet(u"b")});
    return group;
}

void expectSameSettings(const SnippetGroup& a, const SnippetGroup& b) {
    EXPECT_EQ(a.expandAfter(), b.expandAfter());
    EXPECT_EQ(a.expandAfterDelimiters(), b.expandAfterDelimiters());
    EXPECT_EQ(a.expandTrigger(), b.expandTrigger());
    EXPECT_EQ(a.delimiters(), b.delimiters());
    EXPECT_EQ(a.caseSensitivity(), b.caseSensitivity());
    EXPECT_EQ(a.resetFormatting(), b.resetFormatting());
    EXPECT_EQ(a.showInMenuBar(), b.showInMenuBar());
    EXPECT_EQ(a.suggestAbbreviations(), b.suggestAbbreviations());
    EXPECT_EQ(a.availability(), b.availability());
}

TEST(SnippetGroup, CopyingSettingsLeavesIdentityNamePrefixAndItems) {
    const auto source = groupWithSettings();
    const auto group = SnippetGroup::make();
    group->setName(u"Mine");
    const auto uuid = group->uuid();
    group->copySettingsFromGroup(*source);
    expectSameSettings(*group, *source);
    EXPECT_EQ(group->uuid(), uuid);
    EXPECT_EQ(group->name(), u"Mine");
    EXPECT_EQ(group->abbreviationPrefix(), std::nullopt);
    EXPECT_TRUE(group->items().empty());
}

TEST(SnippetGroup, DuplicatesWithAndWithoutItems) {
    const auto source = groupWithSettings();
    for (const bool withItems : {false, true}) {
        const auto copy = source->copySnippetGroup(withItems);
        expectSameSettings(*copy, *source);
        EXPECT_EQ(copy->name(), u"Letters");
        EXPECT_EQ(copy->abbreviationPrefix(), u";");
        EXPECT_NE(copy->uuid(), source->uuid());
        EXPECT_EQ(copy->items().size(), withItems ? 2U : 0U);
        for (std::size_t i = 0; i < copy->items().size(); ++i) {
            EXPECT_EQ(copy->items()[i]->abbreviation(), source->items()[i]->abbreviation());
            EXPECT_NE(copy->items()[i]->uuid(), source->items()[i]->uuid());
            EXPECT_EQ(copy->items()[i]->parentGroup(), copy);
            EXPECT_EQ(source->items()[i]->parentGroup(), source);
        }
        copy->availability().applications->push_back(u"org.other");
        EXPECT_EQ(source->availability().applications->size(), 1U);
    }
}

TEST(SnippetGroup, FindsTheFirstWithExactlyTheAbbreviation) {
    const auto group = SnippetGroup::make();
    group->setAbbreviationPrefix(u";");
    const auto first = snippet(u"sig");
    group->addItems({std::make_shared<Snippet>(), first, snippet(u"sig")});
    EXPECT_EQ(group->findSnippetWithAbbreviation(u"sig"), first);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u"Sig"), nullptr);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u";sig"), nullptr);
    EXPECT_EQ(group->findSnippetWithAbbreviation(u""), nullptr) << "no abbreviation is not an empty one";
}

TEST(SnippetGroup, LineFeedBecomesReturnInASet) {
    const auto convert = SnippetGroup::replaceNewlineCharacterByCarriageReturnCharacter;
    EXPECT_EQ(convert(std::nullopt), std::nullopt);
    EXPECT_EQ(convert(CharacterSet()), CharacterSet());
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\u2028 ")), CharacterSet::withCharacters(u"\u2028 "));
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\n")), CharacterSet::withCharacters(u"\r"));
    EXPECT_EQ(convert(CharacterSet::withCharacters(u"\r\n.")), CharacterSet::withCharacters(u"\r."));
}

}  // namespace
}  // namespace plume
