// The clipboard among other programs: what they are given, what is read from them, and who counts as having taken it.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <future>
#include <map>
#include <mutex>

#include "Foundation/Strings.h"
#include "ports/x11/clipboard/SharedClipboardCopy.h"
#include "ports/x11/clipboard/X11Pasteboard.h"
#include "ports/x11/clipboard/X11SelectionTypes.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/SelectionClients.h"
#include "testing/rig/SessionThread.h"

namespace plume::rig {

namespace {

using std::chrono::duration_cast;
using std::chrono::milliseconds;
using std::chrono::steady_clock;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;

const std::string String(PasteboardType::String);
const std::string RTF(PasteboardType::RTF);
const std::string RTFD(PasteboardType::RTFD);
const std::string HTML(PasteboardType::HTML);

constexpr std::size_t TwentyMegabytes = 20'000'000;

SelectionData utf8(std::string text) {
    return {"UTF8_STRING", 8, std::move(text)};
}

template <typename Call>
milliseconds timeOf(Call call) {
    const auto start = steady_clock::now();
    call();
    return duration_cast<milliseconds>(steady_clock::now() - start);
}

// Promises content, and notes what it was asked for and what was taken.
class NotingOwner final : public PasteboardOwner {
  public:
    using Contents = std::map<std::string, std::string, std::less<>>;

    explicit NotingOwner(Contents contents) : contents_(std::move(contents)) {}

    void provideData(Pasteboard& pasteboard, std::string_view type) override {
        const auto found = contents_.find(type);
        if (found != contents_.end()) pasteboard.setData(found->second, type);
    }
    void dataWasTaken(std::string_view type) override {
        const std::lock_guard lock(mutex_);
        taken_.emplace_back(type);
        changed_.notify_all();
    }

    // What was taken, once that is at least so many.
    std::vector<std::string> awaitTaken(std::size_t count) {
        std::unique_lock lock(mutex_);
        changed_.wait_for(lock, std::chrono::seconds(10), [&] { return taken_.size() >= count; });
        return taken_;
    }

  private:
    const Contents contents_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<std::string> taken_;
};

class X11PasteboardTest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        thread_ = std::make_unique<SessionThread>(display());
        pasteboard_ = thread_->run([&] { return std::move(X11Pasteboard::open(thread_->session())).value(); });
    }
    void TearDown() override {
        thread_->end();
        pasteboard_.reset();
        thread_.reset();
        awaitNoOwner();
    }

    static const std::string& display() { return rig_->server().display(); }
    static void awaitNoOwner() {
        rig_->client().await("a clipboard without owner", Milliseconds(10'000), [] {
            return rig_->client().selectionOwner("CLIPBOARD") == 0 && rig_->client().selectionOwner("PRIMARY") == 0;
        });
    }

