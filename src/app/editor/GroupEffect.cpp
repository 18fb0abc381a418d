#include "app/editor/GroupEffect.h"

#include <QCoreApplication>
#include <QStringList>
#include <algorithm>
#include <array>

#include "app/editing/DelimiterNames.h"
#include "app/qt/Text.h"
#include "engine/AutoText.h"

namespace plume {

namespace {

using Naming = std::function<QString(const std::u16string&)>;
using Identifiers = std::vector<std::u16string>;

constexpr qsizetype LongestExample = 40;
constexpr qsizetype MostListed = 4;

// The first of many; one alone is never left out.
struct Listing {
    Listing(const QStringList& first, qsizetype count) : words(first) {
        if (count <= MostListed + 1) return;
        words = first.mid(0, MostListed);
        others = static_cast<int>(count - MostListed);
    }

    QStringList words;  // one at least
    int others = 0;
};

class Effect {
    Q_DECLARE_TR_FUNCTIONS(GroupEffect)
  public:
    Effect(const SnippetGroup& group, Naming applicationName, Naming inputSourceName)
        : group_(group), applicationName_(std::move(applicationName)), inputSourceName_(std::move(inputSourceName)) {}

    QString sentence() const {
        if (QString reason = whyNothing(); !reason.isEmpty()) return reason;
        QString sentence = inPrograms(expansion());
        sentence[0] = sentence[0].toUpper();
        const QString keyboards = withKeyboards();
        return keyboards.isEmpty() ? sentence : tr("%1 %2").arg(sentence, keyboards);
    }

  private:
    QString whyNothing() const;
    QString inPrograms(const QString& what) const;
    QString withKeyboards() const;
    QString expansion() const;
    QString typing() const;
    QString behindDelimiter() const;
    QString example() const;
    static QString delimiters(const std::optional<CharacterSet>& chosen);
    static QString all(Listing listing);
    static QString any(Listing listing);

    bool expandsOnDelimiter() const {
        return group_.expandTrigger() == ExpandTrigger::DelimiterKept ||
               group_.expandTrigger() == ExpandTrigger::DelimiterSwallowed;
    }

