#include "app/qt/Sentences.h"

#include <QCoreApplication>
#include <QStringList>
#include <optional>

namespace plume {

namespace {

constexpr const char* Context = "Sentences";

// Sentences quote sentences that quote reasons.
constexpr int DeepestQuote = 3;

// The more particular ones first. Their strings are long.
// NOLINTBEGIN(bugprone-suspicious-missing-comma)
constexpr const char* Known[] = {
    // The keyboard
    QT_TRANSLATE_NOOP("Sentences", "Plume is not working: it cannot hear the keyboard."),
    QT_TRANSLATE_NOOP("Sentences", "%1 takes keys, too. When letters get lost or come twice, end one of the two."),
    QT_TRANSLATE_NOOP("Sentences",
                      "Listening to the keyboard was ended three times within a minute, because Plume did not "
                      "answer in time. It is tried again in a minute."),
    QT_TRANSLATE_NOOP("Sentences", "Plume does not listen"),
    QT_TRANSLATE_NOOP("Sentences", "Listen now"),
    QT_TRANSLATE_NOOP("Sentences", "Show Reports"),
    QT_TRANSLATE_NOOP("Sentences",
                      "The snippet was not sent: another program holds the keyboard, or a password is asked for."),
    QT_TRANSLATE_NOOP("Sentences", "The snippet was not sent: it is no longer in your library."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The snippet was not sent: the window that it was for is gone, or does not take the keyboard."),
    // Forms
    QT_TRANSLATE_NOOP("Sentences", "The window that it was for is gone, or does not take the keyboard."),
    QT_TRANSLATE_NOOP("Sentences", "Another field has the focus than the one that it was for."),
    QT_TRANSLATE_NOOP("Sentences", "A form is shown as a plain window, because no page can be drawn: %1"),
    QT_TRANSLATE_NOOP("Sentences", "the program plume-form is not installed."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms does not answer."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms cannot be started."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms does not listen."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms says what cannot be."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms has crashed."),
    QT_TRANSLATE_NOOP("Sentences", "The program that draws forms has ended with %1."),
    // Hot keys
    QT_TRANSLATE_NOOP("Sentences", "Another hot key of Plume's has this combination already."),
    QT_TRANSLATE_NOOP("Sentences", "Another program has this combination as its hot key already: choose another."),
    QT_TRANSLATE_NOOP("Sentences", "The keyboard has no key with code %1 for the hot key."),
    // What the desktop lacks
    QT_TRANSLATE_NOOP("Sentences",
                      "The keyboard \"%1\" of display \"%2\" is held by another program, perhaps another Plume or "
                      "key tool: end that program."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The X server \"%1\" lacks the XFIXES extension, which Plume needs to follow the clipboard: "
                      "switch it on."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The keyboard layout of the X display \"%1\" cannot be read: Plume needs an X server with "
                      "the XKB extension."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The X server of display \"%1\" lacks an XTEST keyboard on the main keyboard: was it removed "
                      "with xinput?"),
    QT_TRANSLATE_NOOP("Sentences", "The X server of display \"%1\" lacks %2"),
    // Passwords
    QT_TRANSLATE_NOOP("Sentences", "Password fields in browsers"),
    QT_TRANSLATE_NOOP("Sentences",
                      "Browsers and Qt programs tell Plume which field takes a password only while the desktop's "
                      "accessibility is on, which makes them a little slower; until then Plume hears passwords "
                      "that are typed there. %1"),
    QT_TRANSLATE_NOOP("Sentences", "Your answer is kept; \"plume settings %1\" shows it."),
    QT_TRANSLATE_NOOP("Sentences", "Switch on"),
    QT_TRANSLATE_NOOP("Sentences", "Not now"),
    QT_TRANSLATE_NOOP("Sentences",
                      "Programs tell about their password fields now; Chromium has to be started again. %1"),
    QT_TRANSLATE_NOOP("Sentences", "The answer is not kept: %1"),
    QT_TRANSLATE_NOOP("Sentences", "%1 is %2 from now on."),
    // Expanding
    QT_TRANSLATE_NOOP("Sentences", "Several snippets match \"%1\", and there is no list here to choose from."),
    QT_TRANSLATE_NOOP("Sentences", "The snippet \"%1\" has fields to fill in, and there is no form here to do it."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The snippet \"%1\" is not expanded, because its content never ends or is too long; check "
                      "whether snippets include each other."),
    QT_TRANSLATE_NOOP("Sentences", "AppleScript snippets cannot run on this system: there is no %1."),
    QT_TRANSLATE_NOOP("Sentences", "A script was ended because it ran longer than %1."),
    QT_TRANSLATE_NOOP("Sentences", "1 second"),
    QT_TRANSLATE_NOOP("Sentences", "%1 seconds"),
    QT_TRANSLATE_NOOP("Sentences", "A script was ended because it wrote more than %1 million characters."),
    QT_TRANSLATE_NOOP("Sentences", "A script could not be run: the system gives no further thread."),
    QT_TRANSLATE_NOOP("Sentences", "A script could not be run: %1."),
    // The library
    QT_TRANSLATE_NOOP("Sentences", "Your library cannot be opened."),
    QT_TRANSLATE_NOOP("Sentences", "The library could not be exported."),
    QT_TRANSLATE_NOOP("Sentences", "The file could not be restored."),
    QT_TRANSLATE_NOOP("Sentences", "The file could not be imported."),
    QT_TRANSLATE_NOOP("Sentences", "The library was damaged"),
    QT_TRANSLATE_NOOP("Sentences", "The library was damaged, and there is no backup of it."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The library was damaged. The newest backup is %1. What could not be read is kept beside "
                      "it."),
    QT_TRANSLATE_NOOP("Sentences", "Restore"),
    QT_TRANSLATE_NOOP("Sentences", "The library cannot be read: %1. It is kept in %2."),
    QT_TRANSLATE_NOOP("Sentences", "The last changes of the library cannot be read: %1"),
    QT_TRANSLATE_NOOP("Sentences", "No backup was made: %1"),
    QT_TRANSLATE_NOOP("Sentences", "An old backup stays: %1"),
    QT_TRANSLATE_NOOP("Sentences", "nothing was replaced, because the library of now cannot be kept: %1"),
    // Synchronisation
    QT_TRANSLATE_NOOP("Sentences", "The sync folder %1 is not there; the library is sent when it comes."),
    QT_TRANSLATE_NOOP("Sentences", "Another machine had changed the library meanwhile; its version is kept in %1."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The library was replaced by another machine's. What it held, with changes that were not "
                      "sent yet, is in %1."),
    QT_TRANSLATE_NOOP("Sentences",
                      "The library is not sent, because the other one in the sync folder cannot be kept: %1"),
    QT_TRANSLATE_NOOP("Sentences",
                      "The library in the sync folder is not taken over, because this machine's cannot be kept: "
                      "%1"),
    QT_TRANSLATE_NOOP("Sentences", "The library in the sync folder cannot be read and is left alone: %1"),
    QT_TRANSLATE_NOOP("Sentences",
                      "The library was not sent to the sync folder: another machine writes it all the time"),
    QT_TRANSLATE_NOOP("Sentences", "The library was not sent to the sync folder: %1"),
    // Files
    QT_TRANSLATE_NOOP("Sentences", "%1 cannot be read: %2"),
    QT_TRANSLATE_NOOP("Sentences", "%1 cannot be written: %2"),
    QT_TRANSLATE_NOOP("Sentences", "%1 cannot be used: %2"),
};
// NOLINTEND(bugprone-suspicious-missing-comma)

// Numbered as they come.
QString placeholder(qsizetype number) {
    return QLatin1Char('%') + QString::number(number);
}

// The sentence's words between what it quotes.
QStringList wordsOf(const QString& known) {
    QStringList words;
    qsizetype start = 0;
    while (true) {
        const qsizetype end = known.indexOf(placeholder(words.size() + 1), start);
        if (end < 0) break;
        words.push_back(known.mid(start, end - start));
        start = end + 2;
    }
    words.push_back(known.mid(start));
    return words;
}

// What a text quotes in the places of the sentence; nothing when it is another sentence.
std::optional<QStringList> quotedIn(const QString& text, const QString& known) {
    const QStringList words = wordsOf(known);
    if (words.size() == 1) return text == known ? std::optional(QStringList()) : std::nullopt;
    if (!text.startsWith(words.front()) || !text.endsWith(words.back())) return std::nullopt;
    const qsizetype end = text.size() - words.back().size();
    qsizetype start = words.front().size();
    QStringList quoted;
    for (qsizetype i = 1; i + 1 < words.size(); ++i) {
        const qsizetype next = text.indexOf(words[i], start);
        if (next < 0 || next + words[i].size() > end) return std::nullopt;
        quoted.push_back(text.mid(start, next - start));
        start = next + words[i].size();
    }
    if (start > end) return std::nullopt;
    quoted.push_back(text.mid(start, end - start));
    return quoted.contains(QString()) ? std::nullopt : std::optional(quoted);
}

QString translated(const QString& text, int deepest) {
    if (deepest == 0) return text;
    for (const char* known : Known) {
        const auto quoted = quotedIn(text, QString::fromUtf8(known));
        if (!quoted) continue;
        const QStringList words = wordsOf(QCoreApplication::translate(Context, known));
        // A translation that lacks a place, or has them in another order, would lose or mix up what is quoted.
        if (words.size() != quoted->size() + 1) return text;
        QString result = words.front();
        for (qsizetype i = 0; i < quoted->size(); ++i) result += translated((*quoted)[i], deepest - 1) + words[i + 1];
        return result;
    }
    return text;
}

}  // namespace

QString inUsersLanguage(const QString& sentence) {
    return translated(sentence, DeepestQuote);
}

}  // namespace plume
