#include "testing/real/Story.h"

namespace plume::real {

const std::string CopiedBefore = "copied before";

namespace {

constexpr int LongRepeats = 30;

std::string longText() {
    std::string text;
    for (int i = 0; i < LongRepeats; ++i) text += "The quick brown fox jumps over lazy dogs. ";
    return text + "End";
}

// No story starts with a small letter or ends a sentence: office programs would write capitals of their own.
std::vector<Story> makeStories() {
    const std::string wide = "Hello, wide world";
    const std::string address = "Jo Doe\n1 Sample Street\nSampletown";
    return {
        {"word, kept delimiter", "So btw ", "So by the way "},
        {"symbol inside a line", std::string("So on") + LeftKey + LeftKey + ";ww", "So " + wide + "on"},
        {"typing on at once", "So ;ww and so on btw and so on", "So " + wide + " and so on by the way and so on"},
        {"keys that overlap", "So ;ww and so on btw and so on", "So " + wide + " and so on by the way and so on",
         Needs::Nothing, Typing::RollingOver},
        {"two in a row", "So ;ww;ww btw btw ", "So " + wide + wide + " by the way by the way "},
        {"caret", "So ;tagbold", "So <b>bold</b>"},
        {"several lines", "So ;adr and on", "So " + address + " and on", Needs::Lines},
        {"several lines, indented", "So\n    on\n;adr", "So\n    on\n" + address, Needs::Indentation},
        {"1,200 characters", "So ;long and on", "So " + longText() + " and on"},
        {"beyond U+FFFF", "So ;emo and on", "So 😀👍 and on"},
        {"characters on no key", "So ;uni and on", "So naïve Ünïcödé — 日本語 【】 and on"},
        {"rich text", "So ;rich and on", "So bold and plain and on"},
        {"clipboard", "So ;rich and on", CopiedBefore, Needs::Nothing, Typing::AtOnce, Then::ReadClipboard},
        {"undo", "So btw ", "So btw ", Needs::Nothing, Typing::AtOnce, Then::Undo},
        {"password", "So ;ww btw ", "So ;ww btw ", Needs::Password},
        {"password, behind a Tab", std::string(1, FieldBefore) + "\t;ww btw ", ";ww btw ", Needs::Password},
        {"proposals", "btw and on", "by the way and on", Needs::Proposals},
        {"proposals, overlapping", "btw and on", "by the way and on", Needs::Proposals, Typing::RollingOver},
        {"proposals, typed slowly", "btw and on", "by the way and on", Needs::Proposals, Typing::Slowly},
        {"proposals, undo", "btw ", "btw ", Needs::Proposals, Typing::Slowly, Then::Undo},
    };
}

}  // namespace

const std::vector<Story>& stories() {
    static const std::vector<Story> all = makeStories();
    return all;
}

std::string library() {
    return R"json([
  { "name": "At once", "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "ww", "content": "Hello, wide world" },
      { "abbreviation": "tag", "content": "<b>【|】</b>" },
      { "abbreviation": "adr", "content": "Jo Doe\n1 Sample Street\nSampletown" },
      { "abbreviation": "emo", "content": "😀👍" },
      { "abbreviation": "uni", "content": "naïve Ünïcödé — 日本語 【】" },
      { "abbreviation": "rich", "contentType": 1, "rtf": "{\\rtf1\\ansi \\b bold\\b0  and plain}" },
      { "abbreviation": "long", "content": ")json" +
           longText() + R"json(" } ] },
  { "name": "Words", "expandTrigger": 1, "items": [
      { "abbreviation": "btw", "caseSensitivity": 2, "content": "by the way" } ] }
])json";
}

std::string settings(const std::string& rows) {
    // The undo key is Control+Alt+Z.
    return R"({ "PlayFeedbackSound": false, "LetProgramsTellPasswordFields": true, "UndoHotKey": 25769803782,
  "CustomApplicationSettings": )" +
           rows + "}";
}

}  // namespace plume::real
