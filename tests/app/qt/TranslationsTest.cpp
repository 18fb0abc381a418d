#include "app/qt/Translations.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QTranslator>
#include <string>

#include "tests/support/Language.h"

namespace plume {
namespace {

class TranslationsTest : public testing::Test {
  protected:
    ~TranslationsTest() override { qDeleteAll(qApp->findChildren<QTranslator*>(Qt::FindDirectChildrenOnly)); }

    static std::string quit() { return QCoreApplication::translate("plume::StatusMenu", "&Quit Plume").toStdString(); }
    static std::string quitFor(const QStringList& languages) {
        installTranslations(*qApp, test::translationFolder(), languages);
        const std::string text = quit();
        qDeleteAll(qApp->findChildren<QTranslator*>(Qt::FindDirectChildrenOnly));
        return text;
    }
};

TEST_F(TranslationsTest, WindowsSpeakTheFirstOfTheUsersLanguagesThatIsThere) {
    EXPECT_EQ(quitFor({"de-DE", "de", "de-Latn-DE"}), "&Plume beenden");
    EXPECT_EQ(quitFor({"de-AT"}), "&Plume beenden");
    EXPECT_EQ(quitFor({"fr_CA", "en"}), "&Quitter Plume");
    EXPECT_EQ(quitFor({"pt-BR", "tlh", "fr", "de"}), "&Quitter Plume");
}

TEST_F(TranslationsTest, EnglishIsALanguageOfTheUsersToo) {
    EXPECT_EQ(quitFor({"en-US", "de"}), "&Quit Plume");
    EXPECT_EQ(quitFor({"C", "de"}), "&Quit Plume");
    EXPECT_EQ(quitFor({"pt-BR"}), "&Quit Plume");
    EXPECT_EQ(quitFor({"", "../de", "de/../../plume_de"}), "&Quit Plume");
    EXPECT_EQ(quitFor({}), "&Quit Plume");
}

TEST_F(TranslationsTest, AMissingFolderLeavesEnglish) {
    installTranslations(*qApp, "/nowhere/at all", {"de"});
    installTranslations(*qApp, {}, {"de"});
    EXPECT_EQ(quit(), "&Quit Plume");
}

TEST_F(TranslationsTest, NumbersHaveTheirForms) {
    const auto snippets = [](int count) {
        return QCoreApplication::translate("plume::RestoreDataWindowController",
                                           "Your %n snippets are replaced by what this backup holds:", "", count)
            .section(u' ', 0, 3)
            .toStdString();
    };
    installTranslations(*qApp, test::translationFolder(), {"fr"});
    EXPECT_EQ(snippets(0), "Votre 0 extrait est");
    EXPECT_EQ(snippets(2), "Vos 2 extraits sont");
}

}  // namespace
}  // namespace plume
