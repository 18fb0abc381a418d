#include "app/windows/DecisionWords.h"

#include <string_view>

#include "app/qt/Text.h"

namespace plume {

namespace {

using Outcome = MatchDecision::Outcome;

// On one line, and no longer than a sentence can bear.
QString asName(std::u16string_view text) {
    constexpr qsizetype LongestName = 40;
    QString name = toQString(text.substr(0, 2 * LongestName));
    for (QChar& character : name) {
        if (!character.isPrint() && !character.isSurrogate()) character = QChar::Space;
    }
    if (name.size() <= LongestName) return name;
    name.truncate(LongestName - 1);
    if (name.back().isHighSurrogate()) name.chop(1);
    return name + QChar(0x2026);
}

QString withCapital(QString text) {
    if (!text.isEmpty()) text[0] = text[0].toUpper();
    return text;
}

}  // namespace

DecisionWords DecisionWords::of(const MatchDecision& decision) {
    DecisionWords words;
    words.abbreviation = asName(decision.abbreviation);
    words.group = asName(decision.group);
    words.reason = withCapital(reasonOf(decision));
    words.sentence = words.sentenceOf(decision);
    words.advice = adviceOf(decision.outcome);
    return words;
}

QString DecisionWords::reasonOf(const MatchDecision& decision) {
    const QString application = asName(decision.application);
    switch (decision.outcome) {
        case Outcome::Expanded:
            return application.isEmpty() ? tr("expanded") : tr("expanded in %1").arg(application);
        case Outcome::Offered:
            return tr("offered in a list, as one of several that match");
        case Outcome::Failed:
            return tr("its content could not be expanded");
        case Outcome::WrongApplication:
            return application.isEmpty() ? tr("the group is not meant for a program that Plume cannot name")
                                         : tr("the group is not meant for %1").arg(application);
        case Outcome::WrongInputSource:
            return tr("the group is not meant for this keyboard layout or input method");
        case Outcome::WrongTextBefore:
            return missingBefore(decision);
        case Outcome::WrongCase:
            return tr("its capital and small letters were typed differently");
        case Outcome::WrongTrigger:
            return tr("the group does not expand after the key that followed");
        case Outcome::SwitchedOff:
            return tr("Plume was switched off");
        case Outcome::SwitchedOn:
            return tr("Plume was switched on");
        case Outcome::SecureInputBegan:
            return tr("a password field or another program kept the keyboard to itself");
        case Outcome::SecureInputEnded:
            return tr("Plume could hear the keyboard again");
    }
    return {};
}

QString DecisionWords::missingBefore(const MatchDecision& decision) {
    if (decision.detail == MatchDecision::AfterDelimiter) return tr("no space or other delimiter stood before it");
    if (decision.detail == MatchDecision::AfterWhitespace) return tr("no space or new line stood before it");
    if (decision.detail == MatchDecision::AfterDigits) return tr("no number stood before it");
    if (decision.detail == MatchDecision::AfterPrefix) return tr("part of its prefix stood before it once more");
    return tr("the group wants something else before it");
}

QString DecisionWords::sentenceOf(const MatchDecision& decision) const {
    const QString subject =
        group.isEmpty() ? tr("“%1”").arg(abbreviation) : tr("“%1” (group %2)").arg(abbreviation, group);
    switch (decision.outcome) {
        case Outcome::Expanded:
        case Outcome::Offered:
            //: %1 is an abbreviation, %2 for example "expanded in xterm"
            return tr("%1 was %2.").arg(subject, reasonOf(decision));
        case Outcome::SwitchedOff:
        case Outcome::SwitchedOn:
        case Outcome::SecureInputBegan:
        case Outcome::SecureInputEnded:
            return tr("%1.").arg(reason);
        default:
            //: %1 is an abbreviation, %2 for example "the group is not meant for xterm"
            return tr("%1 did not expand: %2.").arg(subject, reasonOf(decision));
    }
}

QString DecisionWords::adviceOf(Outcome outcome) {
    switch (outcome) {
        case Outcome::Offered:
            return tr("Choose from the list, or give each snippet an abbreviation of its own.");
        case Outcome::Failed:
            return tr("Have a look at the snippet’s content. What was wrong with it may have been reported.");
        case Outcome::WrongApplication:
            return tr("Change the list of programs in the group’s settings.");
        case Outcome::WrongInputSource:
            return tr("Change to another keyboard layout, or change the list of them in the group’s settings.");
        case Outcome::WrongTextBefore:
            return tr(
                "Type it where that fits, or change in the group’s settings what must stand before an abbreviation.");
        case Outcome::WrongCase:
            return tr("Type it as it is written here, or let the snippet ignore case.");
        case Outcome::WrongTrigger:
            return tr("Type one of the group’s own delimiters, or add this one to them in the group’s settings.");
        case Outcome::SwitchedOff:
            return tr("Nothing expands until you switch Plume on in the menu of its icon.");
        case Outcome::SecureInputBegan:
            return tr("Nothing expands until you leave the field, or the other program lets the keyboard go.");
        case Outcome::Expanded:
        case Outcome::SwitchedOn:
        case Outcome::SecureInputEnded:
            break;
    }
    return {};
}

}  // namespace plume
