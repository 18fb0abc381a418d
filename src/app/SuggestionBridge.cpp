#include "app/SuggestionBridge.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "app/FirstLine.h"

namespace plume {

namespace {

constexpr std::size_t PageRows = 10;
constexpr std::size_t Digits = 10;
// Seconds.
constexpr double KeyboardPoll = 0.1;
// The program shows its key first: drawing the list beside it would take the processor's time from that.
constexpr double PageDelay = 0.012;

// The keys 1 to 9, then 0.
char16_t digitFor(std::size_t index) {
    if (index >= Digits) return u'\0';
    return static_cast<char16_t>(u'0' + (index + 1) % Digits);
}

}  // namespace

SuggestionBridge::SuggestionBridge(Dependencies dependencies)
    : around_(std::move(dependencies)), caret_(around_.accessibility, around_.processManager, around_.tapLoop) {
    around_.mainLoop.perform([view = around_.view, events = events()] { view().setEvents(events); });
}

SuggestionBridge::~SuggestionBridge() {
    *self_ = nullptr;
    around_.mainLoop.perform([view = around_.view] {
        view().hide();
        view().setEvents({});
    });
}

SuggestionView::Events SuggestionBridge::events() const {
    // On the main thread; what they do is done on this one.
    const auto onTap = [self = self_, &loop = around_.tapLoop](auto call) {
        loop.perform([self, call] {
            if (*self) call(**self);
        });
    };
    return {.clicked =
                [onTap](std::uint64_t page, std::size_t index) {
                    onTap([page, index](SuggestionBridge& bridge) { bridge.clicked(page, index); });
                },
            .scrolled = [onTap](int rows) { onTap([rows](SuggestionBridge& bridge) { bridge.scrolled(rows); }); },
            .placed =
                [onTap](const Rectangle& frame) {
                    onTap([frame](SuggestionBridge& bridge) {
                        if (bridge.visible_) bridge.frame_ = frame;
                    });
                }};
}

void SuggestionBridge::setSnippets(const SuggestionList& list) {
    list_ = &list;
    reloadData();
}

void SuggestionBridge::reloadData() {
    first_ = 0;
    selected_ = 0;
    listStart_ = pageNumber_ + 1;
    pageChanged();
}

void SuggestionBridge::showWindowAtCaret() {
    visible_ = true;
    window_ = around_.processManager.frontWindow();
    caret_.find([this](const CaretPlace& place) { open(place); });
}

void SuggestionBridge::open(const CaretPlace& place) {
    paging_.cancel();
    isOpen_ = true;
    shown_ = page();
    around_.mainLoop.perform([view = around_.view, page = shown_, place] { view().show(page, place); });
    watchKeyboard();
}

// A window may come to the front without a key or a click of the user's.
void SuggestionBridge::watchKeyboard() {
    watching_ = around_.tapLoop.performAfterDelay(KeyboardPoll, [this] {
        watching_.cancel();
        around_.processManager.frontWindow() == window_ ? watchKeyboard() : around_.keyboardMoved();
    });
}

void SuggestionBridge::close() {
    caret_.cancel();
    paging_.cancel();
    watching_.cancel();
    visible_ = false;
    frame_ = {};
    if (std::exchange(isOpen_, false)) around_.mainLoop.perform([view = around_.view] { view().hide(); });
}

void SuggestionBridge::nextSuggestion() {
    if (selected_ + 1 < list_->size()) select(selected_ + 1);
}

void SuggestionBridge::previousSuggestion() {
    if (selected_ > 0) select(selected_ - 1);
}

std::size_t SuggestionBridge::selectedSuggestionIndex() const {
    return selected_ < list_->size() ? selected_ : NotFound;
}

void SuggestionBridge::select(std::size_t index) {
    selected_ = index;
    first_ = std::clamp(first_, index < PageRows ? 0 : index - PageRows + 1, index);
    pageChanged();
}

// A list that has come meanwhile has something else at that place.
void SuggestionBridge::clicked(std::uint64_t page, std::size_t index) {
    if (!visible_ || page < listStart_ || index >= list_->size()) return;
    selected_ = index;
    selectedAction_();
}

void SuggestionBridge::scrolled(int rows) {
    if (!visible_ || list_->size() <= PageRows) return;
    const auto last = static_cast<std::ptrdiff_t>(list_->size() - PageRows);
    first_ = static_cast<std::size_t>(std::clamp<std::ptrdiff_t>(static_cast<std::ptrdiff_t>(first_) + rows, 0, last));
    pageChanged();
}

// Once for all that one key changes.
void SuggestionBridge::pageChanged() {
    if (!isOpen_ || paging_) return;
    paging_ = around_.tapLoop.performAfterDelay(PageDelay, [this] {
        paging_.cancel();
        SuggestionPage next = page();
        if (next.isSameAs(shown_)) {
            // A click on what is seen means this list.
            listStart_ = shown_.number;
            return;
        }
        shown_ = next;
        around_.mainLoop.perform([view = around_.view, page = std::move(next)] { view().update(page); });
    });
}

SuggestionPage SuggestionBridge::page() {
    SuggestionPage page{.number = ++pageNumber_,
                        .rows = {},
                        .first = first_,
                        .total = list_->size(),
                        .selected = selected_,
                        .selectorKeyModifier = selectorKeyModifier_};
    const std::size_t end = std::min(first_ + PageRows, list_->size());
    for (std::size_t index = first_; index < end; ++index) page.rows.push_back(rowAt(index));
    return page;
}

SuggestionRow SuggestionBridge::rowAt(std::size_t index) const {
    const Snippet& snippet = *list_->suggestions[index];
    const auto& content = snippet.richTextContent();
    return {.abbreviation = snippet.abbreviationWithPrefix().value_or(u""),
            .typedLength = list_->suggestionFilters[index].size(),
            .label = snippet.label().value_or(u""),
            .content = content ? firstLine(content->string()) : std::u16string(),
            .digit = digitFor(index)};
}

}  // namespace plume
