#include "input/delivery/ContextInputResolver.h"

#include <algorithm>
#include <utility>

#include "input/AXUtils.h"

namespace plume {

namespace {

// The word processor in the browser draws its text itself and loses typed chunks.
constexpr std::u16string_view DocumentEditorAddress = u"https://docs.google.com/document";
constexpr double DocumentEditorPause = 0.05;  // seconds
// Against programs whose elements are their own ancestors.
constexpr int MaximumAncestors = 1000;

// Shorter texts are typed whatever key is held.
constexpr std::size_t HeldKeyMinimumLength = 21;
constexpr KeyCode HeldKey = KeyCode::A;

// Units in a typed chunk of a text with many characters that no key of the layout types: so many of them as a batch
// has room for can be typed before the poster gives up waiting for free key codes.
constexpr std::uint64_t BlockLengthWithoutKeys = 2;

bool isString(const std::optional<std::u16string>& value, std::u16string_view expected) {
    return value && *value == expected;
}

}  // namespace

ContextInputResolver::ContextInputResolver(const ProcessManager& processManager, BundleIdentifierResolver& identifiers,
                                           const Accessibility& accessibility, const EventPoster& poster)
    : processManager_(processManager),
      identifiers_(identifiers),
      accessibility_(accessibility),
      poster_(poster),
      setting_(std::make_shared<ContextInputSetting>()) {}

void ContextInputResolver::refresh() {
    const auto front = processManager_.frontProcess();
    contextBundleIdentifier_ = front ? identifiers_.getBundleIdentifier(*front) : std::nullopt;
    bool isKnown = false;
    setting_ = applicationSettings.resolve(contextBundleIdentifier_, isKnown);
    if (isKnown) return;

    // Sheets of these programs take no events at the later place of the event stream.
    const bool hasSheets = isString(contextBundleIdentifier_, u"com.apple.TextEdit") ||
                           isString(contextBundleIdentifier_, u"com.apple.mail");
    if (!listenAtAnnotatedSession || !hasSheets) return;
    const auto top = AXUtils::getFocusedTopLevelUIElement(accessibility_);
    if (!top || !isString(top->stringAttribute("AXRole"), u"AXSheet")) return;
    setting_->flags |= InputFlag::PostToSessionEventTap | InputFlag::UseClipboard;
}

void ContextInputResolver::prepareSending(const SnippetExpandedContent* content) {
    refresh();
    decide(content);
    if (!setting_->canPaste()) typeThisOne(content);
}

void ContextInputResolver::decide(const SnippetExpandedContent* content) {
    if (has(InputFlag::UseClipboard)) return;
    askFocusedElement();
    if (content && content->isRich()) {
        setting_->flags |= InputFlag::UseClipboard;
        return;
    }
    if (preferences.useClipboard) applyPreference();
    if (!content || has(InputFlag::UseClipboard)) return;
    if (mustPaste(content->string())) {
        setting_->flags |= InputFlag::UseClipboard;
    } else if (!canBeTyped(content->string())) {
        pasteThisOne();
    }
}

// A copy: that this text cannot be typed says nothing about the next one.
void ContextInputResolver::pasteThisOne() {
    setting_ = std::make_shared<ContextInputSetting>(*setting_);
    setting_->flags |= InputFlag::UseClipboard;
}

void ContextInputResolver::typeThisOne(const SnippetExpandedContent* content) {
    setting_ = std::make_shared<ContextInputSetting>(*setting_);
    setting_->flags -= InputFlag::UseClipboard;
    if (content && !poster_.canType(content->string())) setting_->blockLength = BlockLengthWithoutKeys;
}

void ContextInputResolver::askFocusedElement() {
    const auto focused = AXUtils::getFocusedUIElement(accessibility_);
    if (!focused) return;
    if (isString(contextBundleIdentifier_, u"com.apple.Safari")) return lookForDocumentEditor(focused);
    if (!isString(focused->stringAttribute("AXSubrole"), u"AXSearchField")) return;
    // The search field of a help menu.
    const auto parent = focused->elementAttribute("AXParent");
    if (parent && isString(parent->stringAttribute("AXRole"), u"AXMenuItem")) {
        setting_->flags |= InputFlag::UseClipboard;
    }
}

void ContextInputResolver::lookForDocumentEditor(std::shared_ptr<UIElement> element) {
    for (int i = 0; element && i < MaximumAncestors; ++i) {
        if (isString(element->stringAttribute("AXRole"), u"AXWebArea")) {
            const auto address = element->stringAttribute("AXURL");
            if (address && address->starts_with(DocumentEditorAddress)) {
                setting_->flags |= InputFlag::UseClipboard;
                setting_->afterPastingDelay = DocumentEditorPause;
                return;
            }
        }
        element = element->elementAttribute("AXParent");
    }
}

void ContextInputResolver::applyPreference() {
    const auto& listed = preferences.useClipboardApplications;
    const bool isListed = setting_->bundleIdentifier &&
                          std::find(listed.begin(), listed.end(), *setting_->bundleIdentifier) != listed.end();
    bool paste = true;
    if (preferences.useClipboardIn == 2) {
        paste = isListed;
    } else if (preferences.useClipboardIn != 0) {
        paste = !isListed;
    }
    if (paste) {
        setting_->flags |= InputFlag::UseClipboard;
    } else {
        setting_->flags -= InputFlag::UseClipboard;
    }
}

bool ContextInputResolver::mustPaste(std::u16string_view text) const {
    if (has(InputFlag::UseClipboardIfHasNewLine) && text.find(u'\n') != std::u16string_view::npos) return true;
    if (preferences.useClipboardForLongText && isLong(text)) return true;
    return text.size() >= HeldKeyMinimumLength && poster_.isKeyDown(HeldKey);
}

bool ContextInputResolver::canBeTyped(std::u16string_view text) const {
    const auto isSurrogate = [](char16_t unit) { return unit >= 0xD800 && unit <= 0xDFFF; };
    if (setting_->longestTyped > 0 && text.size() > setting_->longestTyped) return false;
    if (!setting_->typesBeyondBmp && std::any_of(text.begin(), text.end(), isSurrogate)) return false;
    return poster_.canType(text);
}

bool ContextInputResolver::isLong(std::u16string_view text) const {
    return preferences.longTextLength >= 0 && text.size() > static_cast<std::size_t>(preferences.longTextLength);
}

}  // namespace plume
