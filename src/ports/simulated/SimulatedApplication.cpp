#include "ports/simulated/SimulatedApplication.h"

#include <algorithm>
#include <utility>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/text/RTFD.h"
#include "ports/simulated/SimulatedModifiers.h"

namespace plume {

namespace {

// Control characters that stand for keys (Escape, arrows) are no text; Return, Enter and Tab are.
bool isText(char16_t unit) {
    return unit == u'\t' || unit == u'\n' || unit == u'\r' || (unit >= u' ' && unit != u'\x7F');
}

std::int64_t signedOf(std::size_t number) {
    return static_cast<std::int64_t>(number);
}

}  // namespace

SimulatedApplication::SimulatedApplication(std::u16string bundleIdentifier, ProcessSerialNumber process,
                                           Pasteboard& pasteboard)
    : bundleIdentifier_(std::move(bundleIdentifier)), process_(process), pasteboard_(pasteboard) {
    element_->setAttribute("AXRole", std::u16string(u"AXApplication"));
    element_->setAttribute("AXFocusedUIElement", std::shared_ptr<UIElement>(fieldElement_));
    fieldElement_->setAttribute("AXRole", std::u16string(u"AXTextArea"));
    using Answer = std::optional<SimulatedUIElement::RangeAnswer>;
    fieldElement_->setRangeAttribute("AXStringForRange", [this](TextRange range) -> Answer {
        const std::int64_t size = signedOf(field_.text().size());
        if (range.location < 0 || range.length < 0 || range.location > size) return std::nullopt;
        if (range.length > size - range.location) return std::nullopt;
        return field_.text().substr(static_cast<std::size_t>(range.location), static_cast<std::size_t>(range.length));
    });
    tellAccessibility();
}

void SimulatedApplication::setText(std::u16string text) {
    field_.setText(std::move(text));
    tellAccessibility();
}

void SimulatedApplication::select(Range range) {
    field_.select(range);
    tellAccessibility();
}

void SimulatedApplication::handle(SimulatedKeyEvent event) {
    events_.push_back(event);
    if (event.origin == SimulatedKeyEvent::Origin::Plume) {
        followPlumesModifiers(event);
        event.flags |= plumesModifiers_;
    }
    if (event.down) perform(event);
    tellAccessibility();
}

void SimulatedApplication::followPlumesModifiers(const SimulatedKeyEvent& event) {
    const EventFlags flag = event.keyCode ? modifierFlagOf(*event.keyCode) : EventFlags();
    plumesModifiers_ = event.down ? plumesModifiers_ | flag : plumesModifiers_ - flag;
}

void SimulatedApplication::perform(const SimulatedKeyEvent& event) {
    // What is typed without a key is text whatever is held.
    if (!event.keyCode) return field_.insert(event.string);
    if (!modifierFlagOf(*event.keyCode).isEmpty()) return;
    if (performByKey(*event.keyCode, event.flags.contains(EventFlag::Shift))) return;
    const EventFlags commands = EventFlag::Control | EventFlag::Command;
    const EventFlags own = usesControlKey_ ? EventFlag::Control : EventFlag::Command;
    if (!event.flags.containsAny(commands)) return insertProduced(event.string);
    if ((event.flags & commands) == own) performCommand(*event.keyCode);
}

bool SimulatedApplication::performByKey(KeyCode keyCode, bool shift) {
    using Movement = SimulatedTextField::Movement;
    const auto move = [&](Movement movement) {
        field_.move(movement, shift);
        return true;
    };
    switch (keyCode) {
        case KeyCode::Delete:
            field_.deleteBackward();
            return true;
        case KeyCode::ForwardDelete:
            field_.deleteForward();
            return true;
        case KeyCode::Left:
            return move(Movement::Left);
        case KeyCode::Right:
            return move(Movement::Right);
        case KeyCode::Up:
            return move(Movement::Up);
        case KeyCode::Down:
            return move(Movement::Down);
        case KeyCode::Home:
            return move(Movement::LineStart);
        case KeyCode::End:
            return move(Movement::LineEnd);
        default:
            return keyCode == KeyCode::Escape || keyCode == KeyCode::PageUp || keyCode == KeyCode::PageDown;
    }
}

void SimulatedApplication::performCommand(KeyCode keyCode) {
    if (keyCode == KeyCode::V) paste();
    if (keyCode == KeyCode::C) copy();
}

void SimulatedApplication::insertProduced(std::u16string_view produced) {
    if (produced.empty() || !std::all_of(produced.begin(), produced.end(), isText)) return;
    std::u16string text(produced);
    std::replace(text.begin(), text.end(), u'\r', u'\n');
    field_.insert(text);
}

void SimulatedApplication::paste() {
    if (const auto text = pasteboardText()) field_.insert(*text);
}

// A plain field asks for plain text first, and takes the text of rich content where there is none.
std::optional<std::u16string> SimulatedApplication::pasteboardText() const {
    if (auto plain = pasteboard_.string()) return plain;
    if (const auto bytes = pasteboard_.data(PasteboardType::RTFD)) {
        if (const auto text = attributedStringFromRTFD(*bytes)) return text.value().string();
    }
    if (const auto bytes = pasteboard_.data(PasteboardType::RTF)) {
        if (const auto text = attributedStringFromRTF(*bytes)) return text.value().string();
    }
    return std::nullopt;
}

void SimulatedApplication::copy() {
    if (field_.selection().length == 0) return;
    const std::string type(PasteboardType::String);
    pasteboard_.declareTypes({type}, nullptr);
    pasteboard_.setString(field_.selectedText(), type);
}

void SimulatedApplication::tellAccessibility() {
    const Range selection = field_.selection();
    fieldElement_->setAttribute("AXSelectedTextRange",
                                TextRange{signedOf(selection.location), signedOf(selection.length)});
}

}  // namespace plume
