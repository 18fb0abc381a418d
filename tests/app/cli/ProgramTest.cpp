// The command line, seen from a shell.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <nlohmann/json.hpp>

#include "tests/app/cli/ProgramRun.h"

namespace plume {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::MatchesRegex;
using ::testing::Not;
using ::testing::StartsWith;

// ---- Arguments ----

TEST(Arguments, ThatAreWrongAreToldInOneLineWithTheRightForm) {
    const struct {
        std::vector<std::string> arguments;
        const char* says;
        const char* rightForm;
    } cases[] = {
        {{"exapnd", ";date"}, "exapnd", "plume run|list|search|expand|add|"},
        {{"--verbose"}, "--verbose", "plume run|list|search|expand|add|"},
        {{"run", "--librari", "x"}, "--librari", "plume run [--library FILE.json|FILE.csv]"},
        {{"run", "--library"}, "--library", "[--settings FILE.json]"},
        {{"run", "now"}, "now", "plume run [--library"},
        {{"list", "--settings", "x"}, "--settings", "plume list [--library"},
        {{"search"}, "TEXT", "plume search TEXT"},
        {{"expand"}, "ABBREVIATION", "plume expand ABBREVIATION"},
        {{"expand", "a", "b"}, "b", "plume expand ABBREVIATION"},
        {{"settings", "IsEnabled", "true", "false"}, "false", "plume settings [KEY [VALUE]]"},
        {{"settings", "--default"}, "KEY", "plume settings [KEY [VALUE]]"},
        {{"doctor", "--all"}, "--all", "plume doctor"},
        {{"simulate"}, "FILE", "plume simulate FILE... [--case NAME]"},
        {{"add", "x"}, "TEXT", "plume add ABBREVIATION TEXT"},
        {{"convert", "x"}, "FILES", "plume convert FILE|FOLDER"},
        {{"import", "x", "--placeholders", "mine"}, "--placeholders", "[--placeholders textexpander]"},
    };
    for (const auto& one : cases) {
        const ProgramResult result = ProgramHome().run(one.arguments);
        EXPECT_EQ(result.status, 2) << one.says;
        EXPECT_THAT(result.output, IsEmpty());
        EXPECT_THAT(result.error, AllOf(StartsWith("plume: "), HasSubstr(one.says), HasSubstr(one.rightForm)));
        EXPECT_EQ(std::count(result.error.begin(), result.error.end(), '\n'), 1) << result.error;
    }
}

TEST(Help, HasExamplesOfEveryKind) {
    const ProgramHome home;
    const ProgramResult result = home.run({"--help"});
    EXPECT_EQ(result.status, 0);
    for (const char* example :
         {"plume run ", "plume list ", "plume search arrow", "plume expand ;date", "plume doctor"}) {
        EXPECT_THAT(result.output, HasSubstr(example));
    }
    for (const char* command : {"run", "list", "search", "expand", "settings", "doctor", "simulate"}) {
        const ProgramResult ofCommand = home.run({command, "--help"});
        EXPECT_EQ(ofCommand.status, 0);
        EXPECT_THAT(ofCommand.output, HasSubstr(std::string("plume ") + command));
    }
    EXPECT_THAT(home.run({"--version"}).output, MatchesRegex("plume [0-9]+\\.[0-9]+\\.[0-9]+\n"));
}

// ---- The sample library ----

TEST(SampleLibrary, IsShown) {
    const ProgramResult result = ProgramHome().run({"list"});
    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.error, IsEmpty());
    for (const char* line :
         {"Dates and times (expands as soon as it is typed)", "  ;date   Today", "  btw ", "  ;sig ",
          "  ;->     Arrow right: →\n", "uname -sr  [script]", "please answer by Friday.  [rich text]"}) {
        EXPECT_THAT(result.output, HasSubstr(line));
    }
}

struct SampleExpansion {
    const char* abbreviation;
    const char* output;  // as a regular expression
};

