// One row of a list of snippets, as it is shown: what a model hands to the delegate that draws it.
#pragma once

#include <QList>
#include <QMetaType>
#include <QString>

#include <string_view>

#include "Foundation/Strings.h"

namespace plume {

struct MarkedText {
    QString text;
    QList<Range> marks;  // what was typed or searched for in it
};

struct SnippetRow {
    // In data(), for the delegate.
    static constexpr int Role = Qt::UserRole;

    MarkedText abbreviation;
    MarkedText label;
    MarkedText content;  // its beginning, in one line
    QString group;
    QString shortcut;        // picks it; empty: none does
    bool isDivider = false;  // no snippet: a line above what is similar alone

    // All of it in one sentence, for those who hear it.
    QString spoken() const;
};

// The text unit for unit, so that places in it hold, without breaks between lines.
QString inOneLine(std::u16string_view text);
// What is pressed to pick with this digit: see SuggestionController for the modifier.
QString digitShortcut(char16_t digit, std::int64_t selectorKeyModifier);

}  // namespace plume

Q_DECLARE_METATYPE(plume::SnippetRow)