    // Lives until the loop has ended: what was taken may be told behind a test's last line.
    NotingOwner& makeOwner(NotingOwner::Contents contents) {
        return *owners_.emplace_back(std::make_unique<NotingOwner>(std::move(contents)));
    }
    std::int64_t declare(const std::vector<std::string>& types, PasteboardOwner* owner) {
        return thread_->run([&] { return pasteboard_->declareTypes(types, owner); });
    }
    // Writes a plain text, without an owner.
    void write(std::u16string_view text) {
        thread_->run([&] {
            pasteboard_->declareTypes({std::string(PasteboardType::String)}, nullptr);
            pasteboard_->setString(text, PasteboardType::String);
        });
    }
    std::int64_t changeCount() {
        return thread_->run([&] { return pasteboard_->changeCount(); });
    }
    void awaitChangeAfter(std::int64_t count) {
        rig_->client().await("a change of the clipboard", Milliseconds(10'000), [&] { return changeCount() > count; });
    }
    std::vector<std::string> types() {
        return thread_->run([&] { return pasteboard_->types(); });
    }
    std::optional<std::u16string> string() {
        return thread_->run([&] { return pasteboard_->string(); });
    }
    std::optional<std::string> data(std::string_view type) {
        return thread_->run([&] { return pasteboard_->data(type); });
    }
    // Another program copies, and the pasteboard knows.
    std::unique_ptr<ForeignOwner> copyElsewhere(SelectionOffer offer, ForeignOwner::Options options = {}) {
        const std::int64_t before = changeCount();
        auto owner = std::make_unique<ForeignOwner>(display(), std::move(offer), std::move(options));
        awaitChangeAfter(before);
        return owner;
    }

    // Whether the keystroke is sent at once.
    bool startsPaste() {
        return thread_->run([&] {
            pasted_ = false;
            pasteboard_->paste([&] { pasted_ = true; });
            return pasted_;
        });
    }
    void awaitPaste() {
        const auto isPasted = [&] { return thread_->run([&] { return pasted_; }); };
        rig_->client().await("the keystroke", Milliseconds(10'000), isPasted);
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    bool pasted_ = false;  // the tap thread's
    std::vector<std::unique_ptr<NotingOwner>> owners_;
    std::unique_ptr<SessionThread> thread_;
    std::unique_ptr<X11Pasteboard> pasteboard_;
};

// Bytes that are not alike anywhere, so that a lost or swapped piece shows.
std::string unevenBytes(std::size_t size) {
    std::string bytes(size, '\0');
    std::uint32_t state = 1;
    for (char& byte : bytes) {
        state = state * 1664525 + 1013904223;
        byte = static_cast<char>(state >> 24);
    }
    return bytes;
}

// ---- Offering ----

TEST_F(X11PasteboardTest, OffersWrittenTextUnderTheNamesProgramsAskFor) {
    write(u"na\u00efve \u65e5");
    SelectionRequestor program(display());
    EXPECT_THAT(program.targets("CLIPBOARD"), ElementsAre("TARGETS", "TIMESTAMP", "MULTIPLE", "UTF8_STRING",
                                                          "text/plain;charset=utf-8", "text/plain", "STRING"));
    for (const char* target : {"UTF8_STRING", "text/plain;charset=utf-8", "text/plain"}) {
        EXPECT_EQ(program.request("CLIPBOARD", target), (SelectionData{target, 8, "na\u00efve \u65e5"}));
    }
    EXPECT_EQ(program.request("CLIPBOARD", "STRING"), (SelectionData{"STRING", 8, "na\xefve ?"}));
    EXPECT_EQ(program.request("CLIPBOARD", "image/png"), std::nullopt);
    const auto time = program.request("CLIPBOARD", "TIMESTAMP");
    ASSERT_TRUE(time);
    EXPECT_NE(wordsOf(time->bytes).at(0), 0U);
}

TEST_F(X11PasteboardTest, AnswersSeveralTargetsAtOnceAndNamesTheMissing) {
    write(u"text");
    SelectionRequestor program(display());
    const auto values = program.requestMultiple("CLIPBOARD", {"UTF8_STRING", "image/png", "STRING"});
    EXPECT_EQ(values, (std::map<std::string, SelectionData>{{"UTF8_STRING", utf8("text")},
                                                            {"STRING", SelectionData{"STRING", 8, "text"}}}));
}

TEST_F(X11PasteboardTest, GivesTwentyMegabytesInPiecesToSeveralProgramsAtOnce) {
    const std::string bytes = unevenBytes(TwentyMegabytes);
    thread_->run([&] {
        pasteboard_->declareTypes({"image/png"}, nullptr);
        pasteboard_->setData(bytes, "image/png");
    });
    const auto read = [&] {
        SelectionRequestor program(display());
        const auto value = program.request("CLIPBOARD", "image/png");
        return value && value->bytes == bytes && program.pieces() > 1;
    };
    std::vector<std::future<bool>> readers;
    for (int i = 0; i < 3; ++i) readers.push_back(std::async(std::launch::async, read));
    for (auto& reader : readers) EXPECT_TRUE(reader.get());
}

TEST_F(X11PasteboardTest, RequestorsThatStopOrDieHarmNobody) {
    const std::string large = unevenBytes(3'000'000);
    thread_->run([&] {
        pasteboard_->declareTypes({"image/png"}, nullptr);
        pasteboard_->setData(large, "image/png");
    });
    SelectionRequestor stopped(display());
    stopped.requestAndStop("CLIPBOARD", "image/png");
    for (int i = 0; i < 3; ++i) {
        SelectionRequestor dying(display());
        dying.requestAndStop("CLIPBOARD", "image/png");
    }
    SelectionRequestor alive(display());
    EXPECT_EQ(alive.request("CLIPBOARD", "image/png")->bytes, large);
    EXPECT_EQ(stopped.request("CLIPBOARD", "image/png")->bytes, large);
}

TEST_F(X11PasteboardTest, RichContentIsOfferedAsHtmlAndPlainTextToo) {
    NotingOwner& owner = makeOwner(
        NotingOwner::Contents{{RTFD, "rtfd"}, {RTF, "{\\rtf1 rich}"}, {HTML, "<b>rich</b>"}, {String, "rich"}});
    declare({RTFD, RTF}, &owner);
    EXPECT_THAT(types(), ElementsAre(RTFD, RTF));
    SelectionRequestor program(display());
    EXPECT_EQ(program.request("CLIPBOARD", "text/rtf")->bytes, "{\\rtf1 rich}");
    EXPECT_EQ(program.request("CLIPBOARD", "application/rtf")->bytes, "{\\rtf1 rich}");
    EXPECT_EQ(program.request("CLIPBOARD", "text/html")->bytes, "<b>rich</b>");
    EXPECT_EQ(program.request("CLIPBOARD", "UTF8_STRING")->bytes, "rich");
    EXPECT_EQ(program.request("CLIPBOARD", RTFD)->bytes, "rtfd");
}

TEST_F(X11PasteboardTest, ClipboardManagersAreToldToForgetExpansionsAlone) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}, {"UTF8_STRING", "given back"}});
    SelectionRequestor manager(display());
    declare({String}, &owner);
    EXPECT_EQ(manager.request("CLIPBOARD", "x-kde-passwordManagerHint")->bytes, "secret");
    EXPECT_EQ(manager.request("CLIPBOARD", "application/x-copyq-hidden")->bytes, "1");
    declare({String, "UTF8_STRING"}, &owner);
    EXPECT_EQ(manager.request("CLIPBOARD", "application/x-copyq-hidden")->bytes, "1") << "it may have read half of it";
    EXPECT_THAT(manager.targets("CLIPBOARD"), Not(Contains("application/x-copyq-hidden")));
    EXPECT_EQ(manager.request("CLIPBOARD", "UTF8_STRING")->bytes, "given back");
    const auto isOver = [&] { return !manager.request("CLIPBOARD", "application/x-copyq-hidden"); };
    rig_->client().await("the end of the hint", Milliseconds(10'000), isOver);
    write(u"copied");
    EXPECT_THAT(manager.targets("CLIPBOARD"), Not(Contains("x-kde-passwordManagerHint")));
}

TEST_F(X11PasteboardTest, AClipboardManagerInTheMiddleOfWhatWasCopiedGoesOnWithThat) {
    SharedClipboardCopy copy;
    const auto user = copyElsewhere({{"UTF8_STRING", utf8("copied")}});
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}});
    SelectionRequestor manager(display());
    thread_->run([&] { pasteboard_->setSharedCopy(&copy); });
    for (const std::string& type : types()) data(type);
    declare({String}, &owner);
    EXPECT_EQ(manager.request("CLIPBOARD", "UTF8_STRING"), utf8("copied"));
    manager.targets("CLIPBOARD");
    EXPECT_EQ(manager.request("CLIPBOARD", "UTF8_STRING"), utf8("expansion"));
    EXPECT_EQ(manager.request("CLIPBOARD", "application/x-copyq-hidden")->bytes, "1");
    declare({String}, &owner);
    EXPECT_THAT(manager.targets("CLIPBOARD"), Not(Contains("application/x-copyq-hidden")));
    EXPECT_EQ(manager.request("CLIPBOARD", "UTF8_STRING"), utf8("copied")) << "it was met before";
    thread_->run([&] { pasteboard_->setSharedCopy(nullptr); });
}

