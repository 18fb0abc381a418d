#include "app/editor/GroupEffect.h"

#include <gtest/gtest.h>

#include "app/qt/Text.h"

namespace plume {
namespace {

using Identifiers = std::vector<std::u16string>;

QString name(const std::u16string& identifier) {
    return identifier == u"org.thunderbird" ? QStringLiteral("Thunderbird") : toQString(identifier);
}

CharacterSet these(const std::u16string& characters) {
    return CharacterSet::withCharacters(characters);
}

struct Row {
    std::function<void(SnippetGroup&)> settings;
    std::string sentence;
};

void expectSentences(const std::vector<Row>& rows, const std::u16string& abbreviation = u"sig") {
    for (const auto& [settings, sentence] : rows) {
        const auto group = SnippetGroup::make();
        group->addItem(std::make_shared<Snippet>(std::nullopt, u"without an abbreviation"));
        group->addItem(std::make_shared<Snippet>(abbreviation, u"text"));
        settings(*group);
        EXPECT_EQ(effectOf(*group, name).toStdString(), sentence);
    }
}

TEST(GroupEffect, TellsWhenAnAbbreviationExpands) {
    const auto when = [](ExpandTrigger trigger, std::optional<CharacterSet> set = {}) {
        return [=](SnippetGroup& group) {
            group.setExpandTrigger(trigger);
            group.setDelimiters(set);
        };
    };
    const auto kept = ExpandTrigger::DelimiterKept;
    expectSentences({
        {when(ExpandTrigger::Immediately), "Type sig, and it expands at once."},
        {when(ExpandTrigger::Immediately, these(u"")), "Type sig, and it expands at once."},
        {when(kept), "Type sig, then a space, Return or a punctuation mark."},
        {when(kept, these(u" ")), "Type sig, then a space."},
        {when(kept, these(u" \t\r\u0003;")), "Type sig, then a space, Tab, Return, Enter or “;”."},
        {when(kept, these(u" ,;.!?")), "Type sig, then a space, “!”, “,”, “.” or one of 2 others."},
        {when(kept, these(u"\u00A0")), "Type sig, then “U+00A0”."},
        {when(kept, these(u"")), "Typing sig does nothing: no character is chosen to expand it."},
        {when(ExpandTrigger::DelimiterSwallowed, these(u"\t")), "Type sig, then Tab, which is left out."},
        {when(ExpandTrigger::HotKey), "Type sig, then press the hot key that expands."},
        {when(ExpandTrigger::Never), "Typing sig does nothing: these snippets are only chosen from lists."},
        {when(ExpandTrigger{9}), "Typing sig does nothing: these snippets are only chosen from lists."},
    });
}

TEST(GroupEffect, TellsWhatMustStandBeforeIt) {
    const auto behind = [](ExpandAfter after, std::optional<CharacterSet> set = {}) {
        return [=](SnippetGroup& group) {
            group.setExpandAfter(after);
            group.setExpandAfterDelimiters(set);
        };
    };
    expectSentences({
        {behind(ExpandAfter::Delimiter, these(u" (")), "Type sig behind a space or “(”, and it expands at once."},
        {behind(ExpandAfter::Delimiter, these(u"")), "Type sig before anything else, and it expands at once."},
        {behind(ExpandAfter::Whitespace, these(u"(")),
         "Type sig behind a space or in a new line, and it expands at once."},
        {behind(ExpandAfter::Anything), "Type sig, even inside a word, and it expands at once."},
        {behind(ExpandAfter::Digits), "Type sig right behind a number, and it expands at once."},
        {behind(ExpandAfter{7}), "Type sig before anything else, and it expands at once."},
    });
}

TEST(GroupEffect, TellsWhere) {
    const auto in = [](std::int64_t option, std::optional<Identifiers> programs) {
        return [=](SnippetGroup& group) {
            group.setAbbreviationPrefix(u";");
            group.setExpandTrigger(ExpandTrigger::DelimiterKept);
            group.setDelimiters(these(u" "));
            group.availability().availability = option;
            group.availability().applications = programs;
        };
    };
    const auto with = [](std::int64_t option, std::optional<Identifiers> layouts) {
        return [=](SnippetGroup& group) {
            group.availability().inputMethodsOption = option;
            group.availability().inputMethods = layouts;
        };
    };
    expectSentences({
        {in(0, Identifiers{u"kitty"}), "Type ;sig, then a space."},
        {in(1, std::nullopt), "Type ;sig, then a space."},
        {in(1, Identifiers{u"kitty"}), "Everywhere but in kitty: type ;sig, then a space."},
        {in(2, Identifiers{u"org.thunderbird"}), "In Thunderbird only: type ;sig, then a space."},
        {in(2, Identifiers{u"a", u"b", u"%1"}), "In a, b and %1 only: type ;sig, then a space."},
        {in(2, Identifiers{u"a", u"b", u"c", u"d", u"e", u"f"}),
         "In a, b, c, d and 2 others only: type ;sig, then a space."},
        {in(2, std::nullopt), "Typing ;sig does nothing: no program is chosen yet."},
        {in(5, Identifiers{u"a"}), "Typing ;sig does nothing: the group is switched off in all programs."},
        {with(0, Identifiers{u"us"}), "Type sig, and it expands at once."},
        {with(1, Identifiers{u"us"}), "Type sig, and it expands at once. Not with the keyboard layout us."},
        {with(2, Identifiers{u"us", u"de"}),
         "Type sig, and it expands at once. Only with the keyboard layouts us and de."},
        {with(7, Identifiers{u"us"}), "Type sig, and it expands at once. Only with the keyboard layout us."},
        {with(7, std::nullopt), "Typing sig does nothing: no keyboard layout is chosen yet."},
    });
}

TEST(GroupEffect, ShowsWhatIsTypedSoThatItIsToldFromTheSentence) {
    const auto nothing = [](SnippetGroup&) {};
    expectSentences({{nothing, "Type abc, and it expands at once."}}, u"");
    expectSentences({{nothing, "Type “a b”, and it expands at once."}}, u"a\nb");
    expectSentences({{nothing, "Type “sig,”, and it expands at once."}}, u"sig,");
    expectSentences({{nothing, "Type " + std::string(40, 'x') + "…, and it expands at once."}},
                    std::u16string(5000, u'x'));
    const auto named = [](const std::u16string&) { return QStringLiteral("German"); };
    const auto group = SnippetGroup::make();
    group->availability().inputMethodsOption = PLFunctionAvailability::OnlyListed;
    group->availability().inputMethods = Identifiers{u"de"};
    EXPECT_EQ(effectOf(*group, name, named).toStdString(),
              "Type abc, and it expands at once. Only with the keyboard layout German.");
}

}  // namespace
}  // namespace plume
