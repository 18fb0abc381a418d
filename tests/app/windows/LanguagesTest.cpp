// The smaller windows in other languages: whether all of their texts are, and have the place that they need.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QLineEdit>
#include <QMessageBox>
#include <QPointer>
#include <memory>

#include "app/ReportLog.h"
#include "app/windows/AboutWindow.h"
#include "app/windows/DecisionWords.h"
#include "app/windows/DiagnosticWindow.h"
#include "app/windows/FileUseQuestion.h"
#include "app/windows/FirstSyncWindow.h"
#include "app/windows/NewSnippetWindow.h"
#include "app/windows/PromptWindow.h"
#include "app/windows/ReportsWindow.h"
#include "app/windows/RestoreWindow.h"
#include "app/windows/WelcomeWindow.h"
#include "tests/app/windows/WindowsSupport.h"
#include "tests/library/LibraryMachine.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using namespace test;
using ::testing::HasSubstr;

class LanguagesTest : public ::testing::TestWithParam<const char*> {
  protected:
    LanguagesTest() { machine.load(); }

    // Has the window for as long as somebody looks at it.
    std::string look(QWidget* made, const char* name) {
        const std::unique_ptr<QWidget> window(made);
        bringToFront(*window);
        activate(*window);
        takePicture(*window, QString::fromLatin1(name) + QLatin1Char('-') + QLatin1String(GetParam()));
        Mnemonics().addAll(*window);
        EXPECT_LE(window->minimumSizeHint().width(), 1024) << name;
        EXPECT_LE(window->minimumSizeHint().height(), 700) << name;
        return window->windowTitle().toStdString() + "\n" + textOf(*window);
    }
    static const char* say(const char* german, const char* french) {
        return std::string(GetParam()) == "de" ? german : french;
    }

    const SpokenLanguage spoken{QString::fromLatin1(GetParam())};
    SharedWorld world;
    Machine machine{world};
};

TEST_P(LanguagesTest, WindowsOfTheLibrary) {
    EXPECT_THAT(look(new NewSnippetWindow(*machine.manager, {}, machine.settings), "NewSnippet"),
                HasSubstr(say("&Kürzel:", "&Abréviation\u202F:")));
    EXPECT_THAT(look(new RestoreDataWindowController(*machine.manager, world.files, machine.settings), "Restore"),
                HasSubstr(say("Wiederherstellen\n", "Restaurer\n")));
    const auto ignore = [](int /*answer*/) {};
    EXPECT_THAT(look(new InitalSyncWindowController("/home/me/Dropbox", ignore), "FirstSync"),
                HasSubstr(say("„Dropbox“", "«\u202FDropbox\u202F»")));
    EXPECT_THAT(look(askForFileUse("/home/me/old.plume", [](auto) {}), "FileUse"),
                HasSubstr(say("Daten aus old.plume", "les données de old.plume")));
}

TEST_P(LanguagesTest, WindowsOfTheProgram) {
    WelcomeServices services;
    services.trials = {{u";sig", u"Kind regards"}, {u";date", u"23 November 2026"}};
    services.foundLibraries = {{u"Other Program", "/home/me/.config/other"}};
    services.startsAtLogin = [] { return true; };
    EXPECT_THAT(look(new WelcomeWindow(services, machine.settings), "Welcome"),
                HasSubstr(say("wird zu „Kind regards“", "devient «\u202FKind regards\u202F»")));
    ReportLog reports;
    reports.add("Something happened.");
    reports.add("Something happened.");
    EXPECT_THAT(look(new ReportsWindow(reports, machine.settings), "Reports"),
                HasSubstr(say("Neueste Meldungen", "Rapports récents")));
    EXPECT_THAT(look(new PromptWindow(
                         Error{"Something is missing."}, [] { return Result<void>(); }, [] {}),
                     "Prompt"),
                HasSubstr(say("noch keine Kürzel", "pas encore développer")));
    EXPECT_THAT(look(new AboutWindow("1.0", machine.settings), "About"), HasSubstr(say("Über Plume", "À propos")));
    EXPECT_THAT(look(new DiagnosticWindow("all is well"), "Diagnostics"),
                HasSubstr(say("Dieser Bericht", "Ce rapport")));
}

TEST_P(LanguagesTest, WhatBecameOfAnAbbreviation) {
    MatchDecision decision;
    decision.abbreviation = u"brb";
    decision.application = u"xterm";
    decision.outcome = MatchDecision::Outcome::Expanded;
    EXPECT_EQ(DecisionWords::of(decision).sentence,
              say("Das Kürzel „brb“ wurde in xterm ersetzt.",
                  "L’abréviation «\u202Fbrb\u202F» a été développée dans xterm."));
    decision.outcome = MatchDecision::Outcome::WrongApplication;
    EXPECT_EQ(
        DecisionWords::of(decision).sentence,
        say("Das Kürzel „brb“ wurde nicht ersetzt: die Gruppe gilt nicht für xterm.",
            "L’abréviation «\u202Fbrb\u202F» n’a pas été développée\u202F: le groupe n’est pas prévu pour xterm."));
}

INSTANTIATE_TEST_SUITE_P(Languages, LanguagesTest, ::testing::Values("de", "fr"),
                         [](const auto& language) { return std::string(language.param); });

}  // namespace
}  // namespace plume