// ---- Who has taken it ----

TEST_F(X11PasteboardTest, OnlyWhatTheProgramInFrontHasReadWasTaken) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}, {HTML, "<i>expansion</i>"}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    SelectionRequestor manager(display());
    declare({String, HTML}, &owner);
    manager.readAll("CLIPBOARD");
    front.targets("CLIPBOARD");
    front.request("CLIPBOARD", "TIMESTAMP");
    EXPECT_THAT(owner.awaitTaken(0), IsEmpty());
    front.request("CLIPBOARD", "UTF8_STRING");
    EXPECT_THAT(owner.awaitTaken(1), ElementsAre(String));
    manager.readAll("CLIPBOARD");
    front.request("CLIPBOARD", "text/html");
    EXPECT_THAT(owner.awaitTaken(2), ElementsAre(String, HTML));
}

TEST_F(X11PasteboardTest, LongContentWasTakenWithItsLastPiece) {
    const std::string text(5'000'000, 'x');
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, text}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    declare({String}, &owner);
    front.requestAndStop("CLIPBOARD", "UTF8_STRING");
    EXPECT_THAT(owner.awaitTaken(0), IsEmpty());
    EXPECT_EQ(front.request("CLIPBOARD", "UTF8_STRING")->bytes, text);
    EXPECT_THAT(owner.awaitTaken(1), ElementsAre(String));
}

