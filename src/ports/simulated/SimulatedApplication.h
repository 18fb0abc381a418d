// A program with one text field, which does what the events that reach it say, and remembers them.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/InputSources.h"
#include "platform/Pasteboard.h"
#include "platform/ProcessManager.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedTextField.h"

namespace plume {

// One key going down or up, as the program in front hears of it.
struct SimulatedKeyEvent {
    enum class Origin { User, Plume };

    double time = 0;  // seconds on the desktop's clock
    Origin origin = Origin::User;
    // The key, or nothing when the event carries `string` without belonging to a key.
    std::optional<KeyCode> keyCode;
    EventFlags flags;
    bool down = true;
    std::u16string string;  // what it produces
};

class SimulatedApplication {
  public:
    // The pasteboard is not owned and outlives the application.
    SimulatedApplication(std::u16string bundleIdentifier, ProcessSerialNumber process, Pasteboard& pasteboard);
    SimulatedApplication(const SimulatedApplication&) = delete;
    SimulatedApplication& operator=(const SimulatedApplication&) = delete;

    const std::u16string& bundleIdentifier() const { return bundleIdentifier_; }
    ProcessSerialNumber process() const { return process_; }

    const SimulatedTextField& field() const { return field_; }
    void setText(std::u16string text);
    void select(Range range);

    // Copy and paste are done with Control instead of Command.
    void setUsesControlKey(bool uses) { usesControlKey_ = uses; }

    // Does what the event says, and records it.
    void handle(SimulatedKeyEvent event);
    const std::vector<SimulatedKeyEvent>& events() const { return events_; }

    // What accessibility knows of the program.
    std::shared_ptr<UIElement> element() const { return element_; }

  private:
    void followPlumesModifiers(const SimulatedKeyEvent& event);
    void perform(const SimulatedKeyEvent& event);
    bool performByKey(KeyCode keyCode, bool shift);
    void performCommand(KeyCode keyCode);
    void insertProduced(std::u16string_view produced);
    void paste();
    std::optional<std::u16string> pasteboardText() const;
    void copy();
    void tellAccessibility();

    const std::u16string bundleIdentifier_;
    const ProcessSerialNumber process_;
    Pasteboard& pasteboard_;
    SimulatedTextField field_;
    bool usesControlKey_ = false;
    EventFlags plumesModifiers_;  // of modifier keys that Plume pressed as keys of their own
    std::vector<SimulatedKeyEvent> events_;
    std::shared_ptr<SimulatedUIElement> element_ = std::make_shared<SimulatedUIElement>();
    std::shared_ptr<SimulatedUIElement> fieldElement_ = std::make_shared<SimulatedUIElement>();
};

}  // namespace plume
