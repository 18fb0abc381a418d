// Expansions on the clipboard as they are pasted: into real programs, with a clipboard manager around, and given back.

#include <algorithm>
#include <thread>

#include "Foundation/Strings.h"
#include "input/delivery/ClipboardDataProvider.h"
#include "tests/desktop/PasteboardTestSupport.h"

namespace plume::rig {

namespace {

// Reads everything whenever somebody copies, as clipboard managers do.
class ClipboardManager {
  public:
    explicit ClipboardManager(const std::string& display) : display_(display) {
        thread_ = std::thread([this] { readAlways(); });
    }
    ~ClipboardManager() {
        stops_ = true;
        thread_.join();
    }
    ClipboardManager(const ClipboardManager&) = delete;
    ClipboardManager& operator=(const ClipboardManager&) = delete;

    int texts() const { return texts_; }

  private:
    void readAlways() {
        SelectionRequestor reader(display_);
        while (!stops_) {
            if (reader.readAll("CLIPBOARD").contains("UTF8_STRING")) ++texts_;
        }
    }

    const std::string display_;
    std::atomic<bool> stops_ = false;
    std::atomic<int> texts_ = 0;
    std::thread thread_;
};

class X11PasteTest : public X11PasteboardTest {
  protected:
    void SetUp() override {
        X11PasteboardTest::SetUp();
        thread_->run([&] { provider_ = std::make_unique<ClipboardDataProvider>(*pasteboard_, thread_->loop()); });
    }
    void TearDown() override {
        thread_->run([&] { provider_.reset(); });
        X11PasteboardTest::TearDown();
    }

    void expand(const std::u16string& text) {
        thread_->run([&] {
            provider_->cancelRestore();
            provider_->backup();
            provider_->setString(text);
        });
    }
    void restore() {
        thread_->run([&] { provider_->restoreAfterDelay(); });
    }
    // Waits until the content is given back: until then, it is the provider's expansion.
    void awaitGivenBack() {
        rig_->client().await("giving the clipboard back", Milliseconds(10'000),
                             [&] { return !thread_->run([&] { return provider_->isOffering(); }); });
    }

    std::unique_ptr<ClipboardDataProvider> provider_;
};

SelectionOffer everythingAProgramOffers() {
    SelectionOffer offer = {{"UTF8_STRING", {"UTF8_STRING", 8, "user's"}},
                            {"TEXT", {"COMPOUND_TEXT", 8, "user's"}},
                            {"STRING", {"STRING", 8, "user's"}},
                            {"text/html", {"text/html", 8, std::string("\xff\xfe<\0b\0>\0", 8)}},
                            {"image/png", {"image/png", 8, unevenBytes(5'000'000)}},
                            {"LENGTH", {"INTEGER", 32, std::string("\x06\0\0\0", 4)}},
                            {"x-words", {"CARDINAL", 16, std::string("\1\2\3\4", 4)}}};
    for (int i = 0; i < 20; ++i) {
        const std::string name = "application/x-odd-" + std::to_string(i);
        offer.push_back({name, {name, 8, unevenBytes(static_cast<std::size_t>(i) * 997)}});
    }
    return offer;
}

TEST_F(X11PasteTest, TheUsersClipboardReturnsByteForByte) {
    SelectionRequestor front(display());
    front.comeToFront(rig_->client());
    const auto owner = copyElsewhere(everythingAProgramOffers());
    const auto before = front.readAll("CLIPBOARD");
    ASSERT_EQ(before.size(), 27U);
    expand(u"expansion");
    EXPECT_EQ(front.request("CLIPBOARD", "UTF8_STRING")->bytes, "expansion");
    restore();
    awaitGivenBack();
    const auto after = front.readAll("CLIPBOARD");
    EXPECT_TRUE(after == before);
    for (const auto& [target, value] : before) {
        EXPECT_TRUE(after.contains(target) && after.at(target) == value) << target;
    }
}

class X11PasteIntoTest : public X11PasteTest, public testing::WithParamInterface<TargetKind> {
  protected:
    void SetUp() override {
        X11PasteTest::SetUp();
        if (GetParam() == TargetKind::Xterm) thread_->run([&] { pasteboard_->pastesPrimary = [] { return true; }; });
        target_ = rig_->startTarget(GetParam());
    }
    void TearDown() override {
        target_.reset();
        X11PasteTest::TearDown();
    }
    void paste() {
        if (GetParam() == TargetKind::Xterm) {
            rig_->keyboard().chord({Key::LeftShift}, Key::Insert);
        } else {
            rig_->keyboard().chord({Key::LeftControl}, U'v');
        }
        rig_->keyboard().sync();
    }

    std::unique_ptr<TargetProgram> target_;
};

TEST_P(X11PasteIntoTest, APasteTakesTheExpansionAndTheUsersContentReturns) {
    const ClipboardManager manager(display());
    std::string expected;
    for (const std::string text : {"na\u00efve \u2014 \u65e5\u672c\u8a9e \U0001F600", "second"}) {
        const auto owner = copyElsewhere({{"UTF8_STRING", {"UTF8_STRING", 8, "user's"}}});
        expand(fromUtf8(text));
        const int seen = manager.texts();
        rig_->client().await("the manager's reading", Milliseconds(10'000), [&] { return manager.texts() > seen + 1; });
        EXPECT_TRUE(thread_->run([&] { return provider_->isOffering(); })) << "only a paste takes it";
        restore();
        paste();
        expected += text;
        EXPECT_EQ(target_->awaitText(expected), expected);
        awaitGivenBack();
        EXPECT_EQ(SelectionRequestor(display()).request("CLIPBOARD", "UTF8_STRING")->bytes, "user's");
    }
}

INSTANTIATE_TEST_SUITE_P(Programs, X11PasteIntoTest,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm),
                         [](const auto& tested) { return nameOf(tested.param); });

}  // namespace

}  // namespace plume::rig