TEST_F(X11PasteboardTest, WhatIsLeftLyingWasTakenAndSoWasWhatGivesWayToAnotherAnswer) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    declare({String}, &owner);
    front.requestAndLeave("CLIPBOARD", "UTF8_STRING");
    EXPECT_THAT(owner.awaitTaken(1), ElementsAre(String));
    front.requestAndLeave("CLIPBOARD", "UTF8_STRING");
    front.targets("CLIPBOARD");
    EXPECT_THAT(owner.awaitTaken(2), ElementsAre(String, String));
}

// ---- Pasting ----

TEST_F(X11PasteboardTest, PastesWhenAProgramThatAsksForTheTargetsHasThem) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    declare({String}, &owner);
    EXPECT_FALSE(startsPaste()) << "a stranger may be about to ask";
    awaitPaste();
    EXPECT_TRUE(startsPaste()) << "it did not";
    declare({String}, &owner);
    front.targets("CLIPBOARD");
    EXPECT_TRUE(startsPaste()) << "it has asked";
    declare({String}, &owner);
    EXPECT_FALSE(startsPaste()) << "it always asks";
    front.targets("CLIPBOARD");
    awaitPaste();
}

TEST_F(X11PasteboardTest, PastesWhenAProgramThatHadTheClipboardKnowsThatItHasNot) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    declare({String}, &owner);
    startsPaste();
    awaitPaste();
    for (const bool asks : {false, true}) {
        const std::int64_t before = changeCount();
        front.own("CLIPBOARD");
        awaitChangeAfter(before);
        declare({String}, &owner);
        EXPECT_FALSE(startsPaste());
        asks ? static_cast<void>(front.targets("CLIPBOARD")) : front.answerPing();
        awaitPaste();
    }
}