TEST(SampleLibrary, Expands) {
    const ProgramHome home;
    for (const auto& [abbreviation, output] :
         {SampleExpansion{";date", "20[0-9][0-9]-[01][0-9]-[0-3][0-9]\n"},
          SampleExpansion{"date", "20[0-9][0-9]-[01][0-9]-[0-3][0-9]\n"},  // the prefix may be left out
          SampleExpansion{";time", "[0-2][0-9]:[0-5][0-9]\n"}, SampleExpansion{";week", "20[0-9][0-9]-W[0-5][0-9]\n"},
          SampleExpansion{";mon", "20[0-9][0-9]-[01][0-9]-[0-3][0-9]\n"}, SampleExpansion{";->", "→\n"},
          SampleExpansion{"btw", "by the way\n"},
          SampleExpansion{";hi", "Hello,\n(.|\n)*Kind regards,\nJo Doe\n(.|\n)*"},
          SampleExpansion{";warn", "Important: please answer by Friday.\n"}, SampleExpansion{";uuid", "[-0-9a-f]+\n"},
          SampleExpansion{";pass", "[A-Za-z0-9]+\n"}, SampleExpansion{";bug", "System: Linux (.|\n)*"}}) {
        const ProgramResult result = home.run({"expand", abbreviation});
        EXPECT_EQ(result.status, 0) << abbreviation << ' ' << result.error;
        EXPECT_THAT(result.output, MatchesRegex(output)) << abbreviation;
        EXPECT_THAT(result.error, IsEmpty()) << abbreviation;
    }
}

TEST(Expand, SaysWhatItCannotDo) {
    const ProgramHome home;
    const ProgramResult form = home.run({"expand", ";letter"});
    EXPECT_EQ(form.status, 1);
    EXPECT_THAT(form.output, IsEmpty());
    EXPECT_THAT(form.error, HasSubstr("form"));
    const ProgramResult unknown = home.run({"expand", "nothing"});
    EXPECT_EQ(unknown.status, 1);
    EXPECT_THAT(unknown.error, HasSubstr("\"nothing\""));
}

TEST(Expand, FailsWithItsScripts) {
    const ProgramHome home;
    const std::string file = home.write("scripts.json", R"([{"items": [
        {"abbreviation": "shared", "content": "echo out; false", "contentType": 3},
        {"abbreviation": "own", "content": "#!/bin/cat /nowhere", "contentType": 3},
        {"abbreviation": "exit", "content": "exit 3", "contentType": 3},
        {"abbreviation": "exit0", "content": "echo out; exit 0", "contentType": 3},
        {"abbreviation": "nested", "content": "<【snippet:exit】>"},
        {"abbreviation": "apple", "content": "return 1", "contentType": 2}]}])");
    for (const auto& [abbreviation, status] :
         {std::pair{"shared", 1}, {"own", 1}, {"exit", 1}, {"exit0", 0}, {"nested", 1}, {"apple", 1}}) {
        const ProgramResult result = home.run({"expand", abbreviation, "--library", file});
        EXPECT_EQ(result.status, status) << abbreviation;
        EXPECT_EQ(result.error.empty(), status == 0) << abbreviation;
    }
}

TEST(Search, FindsEveryWordAnywhereInASnippet) {
    const ProgramHome home;
    const ProgramResult arrows = home.run({"search", "ARROW left"});
    EXPECT_EQ(arrows.status, 0);
    EXPECT_THAT(arrows.output, AllOf(HasSubstr(";<-"), Not(HasSubstr(";->")), HasSubstr("(Arrows and symbols)")));
    EXPECT_THAT(home.run({"search", "different in every"}).output, HasSubstr(";letter")) << "it stands in the note";
    EXPECT_THAT(home.run({"search", "sampletown"}).output, HasSubstr(";sig")) << "it stands in the content";
    const ProgramResult nothing = home.run({"search", "zebra"});
    EXPECT_EQ(nothing.status, 1);
    EXPECT_THAT(nothing.output, IsEmpty());
    EXPECT_THAT(nothing.error, HasSubstr("zebra"));
}

