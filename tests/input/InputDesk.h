// An input service among recording and simulated parts.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "input/MacInputService.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedPasteboard.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"
#include "tests/input/delivery/RecordingPoster.h"

namespace plume {

class HandKeyboardTap final : public KeyboardTap {
  public:
    Result<void> create(KeyboardTapListener& aListener, bool isAnnotated) override {
        if (!error.message.empty()) return error;
        listener = &aListener;
        annotated = isAnnotated;
        return {};
    }
    bool exists() const override { return listener != nullptr; }
    void enable() override { ++enabled; }
    void remove() override { listener = nullptr; }
    Result<void> check() const override { return {}; }

    KeyboardTapListener* listener = nullptr;
    bool annotated = false;
    int enabled = 0;
    Error error;
};

class HandMouseTap final : public MouseTap {
  public:
    Result<void> create(Listener aListener) override {
        listener = std::move(aListener);
        return {};
    }
    bool exists() const override { return listener != nullptr; }
    void remove() override { listener = nullptr; }

    Listener listener;
};

class HandSecureInput final : public SecureInput {
  public:
    bool isSecureEventInputEnabled() const override { return on; }
    bool on = false;
};

class HandSystemHotKeys final : public SystemHotKeys {
  public:
    Result<void> registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers,
                                std::function<void()> handler) override {
        registered[id] = {{modifiers, keyCode}, std::move(handler)};
        return {};
    }
    void unregisterHotKey(Id id) override { registered.erase(id); }

    std::map<Id, std::pair<GeneralHotKey, std::function<void()>>> registered;
};

// A pasteboard that tells when the program in front has taken its content, and has it take that only when told to.
class TellingPasteboard final : public Pasteboard {
  public:
    std::vector<std::string> types() const override { return content.types(); }
    std::optional<std::u16string> string() const override { return content.string(); }
    std::optional<std::string> data(std::string_view type) const override { return content.data(type); }
    std::int64_t changeCount() const override { return content.changeCount(); }
    bool tellsWhenTaken() const override { return tells; }
    void paste(std::function<void()> sendKeystroke) override { sendKeystroke(); }
    bool isPasteAwaited() const override { return awaited; }
    std::int64_t declareTypes(const std::vector<std::string>& types, PasteboardOwner* anOwner) override {
        owner = anOwner;
        return content.declareTypes(types, anOwner);
    }
    void setString(std::u16string_view string, std::string_view type) override { content.setString(string, type); }
    void setData(std::string_view bytes, std::string_view type) override { content.setData(bytes, type); }

    // The program in front reads it.
    std::optional<std::u16string> take() {
        auto text = content.string();
        if (owner && tells) owner->dataWasTaken(PasteboardType::String);
        return text;
    }

    SimulatedPasteboard content;
    PasteboardOwner* owner = nullptr;
    bool tells = false;
    bool awaited = false;
};

struct InputDesk {
    explicit InputDesk(std::u16string application = u"editor") {
        poster.clock = &loop;
        processes.setFrontProcess(processes.launch(std::move(application)));
        service.enableEvents();
        loop.runReady();
    }

    ProcessSerialNumber activate(std::u16string application) {
        const auto process = processes.launch(std::move(application));
        processes.setFrontProcess(process);
        return process;
    }
    bool send(TapEvent::Type type, KeyCode keyCode, std::u16string_view text = {}, EventFlags flags = {}) {
        return tap.listener->keyboardEvent({type, keyCode, flags, text});
    }
    bool keyDown(KeyCode keyCode, std::u16string_view text = {}) {
        return send(TapEvent::Type::KeyDown, keyCode, text, heldFlags);
    }
    bool keyUp(KeyCode keyCode) { return send(TapEvent::Type::KeyUp, keyCode, {}, heldFlags); }
    bool hold(KeyModifiers modifiers) {
        heldFlags = flagsFromModifiers(modifiers);
        return send(TapEvent::Type::FlagsChanged, KeyCode::None, {}, heldFlags);
    }

    // A plain output.
    static std::shared_ptr<PLOutput> output(std::u16string text, std::uint64_t backspaces = 0) {
        auto made = std::make_shared<PLOutput>();
        made->cancelTrigger = true;
        made->backspaceCount = backspaces;
        made->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(std::move(text));
        return made;
    }

    SimulatedRunLoop loop;
    HandKeyboardTap tap;
    HandMouseTap mouse;
    RecordingPoster poster;
    TellingPasteboard pasteboard;
    SimulatedProcessManager processes;
    SimulatedInputSources sources;
    SimulatedAccessibility accessibility;
    HandSecureInput secure;
    HandSystemHotKeys systemHotKeys;
    BundleIdentifierResolver identifiers{processes};
    std::vector<std::string> log;
    EventFlags heldFlags;
    MacInputService service{{tap, mouse, poster, pasteboard, processes, sources, accessibility, secure, systemHotKeys,
                             identifiers, loop, loop, [this](const std::string& line) { log.push_back(line); }}};
};

}  // namespace plume