TEST_F(X11PasteboardTest, APasteThatWasNotTakenIsStillForItsProgramAlone) {
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}, {"UTF8_STRING", "given back"}});
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    SelectionRequestor manager(display());
    declare({String}, &owner);
    const auto time = thread_->run([&] { return thread_->session().serverTime(); });
    startsPaste();
    awaitPaste();
    declare({String, "UTF8_STRING"}, &owner);
    manager.setRequestTime(time);
    EXPECT_EQ(manager.request("CLIPBOARD", "UTF8_STRING"), utf8("given back"));
    front.setRequestTime(time);
    EXPECT_EQ(front.request("CLIPBOARD", "UTF8_STRING"), utf8("expansion"));
    EXPECT_THAT(owner.awaitTaken(1), Contains(String));
    const auto isOver = [&] { return front.request("CLIPBOARD", "UTF8_STRING") == utf8("given back"); };
    rig_->client().await("the end of the paste", Milliseconds(10'000), isOver);
}

// ---- Reading ----

TEST_F(X11PasteboardTest, ReadsTextUnderItsBestName) {
    struct Case {
        SelectionOffer offer;
        std::optional<std::u16string> expected;
    };
    const Case cases[] = {
        {{{"STRING", {"STRING", 8, "na\xefve"}}, {"UTF8_STRING", utf8("na\u00efve")}}, u"na\u00efve"},
        {{{"STRING", {"STRING", 8, "na\xefve"}}}, u"na\u00efve"},
        {{{"text/plain", {"text/plain", 8, "na\xefve"}}}, u"na\u00efve"},
        {{{"text/plain", {"text/plain", 8, "na\u00efve"}}}, u"na\u00efve"},
        {{{"text/plain;charset=utf-8", {"text/plain;charset=utf-8", 8, ""}}}, u""},
        {{{"image/png", {"image/png", 8, "png"}}}, std::nullopt},
    };
    for (const Case& one : cases) {
        const auto owner = copyElsewhere(one.offer);
        EXPECT_EQ(string(), one.expected) << one.offer.front().first;
    }
}

TEST_F(X11PasteboardTest, KeepsEveryNameAndSkipsWhatOnlySteersTheExchange) {
    const auto owner = copyElsewhere({{"text/html", {"text/html", 8, "<b>x</b>"}},
                                      {"application/rtf", {"application/rtf", 8, "{\\rtf1 x}"}},
                                      {"UTF8_STRING", utf8("x")},
                                      {"DELETE", {"NULL", 8, ""}},
                                      {"odd", {"odd", 8, std::string("\0\1", 2)}}});
    EXPECT_THAT(types(), ElementsAre(HTML, "text/html", RTF, "application/rtf", String, "UTF8_STRING", "odd"));
    EXPECT_EQ(data(HTML), "<b>x</b>");
    EXPECT_EQ(data(RTF), "{\\rtf1 x}");
    EXPECT_EQ(data("odd"), std::string("\0\1", 2));
    EXPECT_EQ(data("DELETE"), std::nullopt);
    EXPECT_EQ(data("never offered"), std::nullopt);
}

TEST_F(X11PasteboardTest, ReadsTwentyMegabytesInPieces) {
    const std::string bytes = unevenBytes(TwentyMegabytes);
    const auto owner = copyElsewhere({{"image/png", {"image/png", 8, bytes}}});
    EXPECT_TRUE(data("image/png") == bytes);
}

TEST_F(X11PasteboardTest, AnOwnerThatNeverAnswersIsAskedOnce) {
    int beats = 0;
    thread_->run([&] { thread_->session().heartbeat = [&] { ++beats; }; });
    ForeignOwner::Options silent;
    silent.behaviour = ForeignOwner::Behaviour::NeverAnswers;
    auto owner = copyElsewhere({{"UTF8_STRING", utf8("never seen")}}, silent);
    const auto first = timeOf([&] { EXPECT_THAT(types(), IsEmpty()); });
    EXPECT_GE(first, milliseconds(250));
    EXPECT_LE(first, milliseconds(1000));
    EXPECT_GE(beats, 2);
    const auto second = timeOf([&] {
        EXPECT_THAT(types(), IsEmpty());
        EXPECT_EQ(string(), std::nullopt);
        EXPECT_EQ(data("UTF8_STRING"), std::nullopt);
    });
    EXPECT_LE(second, milliseconds(100));
    EXPECT_EQ(owner->requests(), 1);
    owner = copyElsewhere({{"UTF8_STRING", utf8("answered")}});
    EXPECT_EQ(string(), u"answered");
}

TEST_F(X11PasteboardTest, AnOwnerThatDiesInTheMiddleIsNotWaitedFor) {
    ForeignOwner::Options dying;
    dying.behaviour = ForeignOwner::Behaviour::DiesInTheMiddle;
    const auto owner = copyElsewhere({{"image/png", {"image/png", 8, unevenBytes(2'000'000)}}}, dying);
    std::optional<std::string> read;
    const auto time = timeOf([&] { read = data("image/png"); });
    EXPECT_EQ(read, std::nullopt);
    EXPECT_LE(time, milliseconds(900)) << "noticed when it died, not when the time was over";
    EXPECT_EQ(owner->requests(), 2) << "TARGETS and the image";
    write(u"goes on");
    EXPECT_EQ(SelectionRequestor(display()).request("CLIPBOARD", "UTF8_STRING"), utf8("goes on"));
}

// ---- The selection for terminals ----

TEST_F(X11PasteboardTest, TerminalsFindTheExpansionInPrimaryAndThenWhatWasSelected) {
    thread_->run([&] { pasteboard_->setPastesPrimary(true); });
    ForeignOwner::Options primary;
    primary.selection = "PRIMARY";
    const ForeignOwner selected(display(), {{"UTF8_STRING", utf8("selected")}}, primary);
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}, {"UTF8_STRING", "given back"}});
    SelectionRequestor program(display());
    for (int round = 0; round < 2; ++round) {
        declare({String}, &owner);
        EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), utf8("expansion"));
    }
    declare({String, "UTF8_STRING"}, &owner);
    EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), utf8("selected"));
    EXPECT_EQ(program.request("CLIPBOARD", "UTF8_STRING"), utf8("given back"));
    thread_->run([&] { pasteboard_->setPastesPrimary(false); });
    declare({String}, &owner);
    EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), utf8("selected"));
}