TEST(Search, ShowsTheBestFirstAndWhatIsLikeItBelow) {
    const ProgramHome home;
    const std::string file = home.write("own.json", R"([{"name": "First", "items": [
        {"abbreviation": "x", "content": "a sig in it"}, {"abbreviation": "sxig", "content": "like it"}]},
        {"name": "Second", "items": [{"abbreviation": "sig", "label": "Mine", "content": "Regards\nJo"}]}])");
    EXPECT_EQ(home.run({"search", "sig", "--library", file}).output,
              "  sig   Mine: Regards\u2009…  (Second)\n"
              "  x     a sig in it  (First)\n"
              "  -- similar --\n"
              "  sxig  like it  (First)\n");
    const ProgramResult json = home.run({"search", "sig", "--library", file, "--json"});
    EXPECT_EQ(json.status, 0);
    const auto rows = nlohmann::json::parse(json.output);
    ASSERT_EQ(rows.size(), 3U);
    EXPECT_EQ(rows[0]["abbreviation"], "sig");
    EXPECT_EQ(rows[0]["label"], "Mine");
    EXPECT_EQ(rows[0]["group"], "Second");
    EXPECT_EQ(rows[0]["content"], "Regards");
    EXPECT_EQ(rows[0]["uuid"].get<std::string>().size(), 36U);
    EXPECT_EQ(rows[0]["loose"], false);
    EXPECT_EQ(rows[2]["loose"], true);
    const ProgramResult nothing = home.run({"search", "zebra", "--library", file, "--json"});
    EXPECT_EQ(nothing.status, 1);
    EXPECT_EQ(nothing.output, "[]\n");
}

TEST(Search, GoesByTheSettingsForTheUsersLibraryAlone) {
    const ProgramHome home;
    const std::string file =
        home.write("own.json", R"([{"name": "A", "items": [{"abbreviation": "b", "content": "key"}]}])");
    EXPECT_THAT(home.run({"search", "sampletown"}).output, HasSubstr(";sig"));
    home.run({"settings", "SnippetQuickSearchSearchBy", "1"});
    home.run({"settings", "SnippetQuickSearchWildcardSearch", "1"});
    EXPECT_EQ(home.run({"search", "sampletown"}).status, 1);
    EXPECT_THAT(home.run({"search", ";s?g"}).output, HasSubstr(";sig"));
    EXPECT_THAT(home.run({"search", "key", "--library", file}).output, HasSubstr("b  key  (A)"));
}

// ---- Other libraries ----

TEST(Library, OfTheUserComesBeforeTheSample) {
    const ProgramHome home;
    home.write("config/plume/library.json",
               R"([{"name": "Own", "items": [{"abbreviation": "aa", "content": "mine"}]}])");
    EXPECT_EQ(home.run({"expand", "aa"}).output, "mine\n");
    EXPECT_THAT(home.run({"list"}).output, Not(HasSubstr("Arrows")));
}

TEST(Library, ThatIsDamagedIsNeverReplacedByAnother) {
    const ProgramHome home;
    const std::string file = home.write("config/plume/library.json", R"([{"items": [{"abbreviation": 5}]}])");
    for (const char* command : {"list", "backup"}) {
        const ProgramResult result = home.run({command});
        EXPECT_NE(result.status, 0);
        EXPECT_THAT(result.output, IsEmpty());
        EXPECT_THAT(result.error, AllOf(HasSubstr(file), HasSubstr("abbreviation")));
    }
}

// ---- The user's own library ----

std::string lastLineOf(const std::string& text) {
    const std::size_t end = text.find_last_not_of('\n');
    return text.substr(text.rfind('\n', end) + 1, end - text.rfind('\n', end));
}

TEST(OwnLibrary, KeepsWhatIsAddedRemovedAndRestored) {
    const ProgramHome home;
    EXPECT_EQ(home.run({"add", "omw", "on my way", "--group", "Short", "--label", "Coming"}).status, 0);
    EXPECT_EQ(home.run({"expand", "omw"}).output, "on my way\n");
    EXPECT_THAT(home.run({"add", "omw", "again", "--group", "Short"}).error,
                HasSubstr("\"Short\" has \"omw\" already"));
    EXPECT_EQ(home.run({"backups"}).status, 1);
    const std::string backup = lastLineOf(home.run({"backup"}).output);
    EXPECT_THAT(home.run({"remove", "omw"}).output, HasSubstr("gone"));
    EXPECT_EQ(home.run({"expand", "omw"}).status, 1);
    EXPECT_EQ(home.run({"remove", "omw"}).status, 1);
    EXPECT_THAT(home.run({"restore", "latest"}).output, HasSubstr(backup));
    EXPECT_EQ(home.run({"expand", "omw"}).output, "on my way\n");
    EXPECT_THAT(home.run({"backups"}).output, HasSubstr(backup));
}