    const SnippetGroup& group_;
    const Naming applicationName_;
    const Naming inputSourceName_;
};

bool isUsual(const std::optional<CharacterSet>& delimiters) {
    return !delimiters || *delimiters == AutoText::defaultDelimiters();
}

Listing listed(const Identifiers& identifiers, const Naming& naming) {
    QStringList words;
    for (const std::u16string& each : identifiers) words.append(naming ? naming(each) : toQString(each));
    return {words, words.size()};
}

const Identifiers& orNone(const std::optional<Identifiers>& identifiers) {
    static const Identifiers none;
    return identifiers ? *identifiers : none;
}

// ---- Where ----

QString Effect::whyNothing() const {
    const PLFunctionAvailability& where = group_.availability();
    switch (group_.expandTrigger()) {
        case ExpandTrigger::Immediately:
        case ExpandTrigger::DelimiterKept:
        case ExpandTrigger::DelimiterSwallowed:
        case ExpandTrigger::HotKey:
            break;
        default:
            return tr("Typing %1 does nothing: these snippets are only chosen from lists.").arg(example());
    }
    if (where.availability < PLFunctionAvailability::Everywhere ||
        where.availability > PLFunctionAvailability::OnlyListed) {
        return tr("Typing %1 does nothing: the group is switched off in all programs.").arg(example());
    }
    if (where.availability == PLFunctionAvailability::OnlyListed && orNone(where.applications).empty()) {
        return tr("Typing %1 does nothing: no program is chosen yet.").arg(example());
    }
    const bool isLimited = where.inputMethodsOption != PLFunctionAvailability::Everywhere &&
                           where.inputMethodsOption != PLFunctionAvailability::ExceptListed;
    if (isLimited && orNone(where.inputMethods).empty()) {
        return tr("Typing %1 does nothing: no keyboard layout is chosen yet.").arg(example());
    }
    if (expandsOnDelimiter() && group_.delimiters() && group_.delimiters()->isEmpty()) {
        return tr("Typing %1 does nothing: no character is chosen to expand it.").arg(example());
    }
    return {};
}

QString Effect::inPrograms(const QString& what) const {
    const PLFunctionAvailability& where = group_.availability();
    const Identifiers& identifiers = orNone(where.applications);
    if (where.availability == PLFunctionAvailability::Everywhere || identifiers.empty()) return what;
    const QString programs = all(listed(identifiers, applicationName_));
    return where.availability == PLFunctionAvailability::OnlyListed
               ? tr("in %1 only: %2").arg(programs, what)
               : tr("everywhere but in %1: %2").arg(programs, what);
}

QString Effect::withKeyboards() const {
    const PLFunctionAvailability& where = group_.availability();
    const Identifiers& identifiers = orNone(where.inputMethods);
    if (where.inputMethodsOption == PLFunctionAvailability::Everywhere || identifiers.empty()) return {};
    const QString layouts = all(listed(identifiers, inputSourceName_));
    const bool isOne = identifiers.size() == 1;
    if (where.inputMethodsOption == PLFunctionAvailability::ExceptListed) {
        return isOne ? tr("Not with the keyboard layout %1.").arg(layouts)
                     : tr("Not with the keyboard layouts %1.").arg(layouts);
    }
    return isOne ? tr("Only with the keyboard layout %1.").arg(layouts)
                 : tr("Only with the keyboard layouts %1.").arg(layouts);
}

// ---- What is typed ----

QString Effect::expansion() const {
    const QString trigger = expandsOnDelimiter() ? delimiters(group_.delimiters()) : QString();
    switch (group_.expandTrigger()) {
        case ExpandTrigger::DelimiterKept:
            return tr("%1, then %2.").arg(typing(), trigger);
        case ExpandTrigger::DelimiterSwallowed:
            return tr("%1, then %2, which is left out.").arg(typing(), trigger);
        case ExpandTrigger::HotKey:
            return tr("%1, then press the hot key that expands.").arg(typing());
        default:
            return tr("%1, and it expands at once.").arg(typing());
    }
}

QString Effect::typing() const {
    switch (group_.expandAfter()) {
        case ExpandAfter::Delimiter:
            return isUsual(group_.expandAfterDelimiters()) ? tr("type %1").arg(example()) : behindDelimiter();
        case ExpandAfter::Whitespace:
            return tr("type %1 behind a space or in a new line").arg(example());
        case ExpandAfter::Anything:
            return tr("type %1, even inside a word").arg(example());
        case ExpandAfter::Digits:
            return tr("type %1 right behind a number").arg(example());
        default:
            return tr("type %1 before anything else").arg(example());
    }
}

QString Effect::behindDelimiter() const {
    const CharacterSet& set = *group_.expandAfterDelimiters();
    if (set.isEmpty()) return tr("type %1 before anything else").arg(example());
    return tr("type %1 behind %2").arg(example(), delimiters(set));
}

QString Effect::example() const {
    const auto& items = group_.items();
    const auto found = std::find_if(items.begin(), items.end(), [](const std::shared_ptr<Snippet>& snippet) {
        return !snippet->abbreviation().value_or(u"").empty();
    });
    QString text = toQString(group_.abbreviationPrefix().value_or(u"")) +
                   toQString(found == items.end() ? u"abc" : *(*found)->abbreviation());
    // What would run into the sentence around it is told from that.
    bool isQuoted = text.back().isPunct();
    if (text.size() > LongestExample) text = text.left(LongestExample) + u'…';
    for (QChar& c : text) {
        if (!c.isPrint() && !c.isSurrogate()) c = QChar::Space;
        isQuoted = isQuoted || c.isSpace();
    }
    return isQuoted ? tr("“%1”").arg(text) : text;
}

// ---- Lists ----

QString Effect::delimiters(const std::optional<CharacterSet>& chosen) {
    if (isUsual(chosen)) return tr("a space, Return or a punctuation mark");
    const CharacterSet& set = *chosen;
    const std::array<std::pair<char32_t, QString>, NamedDelimiters.size()> named{
        {{U' ', tr("a space")}, {U'\t', tr("Tab")}, {U'\r', tr("Return")}, {U'\u0003', tr("Enter")}}};
    QStringList words;
    for (const auto& [character, name] : named) {
        if (set.contains(character)) words.append(name);
    }
    qsizetype count = words.size();
    for (const auto& [first, last] : set.subtracting(namedDelimiters()).ranges()) {
        count += static_cast<qsizetype>(last - first) + 1;
        for (char32_t each = first; each <= last && words.size() <= MostListed; ++each) {
            words.append(tr("“%1”").arg(toQString(delimiterName(each))));
        }
    }
    return any(Listing(words, count));
}

QString Effect::all(Listing listing) {
    const QString last = listing.others > 0 ? tr("%n others", "", listing.others) : listing.words.takeLast();
    return listing.words.isEmpty() ? last : tr("%1 and %2").arg(listing.words.join(tr(", ")), last);
}

QString Effect::any(Listing listing) {
    const QString last = listing.others > 0 ? tr("one of %n others", "", listing.others) : listing.words.takeLast();
    return listing.words.isEmpty() ? last : tr("%1 or %2").arg(listing.words.join(tr(", ")), last);
}

}  // namespace

QString effectOf(const SnippetGroup& group, const Naming& applicationName, const Naming& inputSourceName) {
    return Effect(group, applicationName, inputSourceName).sentence();
}

}  // namespace plume