TEST_F(X11PasteboardTest, PrimaryIsLeftAloneAfterANewSelectionAndEmptyWhenItWas) {
    thread_->run([&] { pasteboard_->setPastesPrimary(true); });
    NotingOwner& owner = makeOwner(NotingOwner::Contents{{String, "expansion"}});
    SelectionRequestor program(display());
    declare({String}, &owner);
    EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), utf8("expansion"));
    write(u"copied");
    EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), std::nullopt);
    declare({String}, &owner);
    ForeignOwner::Options primary;
    primary.selection = "PRIMARY";
    const ForeignOwner selected(display(), {{"UTF8_STRING", utf8("newly selected")}}, primary);
    write(u"copied");
    EXPECT_EQ(program.request("PRIMARY", "UTF8_STRING"), utf8("newly selected"));
}

// ---- The end ----

TEST_F(X11PasteboardTest, LeavesItsContentToAClipboardManager) {
    const std::string text(3'000'000, 'x');
    std::string saved;
    ForeignOwner::Options options;
    options.selection = "CLIPBOARD_MANAGER";
    options.beforeAnswer = [&](const std::string& target) {
        if (target == "SAVE_TARGETS") saved = SelectionRequestor(display()).request("CLIPBOARD", "UTF8_STRING")->bytes;
    };
    const ForeignOwner manager(display(), {{"SAVE_TARGETS", {"NULL", 8, ""}}}, options);
    const auto handOver = [&] {
        thread_->end();
        pasteboard_->handOver();
    };
    write(fromUtf8(text));
    handOver();
    EXPECT_TRUE(saved == text);
}

TEST_F(X11PasteboardTest, HandingOverWaitsForNoManagerAndForNoneThatHangs) {
    write(u"text");
    thread_->end();
    EXPECT_LE(timeOf([&] { pasteboard_->handOver(); }), milliseconds(200));
    ForeignOwner::Options silent;
    silent.selection = "CLIPBOARD_MANAGER";
    silent.behaviour = ForeignOwner::Behaviour::NeverAnswers;
    const ForeignOwner manager(display(), {}, silent);
    const auto time = timeOf([&] { pasteboard_->handOver(); });
    EXPECT_GE(time, milliseconds(400));
    EXPECT_LE(time, milliseconds(1000));
}

std::string typesAndBytes(int descriptor) {
    std::string all;
    for (const auto& entry : SharedClipboardCopy::read(descriptor)) all += entry.type + "=" + entry.bytes + ";";
    return all;
}

TEST(SharedClipboardCopyTest, HoldsWhatWasReadOfTheNewestContent) {
    SharedClipboardCopy copy;
    EXPECT_EQ(typesAndBytes(copy.descriptor()), "");
    copy.add("UTF8_STRING", 300, 8, "one");
    copy.add("text/html", 301, 8, std::string("<b>\0</b>", 8));
    copy.add("UTF8_STRING", 300, 8, "again");
    EXPECT_EQ(typesAndBytes(copy.descriptor()), std::string("UTF8_STRING=one;text/html=<b>\0</b>;", 35));
    copy.clear();
    EXPECT_EQ(typesAndBytes(copy.descriptor()), "");
    copy.add("empty", 302, 32, "");
    EXPECT_EQ(typesAndBytes(copy.descriptor()), "empty=;");
    const auto entries = SharedClipboardCopy::read(copy.descriptor());
    EXPECT_EQ(entries.at(0).form, 302U);
    EXPECT_EQ(entries.at(0).format, 32);
    EXPECT_EQ(typesAndBytes(-1), "");
}

// The writer was killed, or something else is in its place.
TEST(SharedClipboardCopyTest, GivesOnlyWholeEntries) {
    SharedClipboardCopy copy;
    copy.add("first", 300, 8, "one");
    const off_t afterFirst = lseek(copy.descriptor(), 0, SEEK_END);
    copy.add("second", 300, 8, std::string(100'000, 'x'));
    for (const off_t size : {afterFirst + 50'000, afterFirst + 3, afterFirst}) {
        ASSERT_EQ(ftruncate(copy.descriptor(), size), 0);
        EXPECT_EQ(typesAndBytes(copy.descriptor()), "first=one;") << size;
    }
    const std::string nonsense(64, '\xFF');
    ASSERT_EQ(pwrite(copy.descriptor(), nonsense.data(), nonsense.size(), 8), 64);
    EXPECT_EQ(typesAndBytes(copy.descriptor()), "");
    ASSERT_EQ(pwrite(copy.descriptor(), nonsense.data(), nonsense.size(), 0), 64);
    EXPECT_EQ(typesAndBytes(copy.descriptor()), "");
}

}  // namespace

}  // namespace plume::rig