TEST(OwnLibrary, TakesFilesInAndGivesThemOut) {
    const ProgramHome home;
    const std::string csv = home.write("words.csv", "brb,be right back,Away\n");
    const std::string bad = home.write("bad.json", "[\n{\"items\": [{\"abbreviation\": 5}]}]");
    const ProgramResult imported = home.run({"import", bad, csv});
    EXPECT_EQ(imported.status, 2);
    EXPECT_THAT(imported.error, AllOf(HasSubstr(bad + ": line 2, at $[0].items[0].abbreviation: expected")));
    EXPECT_THAT(imported.output, HasSubstr("1 snippet from " + csv));
    const std::string folder = csv.substr(0, csv.rfind('/') + 1);
    EXPECT_EQ(home.run({"export", folder + "group.csv", "--group", "words"}).status, 0);
    EXPECT_EQ(home.run({"export", folder + "all.plume", "--with-preferences"}).status, 0);
    EXPECT_EQ(home.run({"convert", folder + "all.plume", folder + "all.json"}).status, 0);
    EXPECT_EQ(home.run({"expand", "brb", "--library", folder + "group.csv"}).output, "be right back\n");
    EXPECT_EQ(home.run({"expand", "brb", "--library", folder + "all.json"}).output, "be right back\n");
    for (const std::vector<std::string>& wrong : {std::vector<std::string>{"export", folder + "all.txt"},
                                                  {"export", folder + "x.csv", "--with-preferences"},
                                                  {"export", folder + "x.csv", "--group", "none"},
                                                  {"convert", csv, folder + "x.doc"},
                                                  {"restore", bad}}) {
        EXPECT_EQ(home.run(wrong).status, 2) << wrong[1];
    }
}

TEST(OwnLibrary, IsEditedAsTextWithoutLosingIt) {
    ProgramHome home;
    EXPECT_EQ(home.run({"add", "omw", "on my way"}).status, 0);
    home.set("VISUAL", "sed -i 's/on my way/coming/'");
    EXPECT_THAT(home.run({"edit"}).output, HasSubstr("is changed"));
    EXPECT_EQ(home.run({"expand", "omw"}).output, "coming\n");
    EXPECT_THAT(home.run({"edit"}).output, HasSubstr("Nothing has changed"));
    home.set("VISUAL", "sed -i 's/\"abbreviation\": \"omw\"/\"abbreviation\": 5/'");
    const ProgramResult wrong = home.run({"edit"});
    EXPECT_EQ(wrong.status, 2);
    EXPECT_THAT(wrong.error, AllOf(HasSubstr(": line "), HasSubstr("your text is in ")));
    EXPECT_EQ(home.run({"expand", "omw"}).output, "coming\n");
    home.set("VISUAL", "false");
    EXPECT_EQ(home.run({"edit"}).status, 1);
}

TEST(OwnLibrary, ThatIsDamagedIsKeptAsideAndTheWayBackIsTold) {
    const ProgramHome home;
    EXPECT_EQ(home.run({"add", "omw", "on my way"}).status, 0);
    const std::string backup = lastLineOf(home.run({"backup"}).output);
    home.write("config/plume/plume.sqlite3", "no database");
    const ProgramResult listed = home.run({"list"});
    EXPECT_THAT(listed.error, AllOf(HasSubstr("damaged"), HasSubstr(backup)));
    EXPECT_THAT(listed.output, IsEmpty());
    EXPECT_EQ(home.run({"restore", "latest"}).status, 0);
    EXPECT_EQ(home.run({"expand", "omw"}).output, "on my way\n");
}

