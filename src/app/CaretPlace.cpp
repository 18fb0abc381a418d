#include "app/CaretPlace.h"

#include <cmath>
#include <utility>

namespace plume {

namespace {

constexpr double Slack = 2;           // pixels by which a caret may stand out of its window
constexpr double LargestField = 240;  // pixels: below a higher one nobody would look
// Windows are told with or without their shadows: only a clear difference is one of scale, and scales are quarters.
constexpr double SmallestScale = 1.2;
constexpr double ScaleSteps = 4;
// Seconds until the list comes where no caret is known.
constexpr double LongestQuestion = 0.2;
constexpr double RepetitionDelay = 0.03;

bool contains(const Rectangle& outer, const Point& point) {
    return point.x >= outer.origin.x - Slack && point.x <= outer.origin.x + outer.size.width + Slack &&
           point.y >= outer.origin.y - Slack && point.y <= outer.origin.y + outer.size.height + Slack;
}

Rectangle scaled(const Rectangle& rectangle, double factor) {
    return {{rectangle.origin.x * factor, rectangle.origin.y * factor},
            {rectangle.size.width * factor, rectangle.size.height * factor}};
}

// Some programs that draw at twice the size tell of places as if they did not, others measure from their window.
std::optional<Rectangle> onScreen(const std::optional<Rectangle>& told, const std::optional<Rectangle>& around,
                                  const std::optional<Rectangle>& window) {
    if (!told || told->size.height <= 0) return std::nullopt;
    if (!window) return told;
    const bool isComparable = around && around->size.width > 0;
    const double ratio = isComparable ? window->size.width / around->size.width : 1;
    const double factor = ratio < SmallestScale ? 1 : std::round(ratio * ScaleSteps) / ScaleSteps;
    const Rectangle place = scaled(*told, factor);
    if (contains(*window, place.origin)) return place;
    if (!isComparable) return std::nullopt;
    const Rectangle inside = {{window->origin.x + place.origin.x - around->origin.x * factor,
                               window->origin.y + place.origin.y - around->origin.y * factor},
                              place.size};
    return contains(*window, inside.origin) ? std::optional(inside) : std::nullopt;
}

}  // namespace

CaretPlace caretPlaceIn(const FocusedPlaces& told, const std::optional<Rectangle>& window) {
    if (const auto caret = onScreen(told.caret, told.window, window)) return {CaretPlace::Kind::Caret, *caret};
    const auto field = onScreen(told.element, told.window, window);
    if (field && field->size.height <= LargestField) return {CaretPlace::Kind::Field, *field};
    return {};
}

void CaretFinder::find(Found found) {
    asked_ = std::make_shared<Question>();
    asked_->found = std::move(found);
    asked_->limit = tapLoop_.performAfterDelay(LongestQuestion, [this] { answer({}); });
    ask(asked_);
}

void CaretFinder::ask(const std::shared_ptr<Question>& question) {
    accessibility_.askForFocusedPlaces(
        [this, asked = std::weak_ptr(question), &loop = tapLoop_](const FocusedPlaces& places) {
            loop.perform([this, asked, places] {
                if (const auto stillAsked = asked.lock()) told(stillAsked, places);
            });
        });
}

// Firefox lays a text out for this when it is asked for the first time, and knows only then where the caret is; any
// program may take the keys of its new window sooner than it tells of it.
void CaretFinder::told(const std::shared_ptr<Question>& question, const FocusedPlaces& places) {
    const bool isWorthAsking = !places.caret && (places.element || places.isMoving);
    if (!isWorthAsking || std::exchange(question->isRepeated, true)) {
        return answer(caretPlaceIn(places, processManager_.frontWindowBounds()));
    }
    question->repetition =
        tapLoop_.performAfterDelay(RepetitionDelay, [this, asked = std::weak_ptr(question)] { ask(asked.lock()); });
}

void CaretFinder::answer(const CaretPlace& place) {
    const auto question = std::exchange(asked_, nullptr);
    question->limit.cancel();
    question->repetition.cancel();
    question->found(place);
}

void CaretFinder::cancel() {
    asked_ = nullptr;
}

}  // namespace plume
