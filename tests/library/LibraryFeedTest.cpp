#include "library/LibraryFeed.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <set>

#include "engine/AbbreviationIndex.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using test::snippet;

std::string described(const SnippetGroups& groups) {
    std::string all;
    for (const auto& group : groups) all += test::fieldsOf(*group) + "\n";
    return all;
}

// Every snippet that could end the text, in the order of the library.
class Found final : public AbbreviationIndex::Visitor {
  public:
    Found(const AbbreviationIndex& index, std::u16string_view text) {
        index.visitCandidates(AbbreviationIndex::Trigger::Immediately, text, *this);
    }
    void visit(const AbbreviationIndex::Candidate& candidate) override {
        found.insert({candidate.group->order, candidate.rank});
    }
    std::set<std::pair<std::size_t, std::size_t>> found;
};

// An edit of any kind, as a person, an import or a restore makes them.
void edit(SnippetGroups& groups) {
    const auto below = [](std::size_t bound) { return *rc::gen::inRange<std::size_t>(0, bound); };
    const auto abbreviation = [&] { return std::u16string(1, static_cast<char16_t>(u'a' + below(4))); };
    if (groups.empty() || below(8) == 0) {
        groups.insert(groups.begin() + static_cast<std::ptrdiff_t>(below(groups.size() + 1)), test::fullGroup());
        return;
    }
    auto& group = *groups[below(groups.size())];
    const std::size_t count = group.items().size();
    switch (below(10)) {
        case 0:
            groups.erase(groups.begin() + static_cast<std::ptrdiff_t>(below(groups.size())));
            break;
        case 1:
            std::swap(groups.front(), groups.back());
            break;
        case 2:
            group.setName(abbreviation());
            break;
        case 3:
            group.setAbbreviationPrefix(abbreviation());
            group.setExpandTrigger(static_cast<ExpandTrigger>(below(4)));
            break;
        case 4:
            for (std::size_t i = below(20); i > 0; --i) group.insertItem(snippet(abbreviation()), below(count + 1));
            break;
        case 5:
            group.replaceItems({snippet(abbreviation()), test::fullSnippet()});
            break;
        case 6:
            if (count > 0) group.removeItem(group.items()[below(count)]);
            break;
        case 7:
            if (count > 0) group.items()[below(count)]->setAbbreviation(abbreviation());
            break;
        case 8:  // the same record in two places
            if (count > 0) groups[below(groups.size())]->insertItem(group.items()[below(count)], below(3));
            break;
        default:
            if (count > 0) group.items()[below(count)]->setRichTextContent(test::richText());
    }
}

RC_GTEST_PROP(LibraryFeed, KeepsRecordsOfItsOwnAndTheirIndexInStep, ()) {
    SnippetGroups groups;
    LibraryFeed feed;
    FedLibrary fed;
    AbbreviationIndex index(CharacterSet::withCharacters(u" "));
    for (int turns = *rc::gen::inRange(1, 12); turns > 0; --turns) {
        for (int edits = *rc::gen::inRange(0, 6); edits > 0; --edits) edit(groups);
        if (auto update = feed.changesTo(groups)) {
            fed.apply(*update);
            index.setGroups(fed.groups());
        }
        RC_ASSERT(!feed.changesTo(groups));
        RC_ASSERT(described(fed.groups()) == described(groups));
        for (std::size_t i = 0; i < groups.size(); ++i) {
            RC_ASSERT(fed.groups()[i] != groups[i]);
            for (const auto& each : fed.groups()[i]->items()) RC_ASSERT(each->parentGroup() == fed.groups()[i]);
        }
        AbbreviationIndex fresh(CharacterSet::withCharacters(u" "));
        fresh.setGroups(groups);
        for (const char16_t* text : {u"aa", u"ab", u"ba", u"cd", u";a"}) {
            RC_ASSERT(Found(index, text).found == Found(fresh, text).found);
        }
    }
}

TEST(LibraryFeed, SendsWhatHasChangedAndNoMore) {
    SnippetGroups groups{test::fullGroup(), test::fullGroup()};
    LibraryFeed feed;
    FedLibrary fed;
    auto all = feed.changesTo(groups);
    ASSERT_TRUE(all);
    fed.apply(*all);
    const auto untouched = fed.groups()[1]->items();
    groups[1]->items()[1]->setAbbreviation(u"new");
    auto update = feed.changesTo(groups);
    ASSERT_TRUE(update && update->added.empty() && update->changed.size() == 1);
    EXPECT_EQ(update->changed[0].changed.size(), 1U);
    fed.apply(*update);
    EXPECT_EQ(fed.groups()[1]->items()[0], untouched[0]);
    EXPECT_EQ(fed.groups()[1]->items()[1]->abbreviation(), u"new");
    EXPECT_EQ(update->changed[0].changed[0].second, untouched[1]) << "what went out is the sender's to free";
}

}  // namespace
}  // namespace plume