TEST(Library, MayBeSeparatedValues) {
    const ProgramHome home;
    const std::string file = home.write("words.CSV", "brb,\"be right back, soon\",Away\nomw,on my way\n");
    const ProgramResult listed = home.run({"list", "--library", file});
    EXPECT_EQ(listed.status, 0) << listed.error;
    EXPECT_THAT(listed.output, AllOf(StartsWith("words ("), HasSubstr("  brb  Away: be right back, soon\n")));
    EXPECT_EQ(home.run({"expand", "omw", "--library", file}).output, "on my way\n");
}

TEST(Library, ThatCannotBeReadIsToldByName) {
    const ProgramHome home;
    for (const std::string& file : {std::string("/no/such/file.json"), home.write("empty.csv", ""),
                                    home.write("broken.json", "[{]"), std::string("/tmp")}) {
        const ProgramResult result = home.run({"list", "--library", file});
        EXPECT_EQ(result.status, 2) << file;
        EXPECT_THAT(result.error, HasSubstr(file));
    }
}

// ---- On a desktop that is none ----

TEST(Run, WithoutADisplaySaysWhatIsMissing) {
    const ProgramResult result = ProgramHome().run({"run"});
    EXPECT_EQ(result.status, 3);
    EXPECT_THAT(result.output, IsEmpty());
    EXPECT_THAT(result.error, HasSubstr("DISPLAY"));
}

TEST(Run, ReadsItsSettingsFirst) {
    const ProgramHome home;
    const std::string file = home.write("settings.json", R"({"LongTextLength": "long"})");
    const ProgramResult result = home.run({"run", "--settings", file});
    EXPECT_EQ(result.status, 2);
    EXPECT_THAT(result.error, AllOf(HasSubstr(file), HasSubstr("LongTextLength")));
}

// ---- Settings ----

TEST(Settings, AreShownChangedAndTakenBack) {
    const ProgramHome home;
    const struct {
        std::vector<std::string> change;
        std::string shown;
    } cases[] = {
        {{"IsEnabled"}, "true"},
        {{"IsEnabled", "false"}, "false"},
        {{"FeedbackSound", "Pop"}, "Pop"},
        {{"FeedbackSound", "5"}, "5"},
        {{"FontSizeDelta", "-2"}, "-2"},
        {{"RestoreClipboardDelay", "1"}, "1.0"},
        {{"UseClipboardApplications", R"(["a", "b"])"}, R"(["a","b"])"},
        {{"CustomApplicationSettings", R"({"xterm": {}})"}, R"({"xterm":{}})"},
        {{"LastBackupTime", "2026-01-31T18:30:00Z"}, "2026-01-31T18:30:00Z"},
        {{"IsEnabled", "--default"}, "true"},
        {{"UndoHotKey"}, ""},
    };
    for (const auto& [change, shown] : cases) {
        std::vector<std::string> arguments{"settings"};
        arguments.insert(arguments.end(), change.begin(), change.end());
        if (change.size() > 1) {
            const ProgramResult changed = home.run(arguments);
            EXPECT_EQ(changed.status, 0);
            EXPECT_EQ(changed.output + changed.error, "");
        }
        EXPECT_THAT(home.run({"settings", change.front()}).output, HasSubstr(shown + (shown.empty() ? "" : "\n")));
    }
    EXPECT_THAT(home.run({"settings"}).output,
                AllOf(HasSubstr("\n* FeedbackSound                         \"5\"\n"),
                      HasSubstr("\n  BackupQuantity                        10\n"), HasSubstr("\n  UndoHotKey\n")));
}

TEST(Settings, AreCheckedBeforeTheyAreKept) {
    const ProgramHome home;
    const struct {
        std::vector<std::string> arguments;
        const char* says;
    } cases[] = {
        {{"settings", "Nonsense", "1"}, "there is no setting \"Nonsense\""},
        {{"settings", "IsEnabled", "yes"}, "$.IsEnabled: expected true or false"},
        {{"settings", "BackupQuantity", "-1"}, "$.BackupQuantity: expected a whole number of at least 0"},
        {{"settings", "UseClipboardApplications", "[1]"}, "$.UseClipboardApplications[0]: expected a string"},
        {{"settings", "RestoreClipboardDelay", "1e999"}, "expected a number from 0"},
        {{"settings", "IsEnabled", "true, \"FeedbackSound\": true"}, "expected true or false"},
    };
    for (const auto& [arguments, says] : cases) {
        const ProgramResult result = home.run(arguments);
        EXPECT_EQ(result.status, 2) << says;
        EXPECT_THAT(result.error, AllOf(StartsWith("plume: "), HasSubstr(says)));
        EXPECT_EQ(std::count(result.error.begin(), result.error.end(), '\n'), 1) << result.error;
    }
    EXPECT_THAT(home.run({"settings"}).output, Not(HasSubstr("\n* ")));
}

