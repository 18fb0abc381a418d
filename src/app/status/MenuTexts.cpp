#include "app/status/MenuTexts.h"

#include <QChar>
#include <QCoreApplication>
#include <QTextBoundaryFinder>

#include "app/qt/Text.h"
#include "library/SnippetGroup.h"

namespace plume {

namespace {

constexpr qsizetype AbbreviationLimit = 24;
constexpr qsizetype LineLimit = 50;
constexpr qsizetype NameLimit = 16;
// What a reader takes for one character may be long, but not endless.
constexpr qsizetype UnitsPerCharacter = 8;

class MenuTexts {
    Q_DECLARE_TR_FUNCTIONS(MenuTexts)
};

char32_t take(std::u16string_view text, std::size_t& next) {
    const char16_t unit = text[next++];
    if (!QChar::isHighSurrogate(unit) || next == text.size() || !QChar::isLowSurrogate(text[next])) return unit;
    return QChar::surrogateToUcs4(unit, text[next++]);
}

bool endsLine(char32_t c) {
    return (c >= U'\n' && c <= U'\r') || c == 0x85 || c == 0x2028 || c == 0x2029;
}

bool isBlank(char32_t c) {
    constexpr char32_t PlaceOfPicture = 0xFFFC;
    return QChar::isSpace(c) || QChar::category(c) == QChar::Other_Control || c == PlaceOfPicture;
}

// Joiners and tags are parts of letters and emoji; all other invisible characters only change how their line looks.
bool isLeftOut(char32_t c) {
    const bool joins = c == 0x200C || c == 0x200D || (c >= 0xE0020 && c <= 0xE007F);
    return QChar::category(c) == QChar::Other_Format && !joins;
}

// Half of a character, or none at all.
bool isBroken(char32_t c) {
    return QChar::isSurrogate(c) || QChar::isNonCharacter(c);
}

QString elided(const QString& text, qsizetype limit) {
    QTextBoundaryFinder finder(QTextBoundaryFinder::Grapheme, text);
    qsizetype end = 0;
    for (qsizetype count = 0; count < limit && end < text.size(); ++count) {
        const qsizetype next = finder.toNextBoundary();
        if (next < 0 || next > limit * UnitsPerCharacter) break;
        end = next;
    }
    if (end >= text.size()) return text;
    return text.left(end).trimmed() + QChar(0x2026);
}

QString nameOfNothing() {
    return MenuTexts::tr("Empty snippet");
}

QString abbreviationOf(const Snippet& snippet, qsizetype limit) {
    return harmlessLine(snippet.abbreviationWithPrefix().value_or(u""), limit);
}

QString descriptionOf(const Snippet& snippet, qsizetype limit) {
    QString label = harmlessLine(snippet.label().value_or(u""), limit);
    if (!label.isEmpty() || !snippet.hasContent()) return label;
    return harmlessLine(snippet.richTextContent()->string(), limit);
}

}  // namespace

QString harmlessLine(std::u16string_view text, qsizetype limit) {
    constexpr char32_t Replacement = 0xFFFD;
    // One more than may be kept, so that elided() sees that something is missing.
    const qsizetype enough = (limit + 1) * UnitsPerCharacter;
    QString line;
    bool blank = false;
    std::size_t next = 0;
    while (next < text.size() && line.size() < enough) {
        const char32_t c = take(text, next);
        if (endsLine(c) && !line.isEmpty()) break;
        if (isBlank(c)) {
            blank = !line.isEmpty();
        } else if (!isLeftOut(c)) {
            if (blank) line += QLatin1Char(' ');
            blank = false;
            line += QChar::fromUcs4(isBroken(c) ? Replacement : c);
        }
    }
    return elided(line, limit);
}

QString snippetLine(const Snippet& snippet) {
    QString abbreviation = abbreviationOf(snippet, AbbreviationLimit);
    const QString description = descriptionOf(snippet, LineLimit);
    if (abbreviation.isEmpty()) return description.isEmpty() ? nameOfNothing() : description;
    if (description.isEmpty()) return abbreviation;
    //: %1 is an abbreviation, %2 what it stands for.
    return MenuTexts::tr("%1 — %2").arg(abbreviation, description);
}

QString snippetName(const Snippet& snippet) {
    QString name = abbreviationOf(snippet, NameLimit);
    if (name.isEmpty()) name = descriptionOf(snippet, NameLimit);
    return name.isEmpty() ? nameOfNothing() : name;
}

QString asMenuText(QString text, MenuHome home) {
    if (home == MenuHome::Widget) return text.replace(QLatin1Char('&'), QLatin1String("&&"));
    // Qt sends the first "&" as "_" and all others as they are. "__" is read as "_", and "_&" as "&"; where GTK finds
    // "_&" it takes every "_" for the mark of a letter.
    const qsizetype ampersand = text.indexOf(QLatin1Char('&'));
    const qsizetype underscore = text.indexOf(QLatin1Char('_'));
    if (ampersand >= 0 && (underscore < 0 || ampersand < underscore)) {
        text.replace(QLatin1Char('_'), QLatin1Char(' ')).insert(ampersand, QLatin1Char('&'));
    } else if (underscore >= 0) {
        text.replace(QLatin1Char('_'), QLatin1String("__"));
        text[underscore] = QLatin1Char('&');
    }
    return text;
}

}  // namespace plume
