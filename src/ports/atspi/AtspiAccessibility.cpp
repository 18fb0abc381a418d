#include "ports/atspi/AtspiAccessibility.h"

#include <chrono>
#include <utility>

#include "ports/atspi/AtspiElement.h"
#include "ports/atspi/AtspiSession.h"

namespace plume {

namespace {

constexpr std::chrono::milliseconds LongestGoodbye{50};

// The program in front, of which something is known to have the focus. Nothing needs to be asked to make one.
class AtspiApplicationElement final : public UIElement {
  public:
    using Element = std::shared_ptr<UIElement>;

    explicit AtspiApplicationElement(std::shared_ptr<AtspiSession> session) : session_(std::move(session)) {}

    Element elementAttribute(std::string_view name) const override {
        if (name != "AXFocusedUIElement") return nullptr;
        auto focused = session_->askForFocus();
        if (!focused || !*focused) return nullptr;
        return std::make_shared<AtspiElement>(session_, std::move(*focused));
    }
    std::optional<std::u16string> stringAttribute(std::string_view name) const override {
        return name == "AXRole" ? std::optional<std::u16string>(u"AXApplication") : std::nullopt;
    }

    // It has no text and no place.
    std::vector<Element> elementsAttribute(std::string_view) const override { return {}; }
    std::optional<TextRange> rangeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<TextMarkerRange> markerRangeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<Point> pointAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<Size> sizeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<std::u16string> stringForRange(std::string_view, TextRange) const override { return std::nullopt; }
    std::optional<std::u16string> stringForMarkerRange(std::string_view, TextMarkerRange) const override {
        return std::nullopt;
    }
    std::optional<AttributedString> attributedStringForRange(std::string_view, TextRange) const override {
        return std::nullopt;
    }
    std::optional<std::string> dataForRange(std::string_view, TextRange) const override { return std::nullopt; }
    std::optional<Rectangle> rectangleForRange(std::string_view, TextRange) const override { return std::nullopt; }

  private:
    std::shared_ptr<AtspiSession> session_;
};

}  // namespace

std::string_view sentenceOf(AccessibilityStatus status) {
    switch (status) {
        case AccessibilityStatus::Starting:
            return "The accessibility bus is being looked for.";
        case AccessibilityStatus::Working:
            return "Accessibility works.";
        case AccessibilityStatus::SwitchedOff:
            return "Accessibility is not switched on for this session: programs made with GTK 3 tell about their "
                   "texts, "
                   "those made with Qt and browsers do not. To switch it on, run \"gsettings set "
                   "org.gnome.desktop.interface toolkit-accessibility true\" and start those programs again.";
        case AccessibilityStatus::NotInstalled:
            return "The accessibility bus cannot be started: install the package at-spi2-core.";
        case AccessibilityStatus::NoSession:
            return "There is no D-Bus session, so programs cannot tell about their texts: start Plume inside the "
                   "desktop "
                   "session.";
        case AccessibilityStatus::Failed:
            return "The accessibility bus does not accept Plume: log out and in again.";
    }
    return "";
}

AtspiAccessibility::AtspiAccessibility() : session_(std::make_shared<AtspiSession>()) {
    std::promise<void> ended;
    ended_ = ended.get_future();
    thread_ = std::thread([session = session_, ended = std::move(ended)]() mutable {
        session->run();
        ended.set_value();
    });
}

AtspiAccessibility::~AtspiAccessibility() {
    session_->end();
    if (ended_.wait_for(LongestGoodbye) == std::future_status::ready) {
        thread_.join();
    } else {
        thread_.detach();
    }
}

std::shared_ptr<UIElement> AtspiAccessibility::frontApplicationElement() const {
    return session_->focus().isKnown() ? std::make_shared<AtspiApplicationElement>(session_) : nullptr;
}

void AtspiAccessibility::setFrontProcess(pid_t process) {
    session_->tracker().setFrontProcess(process);
}

void AtspiAccessibility::focusMayHaveMoved() {
    session_->tracker().focusMayHaveMoved();
}

void AtspiAccessibility::userTypes() {
    session_->tracker().userTypes();
}

bool AtspiAccessibility::focusIsPassword() const {
    return session_->focus().isPassword();
}

pid_t AtspiAccessibility::focusedProcess() const {
    return session_->focus().process();
}

AccessibilityStatus AtspiAccessibility::status() const {
    return session_->status();
}

}  // namespace plume