TEST(Settings, TellOfADamagedStore) {
    const ProgramHome home;
    home.write("config/plume/plume.sqlite3", "no database");
    const ProgramResult result = home.run({"settings", "IsEnabled"});
    EXPECT_EQ(result.status, 0);
    EXPECT_EQ(result.output, "true\n");
    EXPECT_THAT(result.error, HasSubstr("plume.sqlite3 was damaged; it is kept as plume.sqlite3.damaged-"));
}

TEST(Doctor, FindsWhatIsMissing) {
    const ProgramResult result = ProgramHome().run({"doctor"});
    EXPECT_EQ(result.status, 3);
    EXPECT_THAT(result.output, AllOf(HasSubstr("MISSING display"), HasSubstr("ok      library: "),
                                     HasSubstr("warning accessibility"), HasSubstr("cannot work here")));
}

// ---- Scenarios ----

TEST(Simulate, TellsTheOutcomeAndTheGravestFault) {
    const ProgramHome home;
    const std::string library =
        R"("library": [{"expandTrigger": 0, "items": [{"abbreviation": "sig", "content": "Jo"}]}])";
    const std::string steps = R"("steps": [{"type": "sig"}])";
    const std::string right = home.write("right.json", "{" + library + "," + steps + R"(, "expect": {"text": "Jo"}})");
    const std::string other = home.write("other.json", "{" + library + "," + steps + R"(, "expect": {"text": "No"}})");
    const std::string wrong = home.write("wrong.json", R"({"stepz": []})");

    const ProgramResult good = home.run({"simulate", right});
    EXPECT_EQ(good.status, 0) << good.error;
    EXPECT_THAT(good.output, HasSubstr("\"text\": \"Jo\""));
    EXPECT_THAT(good.error, IsEmpty());

    const ProgramResult different = home.run({"simulate", right, other});
    EXPECT_EQ(different.status, 1);
    EXPECT_THAT(different.error, AllOf(HasSubstr("Jo"), HasSubstr("No")));

    const std::string cases = home.write("cases.json", "{" + library + R"(, "cases": [{"name": "right", )" + steps +
                                                           R"(}, {"name": "other", "expect": {"text": "No"}}]})");
    EXPECT_EQ(home.run({"simulate", cases}).status, 1);
    EXPECT_EQ(home.run({"simulate", cases, "--case", "right"}).status, 0);

    const ProgramResult faulty = home.run({"simulate", wrong, other, right, "/no/such/file.json"});
    EXPECT_EQ(faulty.status, 2);
    EXPECT_THAT(faulty.error, AllOf(HasSubstr("stepz"), HasSubstr(wrong), HasSubstr("/no/such/file.json")));
}

TEST(Simulate, WritesDatesAndNumbersAsTheUserReadsThem) {
    ProgramHome home;
    home.set("LANG", "en_US.UTF-8");
    home.set("LC_TIME", "de_DE.UTF-8");
    home.set("LC_NUMERIC", "fr_FR.UTF-8");
    const std::string scenario = home.write("user.json", R"({
        "library": [{"expandTrigger": 0, "items": [{"abbreviation": "q",
            "content": "【date:full】 【field:a type:3 value:2,5】 【field:b type:3 value:a+1】"}]}],
        "now": "2026-03-09T14:05:06", "timeZone": "UTC",
        "steps": [{"type": "q"}, {"form": {}}],
        "expect": {"text": "Montag, 9. März 2026 2,5 3,5"}})");
    const ProgramResult result = home.run({"simulate", scenario});
    EXPECT_EQ(result.status, 0) << result.error;
}

}  // namespace
}  // namespace plume
