#include "app/qt/Sentences.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QTranslator>

#include "app/qt/Translations.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

class SentencesTest : public testing::Test {
  protected:
    SentencesTest() { installTranslations(*qApp, test::translationFolder(), {"de"}); }
    ~SentencesTest() override { qDeleteAll(qApp->findChildren<QTranslator*>(Qt::FindDirectChildrenOnly)); }

    static std::string german(const std::string& sentence) { return inUsersLanguage(sentence).toStdString(); }
};

TEST_F(SentencesTest, AreKnownByTheirWords) {
    const struct {
        const char* said;
        const char* german;
    } sentences[] = {
        {"Plume does not listen", "Plume hört nicht zu"},
        {"The snippet \"a%1\" has fields to fill in, and there is no form here to do it.",
         "Das Snippet „a%1“ hat Felder zum Ausfüllen, und es gibt hier kein Formular dafür."},
        {"The library cannot be read: line 3: expected a list. It is kept in /home/ä/x.plume.",
         "Die Bibliothek kann nicht gelesen werden: line 3: expected a list. Sie liegt in /home/ä/x.plume."},
        // What is quoted, too
        {"A script was ended because it ran longer than 5 seconds.",
         "Ein Skript wurde beendet, weil es länger als 5 Sekunden lief."},
        {"No backup was made: /a: b cannot be written: /x is full",
         "Es wurde keine Sicherung angelegt: /a: b kann nicht geschrieben werden: /x is full"},
        // Nothing known
        {"", ""},
        {"Restored", "Restored"},
        {"The snippet \"x\" sings.", "The snippet \"x\" sings."},
        {" cannot be written: ", " cannot be written: "},
    };
    for (const auto& each : sentences) EXPECT_EQ(german(each.said), each.german);
}

TEST_F(SentencesTest, LongOnesAreNoTrouble) {
    const std::string all(1'000'000, ':');
    EXPECT_EQ(german("No backup was made: " + all), "Es wurde keine Sicherung angelegt: " + all);
    std::string nested = "x";
    for (int i = 0; i < 1'000; ++i) nested = "No backup was made: " + nested;
    EXPECT_TRUE(german(nested).starts_with("Es wurde keine Sicherung angelegt: Es wurde keine")) << german(nested);
}

}  // namespace
}  // namespace plume
