#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

const std::string StringType(PasteboardType::String);

// Promises one text, and counts how often it is asked. An empty promise is not kept.
class Promise final : public PasteboardOwner {
  public:
    explicit Promise(std::u16string text) : text_(std::move(text)) {}
    void provideData(Pasteboard& pasteboard, std::string_view type) override {
        ++asked;
        if (!text_.empty()) pasteboard.setString(text_, type);
    }
    int asked = 0;

  private:
    std::u16string text_;
};

}  // namespace

TEST_P(PasteboardContract, GivesBackWhatWasWritten) {
    Pasteboard& pasteboard = desk_->pasteboard();
    const std::string odd("\0\xFF\x80 odd", 7);
    pasteboard.declareTypes({std::string(PasteboardType::HTML), StringType, "org.example.odd"}, nullptr);
    pasteboard.setData("<b>x</b>", PasteboardType::HTML);
    pasteboard.setString(u"na\u00EFve \U0001F600", StringType);
    pasteboard.setData(odd, "org.example.odd");
    pasteboard.setData("{\\rtf1}", PasteboardType::RTF);

    EXPECT_EQ(pasteboard.types(),
              (std::vector<std::string>{std::string(PasteboardType::HTML), StringType, "org.example.odd"}));
    EXPECT_EQ(pasteboard.string(), u"na\u00EFve \U0001F600");
    EXPECT_EQ(pasteboard.data(PasteboardType::HTML), "<b>x</b>");
    EXPECT_EQ(pasteboard.data("org.example.odd"), odd);
    EXPECT_EQ(pasteboard.data(PasteboardType::RTF), std::nullopt) << "it was not declared";
    EXPECT_EQ(desk_->readElsewhere(), u"na\u00EFve \U0001F600");
}

TEST_P(PasteboardContract, CountsEveryChange) {
    Pasteboard& pasteboard = desk_->pasteboard();
    const std::int64_t before = pasteboard.changeCount();
    const std::int64_t own = pasteboard.declareTypes({StringType}, nullptr);
    EXPECT_GT(own, before);
    EXPECT_EQ(pasteboard.changeCount(), own);
    pasteboard.setString(u"mine", StringType);
    EXPECT_EQ(desk_->readElsewhere(), u"mine");
    EXPECT_EQ(pasteboard.changeCount(), own) << "neither writing what was declared nor reading it is a change";
    desk_->copyElsewhere(u"theirs");
    EXPECT_TRUE(desk_->runUntil([&] { return pasteboard.changeCount() > own; }));
    EXPECT_EQ(pasteboard.changeCount(), own + 1);
    EXPECT_EQ(pasteboard.string(), u"theirs");
}

TEST_P(PasteboardContract, AsksForPromisedContentWhenSomebodyWantsIt) {
    Pasteboard& pasteboard = desk_->pasteboard();
    Promise promise(u"promised");
    pasteboard.declareTypes({StringType}, &promise);
    EXPECT_TRUE(desk_->runUntil([&] { return pasteboard.types() == std::vector{StringType}; }));
    EXPECT_EQ(promise.asked, 0) << "nobody wants more than the types";
    EXPECT_EQ(desk_->readElsewhere(), u"promised");
    EXPECT_EQ(pasteboard.string(), u"promised");
    EXPECT_EQ(promise.asked, 1) << "what was given is kept";
    EXPECT_EQ(pasteboard.data("org.example.missing"), std::nullopt);

    Promise broken(u"");
    pasteboard.declareTypes({StringType}, &broken);
    EXPECT_EQ(pasteboard.string(), std::nullopt);
    EXPECT_EQ(desk_->readElsewhere(), std::nullopt);
}

TEST_P(PasteboardContract, ForgetsAPromiseThatWasReplaced) {
    Pasteboard& pasteboard = desk_->pasteboard();
    Promise first(u"first");
    Promise second(u"second");
    pasteboard.declareTypes({StringType}, &first);
    pasteboard.declareTypes({StringType}, &second);
    EXPECT_EQ(desk_->readElsewhere(), u"second");
    EXPECT_EQ(first.asked, 0);
}

TEST_P(PasteboardContract, SendsTheKeystrokeOfAPasteOnce) {
    Pasteboard& pasteboard = desk_->pasteboard();
    Promise promise(u"promised");
    for (const int round : {1, 2}) {
        pasteboard.declareTypes({StringType}, &promise);
        int sent = 0;
        pasteboard.paste([&] { ++sent; });
        EXPECT_TRUE(desk_->runUntil([&] { return sent == 1; })) << round;
        EXPECT_FALSE(pasteboard.isPasteAwaited()) << "no program hangs";
    }
    pasteboard.declareTypes({}, nullptr);
}

TEST_P(PasteboardContract, IsEmptiedByDeclaringNothing) {
    Pasteboard& pasteboard = desk_->pasteboard();
    desk_->copyElsewhere(u"theirs");
    ASSERT_TRUE(desk_->runUntil([&] { return pasteboard.string() == u"theirs"; }));
    pasteboard.declareTypes({}, nullptr);
    EXPECT_TRUE(pasteboard.types().empty());
    EXPECT_EQ(pasteboard.string(), std::nullopt);
    EXPECT_EQ(desk_->readElsewhere(), std::nullopt);
}

}  // namespace plume
