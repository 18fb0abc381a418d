// Which application an output goes to, and whether it is typed or pasted there.
//
// Owned by the input service; belongs to the tap thread. Asks the focused program about itself, as far as it answers.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "content/SnippetExpandedContent.h"
#include "input/BundleIdentifierResolver.h"
#include "input/delivery/ContextInputSetting.h"
#include "platform/Accessibility.h"
#include "platform/EventPoster.h"
#include "platform/ProcessManager.h"

namespace plume {

// The user's settings of delivery, under the names of the settings store.
struct DeliveryPreferences {
    bool useClipboard = false;
    std::int64_t useClipboardIn = 0;  // 0 everywhere, 1 except in the listed applications, 2 only in those
    std::vector<std::u16string> useClipboardApplications;
    bool useClipboardForLongText = false;
    std::int8_t longTextLength = 100;  // units; a setting above 127 wraps around, and below 0 no text is long
    bool restoreClipboard = true;
};

class ContextInputResolver {
  public:
    // Nothing is owned; all of it outlives the resolver.
    ContextInputResolver(const ProcessManager& processManager, BundleIdentifierResolver& identifiers,
                         const Accessibility& accessibility, const EventPoster& poster);

    DeliveryPreferences preferences;
    ContextInputSettings applicationSettings;
    bool listenAtAnnotatedSession = false;

    // Resolves the setting of the application in front.
    void refresh();
    // The same, and decides between typing and pasting. `content` is null when there is only something to erase. Where
    // no key pastes, everything is typed.
    void prepareSending(const SnippetExpandedContent* content);

    // As last resolved; the setting is never null.
    const std::optional<std::u16string>& contextBundleIdentifier() const { return contextBundleIdentifier_; }
    const std::shared_ptr<ContextInputSetting>& setting() const { return setting_; }

  private:
    bool has(InputFlag flag) const { return setting_->has(flag); }
    void decide(const SnippetExpandedContent* content);
    void pasteThisOne();
    void typeThisOne(const SnippetExpandedContent* content);
    void askFocusedElement();
    void lookForDocumentEditor(std::shared_ptr<UIElement> element);
    void applyPreference();
    bool mustPaste(std::u16string_view text) const;
    bool isLong(std::u16string_view text) const;
    bool canBeTyped(std::u16string_view text) const;

    const ProcessManager& processManager_;
    BundleIdentifierResolver& identifiers_;
    const Accessibility& accessibility_;
    const EventPoster& poster_;
    std::optional<std::u16string> contextBundleIdentifier_;
    std::shared_ptr<ContextInputSetting> setting_;
};

}  // namespace plume
