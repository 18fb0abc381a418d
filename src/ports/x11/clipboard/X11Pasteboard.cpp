#include "ports/x11/clipboard/X11Pasteboard.h"

#include <xcb/xfixes.h>

#include <algorithm>
#include <cstring>
#include <utility>

#include "Foundation/Strings.h"
#include "ports/x11/clipboard/X11FrontPrograms.h"
#include "ports/x11/clipboard/X11PasteboardContent.h"
#include "ports/x11/clipboard/X11SelectionOwner.h"
#include "ports/x11/clipboard/X11SelectionReader.h"
#include "ports/x11/clipboard/X11SelectionTransfers.h"
#include "ports/x11/clipboard/X11SelectionTypes.h"

namespace plume {

namespace {

constexpr double LongestHandOver = 0.5;  // seconds
constexpr double LongestReading = 1.0;
constexpr std::size_t MostManagers = 16;

// Text in whatever encoding a program gave it.
std::string utf8FromText(std::string_view bytes, std::string_view target) {
    const bool isLatin1 =
        target == SelectionTarget::Latin1String || (target == SelectionTarget::PlainText && !fromStrictUtf8(bytes));
    return isLatin1 ? utf8FromLatin1(bytes) : std::string(bytes);
}

}  // namespace

Result<std::unique_ptr<X11Pasteboard>> X11Pasteboard::open(X11Session& session) {
    if (!session.connection().extension(xcb_xfixes_id)) {
        return Error{"The X server \"" + session.connection().displayName() +
                     "\" lacks the XFIXES extension, which Plume needs to follow the clipboard: switch it on."};
    }
    const auto cookie = xcb_xfixes_query_version(session.get(), 1, 0);
    const XcbOwned<xcb_xfixes_query_version_reply_t> version(
        xcb_xfixes_query_version_reply(session.get(), cookie, nullptr));
    if (!version) return Error{"The X server is gone."};
    return std::unique_ptr<X11Pasteboard>(new X11Pasteboard(session));
}

X11Pasteboard::X11Pasteboard(X11Session& session)
    : session_(session),
      transfers_(std::make_unique<X11SelectionTransfers>(session)),
      reader_(std::make_unique<X11SelectionReader>(session, "CLIPBOARD")),
      primaryReader_(std::make_unique<X11SelectionReader>(session, "PRIMARY")),
      target_(session),
      questions_(session) {
    clipboard_ =
        std::make_unique<X11SelectionOwner>(session, *transfers_, "CLIPBOARD", [this](bool ours) { noteChange(ours); });
    primary_ = std::make_unique<X11SelectionOwner>(session, *transfers_, "PRIMARY",
                                                   [this](bool) { primaryReader_->ownerChanged(); });
    questions_.ownerChanged(clipboard_->owner());
    connectOwners();
}

X11Pasteboard::~X11Pasteboard() = default;

void X11Pasteboard::connectOwners() {
    for (X11SelectionOwner* const owner : {clipboard_.get(), primary_.get()}) {
        owner->readingCounts = [this](xcb_window_t requestor) { return mayBePasting(requestor); };
        owner->isGiven = [this](xcb_window_t requestor) {
            if (target_.isOf(requestor)) target_.isGiven();
        };
        owner->wasRead = [this](xcb_window_t requestor, std::function<void()> tell) {
            if (!target_.isOf(requestor)) return tell();
            target_.wasTaken(std::move(tell));
        };
        owner->contentInstead = [this, owner](xcb_window_t requestor, xcb_atom_t target, xcb_timestamp_t time) {
            if (lateContent_ && target_.isLate(requestor, time)) return lateContent_;
            return owner == clipboard_.get() ? contentBeforeFor(requestor, target) : nullptr;
        };
    }
    clipboard_->toldTargets = [this](xcb_window_t requestor) { questions_.wasAnswered(requestor); };
}

void X11Pasteboard::noteChange(bool ours) {
    ++changeCount_;
    if (ours) declaredCount_ = changeCount_;
    if (!ours && sharedCopy_) sharedCopy_->clear();
    if (!ours) lateContent_.reset();
    if (!ours && ownershipLost) ownershipLost();
    reader_->ownerChanged();
    questions_.ownerChanged(clipboard_->owner());
}

void X11Pasteboard::offer(const std::vector<SharedClipboardCopy::Entry>& entries) {
    std::vector<std::string> types;
    for (const auto& entry : entries) {
        types.push_back(entry.type);
        forms_.insert_or_assign(entry.type, std::pair(entry.form, entry.format));
    }
    declareTypes(types, nullptr);
    for (const auto& entry : entries) setData(entry.bytes, entry.type);
}

bool X11Pasteboard::mayBePasting(xcb_window_t requestor) const {
    return target_.isOf(requestor) || isInFront(session_, requestor);
}

// A clipboard manager that is in the middle of what the user copied goes on with that, and one that was met before sees
// no expansion at all. Whoever pastes is in front, or has asked what is on offer.
std::shared_ptr<X11PasteboardContent> X11Pasteboard::contentBeforeFor(xcb_window_t requestor, xcb_atom_t target) {
    const bool isExpansion = content_ && content_->isExpansion();
    if (!isExpansion || !sharedCopy_ || mayBePasting(requestor)) return {};
    const xcb_window_t client = clientOf(session_, requestor);
    if (managers_.size() >= MostManagers) managers_.clear();
    if (X11PasteboardContent::isHint(session_.connection().atomName(target))) {
        managers_.try_emplace(client, changeCount_);
    }
    const auto manager = managers_.find(client);
    // One that has just been met goes on with what it has half of.
    const bool isMet = manager != managers_.end() && manager->second != changeCount_;
    const bool asksForTargets = target == session_.connection().atom("TARGETS");
    const bool mayPaste = asksForTargets || questions_.isAnswered(requestor);
    return mayPaste && !isMet ? nullptr : contentBefore();
}

// What the user had there; null when it is not known.
std::shared_ptr<X11PasteboardContent> X11Pasteboard::contentBefore() {
    if (contentBefore_) return contentBefore_;
    std::vector<std::string> types;
    const auto entries = SharedClipboardCopy::read(sharedCopy_->descriptor());
    types.reserve(entries.size());
    for (const auto& entry : entries) types.push_back(entry.type);
    if (types.empty()) return {};
    contentBefore_ =
        std::make_shared<X11PasteboardContent>(session_.connection(), *this, std::move(types), nullptr, forms_);
    for (const auto& entry : entries) contentBefore_->set(entry.bytes, entry.type);
    return contentBefore_;
}

bool X11Pasteboard::isHeld() const {
    session_.collect();
    return clipboard_->hasOwner();
}

bool X11Pasteboard::isOffering() const {
    session_.collect();
    return clipboard_->isOwner();
}

std::int64_t X11Pasteboard::changeCount() const {
    session_.collect();
    return changeCount_;
}

std::vector<std::string> X11Pasteboard::types() const {
    if (isOffering()) return content_ ? content_->types() : std::vector<std::string>();
    return clipboard_->hasOwner() ? typesOfTargets(reader_->targets()) : std::vector<std::string>();
}

std::optional<std::u16string> X11Pasteboard::string() const {
    const auto bytes = data(PasteboardType::String);
    return bytes ? std::optional(fromUtf8(*bytes)) : std::nullopt;
}

std::optional<std::string> X11Pasteboard::data(std::string_view type) const {
    if (isOffering()) {
        const auto content = content_;
        return content ? content->data(type) : std::nullopt;
    }
    if (!clipboard_->hasOwner()) return std::nullopt;
    const std::string target(targetForType(type, reader_->targets()));
    if (target.empty() || isMetaTarget(target)) return std::nullopt;
    const auto value = reader_->read(target);
    if (!value) return std::nullopt;
    const bool isText = type == PasteboardType::String;
    if (!isText) forms_.insert_or_assign(target, std::pair(value->type, value->format));
    std::string bytes = isText ? utf8FromText(*value->bytes, target) : *value->bytes;
    if (sharedCopy_) sharedCopy_->add(type, isText ? xcb_atom_t{XCB_ATOM_NONE} : value->type, value->format, bytes);
    return bytes;
}

std::int64_t X11Pasteboard::declareTypes(const std::vector<std::string>& types, PasteboardOwner* owner) {
    session_.collect();
    keepForTarget();
    contentBefore_.reset();
    const bool followsExpansion = content_ && content_->isExpansion();
    content_ = std::make_shared<X11PasteboardContent>(session_.connection(), *this, types, owner, forms_);
    if (followsExpansion) hintForAMoment();
    declaredCount_ = 0;
    if (types.empty() && !lateContent_) {
        clipboard_->release();
    } else {
        clipboard_->own(content_);
    }
    // The server may have refused, or be gone: even so what was declared is something new.
    if (declaredCount_ == 0) declaredCount_ = ++changeCount_;
    if (lateContent_) target_.contentWasReplaced(clipboard_->ownedSince());
    offerPrimary();
    return declaredCount_;
}

// A clipboard manager that has read half of an expansion goes on with what is there now. It knows the targets from
// before, and is not to keep what it gets.
void X11Pasteboard::hintForAMoment() {
    content_->setHints(true);
    const auto end = [content = content_] { content->setHints(content->isExpansion()); };
    hintsEnd_ = session_.runLoop().performAfterDelay(LongestReading, end);
}

// The content that was pasted and not taken, when something else takes its place.
void X11Pasteboard::keepForTarget() {
    lateContent_ = content_ && content_->isExpansion() && target_.isToTake() ? content_ : nullptr;
    if (lateContent_) lateContent_->redeemAll();
}

void X11Pasteboard::paste(std::function<void()> sendKeystroke) {
    questions_.whenAnswered([this, sendKeystroke = std::move(sendKeystroke)](const X11FrontWindows& front) {
        target_.begin(front);
        sendKeystroke();
    });
}

void X11Pasteboard::setString(std::u16string_view string, std::string_view type) {
    if (content_) content_->set(toUtf8(string), type);
}

void X11Pasteboard::setData(std::string_view bytes, std::string_view type) {
    if (content_) content_->set(std::string(bytes), type);
}

void X11Pasteboard::offerPrimary() {
    if (content_->isExpansion() && pastesPrimary_) {
        if (!primary_->isOwner()) selectedBefore_ = selectedText();
        primary_->own(content_, clipboard_->ownedSince());
    } else if (primary_->isOwner() && primary_->content() != selectedBefore_) {
        if (selectedBefore_) {
            primary_->own(selectedBefore_);
        } else {
            primary_->release();
        }
    }
}

std::shared_ptr<X11PasteboardContent> X11Pasteboard::selectedText() {
    if (!primary_->hasOwner()) return nullptr;
    const auto value = primaryReader_->read(SelectionTarget::Utf8String);
    if (!value) return nullptr;
    const std::string type(PasteboardType::String);
    auto text =
        std::make_shared<X11PasteboardContent>(session_.connection(), *this, std::vector{type}, nullptr, forms_);
    text->set(*value->bytes, type);
    return text;
}

void X11Pasteboard::handOver() {
    constexpr std::string_view Property = "PLUME_SAVE_TARGETS";
    if (!isOffering() || !content_ || content_->isExpansion()) return;
    XcbConnection& connection = session_.connection();
    const xcb_atom_t manager = connection.atom("CLIPBOARD_MANAGER");
    const xcb_atom_t property = connection.atom(Property);
    const auto targets = content_->targets();
    xcb_change_property(session_.get(), XCB_PROP_MODE_REPLACE, session_.window(), property, XCB_ATOM_ATOM, 32,
                        static_cast<std::uint32_t>(targets.size()), targets.data());
    bool isAnswered = false;
    const Subscription observer = session_.addObserver(XCB_SELECTION_NOTIFY, [&](const xcb_generic_event_t& event) {
        isAnswered |= reinterpret_cast<const xcb_selection_notify_event_t&>(event).selection == manager;
    });
    // Without a manager the server itself answers at once.
    xcb_convert_selection(session_.get(), session_.window(), manager, connection.atom("SAVE_TARGETS"), property,
                          session_.serverTime());
    const auto served = [&] {
        session_.drain();
        return isAnswered;
    };
    session_.waitUntil(served, LongestHandOver);
}

}  // namespace plume
