#include "app/CaretPlace.h"

#include <gtest/gtest.h>

#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {
namespace {

using Kind = CaretPlace::Kind;

struct Program {
    const char* what;
    std::optional<Rectangle> window;      // as the system knows it
    std::optional<Rectangle> toldWindow;  // as the program tells
    std::optional<Rectangle> toldCaret;
    std::optional<Rectangle> toldField;
    CaretPlace place;
};

TEST(CaretPlace, IsWhereTheProgramMeans) {
    const Rectangle window{{100, 200}, {800, 600}};
    const Rectangle caret{{150, 300}, {0, 16}};
    const Rectangle field{{140, 290}, {400, 30}};
    const Rectangle editor{{140, 290}, {400, 300}};
    const Program programs[] = {
        {"caret and field", window, window, caret, field, {Kind::Caret, caret}},
        {"a window that nobody knows", {}, {}, caret, field, {Kind::Caret, caret}},
        {"a program that does not tell its window", window, {}, caret, field, {Kind::Caret, caret}},
        {"no caret", window, window, {}, field, {Kind::Field, field}},
        {"a caret without height", window, window, Rectangle{{150, 300}, {0, 0}}, field, {Kind::Field, field}},
        {"a whole page in place of a field", window, window, {}, editor, {}},
        {"nothing told", window, window, {}, {}, {}},
        {"beside the window", window, {}, Rectangle{{5000, 300}, {0, 16}}, {}, {}},
        {"a caret elsewhere, and a field", window, {}, Rectangle{{0, 0}, {0, 16}}, field, {Kind::Field, field}},
        {"at the window's very edge",
         window,
         window,
         Rectangle{{99, 799}, {0, 16}},
         {},
         {Kind::Caret, {{99, 799}, {0, 16}}}},
        {"measured from the window",
         window,
         Rectangle{{0, 0}, {800, 600}},
         Rectangle{{50, 100}, {0, 16}},
         {},
         {Kind::Caret, caret}},
        {"at half of its scale",
         window,
         Rectangle{{50, 100}, {400, 300}},
         Rectangle{{75, 150}, {0, 8}},
         {},
         {Kind::Caret, caret}},
        {"at half of its scale, from the window",
         window,
         Rectangle{{0, 0}, {400, 300}},
         Rectangle{{25, 50}, {0, 8}},
         {},
         {Kind::Caret, caret}},
        {"a window told with its shadow", window, Rectangle{{76, 176}, {848, 648}}, caret, {}, {Kind::Caret, caret}},
        {"a scale of one and a half, told without borders",
         window,
         Rectangle{{70, 140}, {530, 390}},
         Rectangle{{100, 200}, {0, 10}},
         {},
         {Kind::Caret, {{150, 300}, {0, 15}}}},
        {"a window without a size", window, Rectangle{{0, 0}, {0, 0}}, caret, {}, {Kind::Caret, caret}},
    };
    for (const Program& program : programs) {
        const CaretPlace place =
            caretPlaceIn({program.toldCaret, program.toldField, program.toldWindow}, program.window);
        EXPECT_EQ(place, program.place) << program.what << ": " << place.rectangle.origin.x << ", "
                                        << place.rectangle.origin.y << ", height " << place.rectangle.size.height;
    }
}

// Tells of places when the test says so.
class SlowAccessibility final : public Accessibility {
  public:
    std::shared_ptr<UIElement> frontApplicationElement() const override { return nullptr; }
    void askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const override { told_ = std::move(told); }
    double mainScreenHeight() const override { return 1000; }
    void tell(const Rectangle& caret) const { told_({.caret = caret, .element = {}, .window = {}}); }
    void tellFieldAlone(const Rectangle& field) const { told_({.caret = {}, .element = field, .window = {}}); }
    void tellNothing(bool isMoving) const {
        told_({.caret = {}, .element = {}, .window = {}, .elementName = {}, .isMoving = isMoving});
    }

  private:
    mutable std::function<void(const FocusedPlaces&)> told_;
};

class CaretFinderTest : public testing::Test {
  protected:
    void find() {
        finder_.find([this](const CaretPlace& place) { found_.push_back(place); });
    }

    const Rectangle caret_{{150, 300}, {0, 16}};
    SimulatedRunLoop loop_;
    SlowAccessibility accessibility_;
    SimulatedProcessManager processes_;
    std::vector<CaretPlace> found_;
    CaretFinder finder_{accessibility_, processes_, loop_};
};

TEST_F(CaretFinderTest, TellsOnceWhenTheProgramTells) {
    find();
    loop_.advance(0.05);
    EXPECT_TRUE(found_.empty());
    accessibility_.tell(caret_);
    loop_.advance(5);
    accessibility_.tell(caret_);
    loop_.advance(5);
    EXPECT_EQ(found_, (std::vector<CaretPlace>{{Kind::Caret, caret_}}));
}

TEST_F(CaretFinderTest, AsksOnceMoreForACaretThatIsNotKnownAtOnce) {
    for (const bool becomesKnown : {true, false}) {
        found_.clear();
        find();
        accessibility_.tellFieldAlone(caret_);
        loop_.advance(0.05);
        EXPECT_TRUE(found_.empty());
        becomesKnown ? accessibility_.tell(caret_) : accessibility_.tellFieldAlone(caret_);
        loop_.runReady();
        EXPECT_EQ(found_, (std::vector<CaretPlace>{{becomesKnown ? Kind::Caret : Kind::Field, caret_}}));
    }
}

TEST_F(CaretFinderTest, AsksAProgramOnceMoreThatHasJustComeToTheFront) {
    find();
    accessibility_.tellNothing(true);
    loop_.advance(0.05);
    EXPECT_TRUE(found_.empty());
    accessibility_.tell(caret_);
    loop_.runReady();
    EXPECT_EQ(found_, (std::vector<CaretPlace>{{Kind::Caret, caret_}}));

    find();
    accessibility_.tellNothing(false);
    loop_.runReady();
    EXPECT_EQ(found_.back(), CaretPlace()) << "it tells nothing, and nobody waits for it";
}

TEST_F(CaretFinderTest, WaitsForNoProgramThatHangs) {
    find();
    loop_.advance(0.3);
    EXPECT_EQ(found_, std::vector<CaretPlace>(1));
    accessibility_.tell(caret_);
    loop_.advance(5);
    EXPECT_EQ(found_.size(), 1);
}

TEST_F(CaretFinderTest, TellsNothingThatNobodyWaitsFor) {
    find();
    finder_.cancel();
    accessibility_.tell(caret_);
    loop_.advance(5);
    EXPECT_TRUE(found_.empty());
}

}  // namespace
}  // namespace plume
