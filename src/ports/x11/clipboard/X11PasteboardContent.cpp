#include "ports/x11/clipboard/X11PasteboardContent.h"

#include <algorithm>

#include "ports/x11/clipboard/X11SelectionTypes.h"

namespace plume {

namespace {

// What asks clipboard managers to keep nothing of an expansion, by the target's name. CopyQ reads the second up to its
// version 7.
constexpr std::pair<std::string_view, std::string_view> HistoryHints[] = {
    {SelectionTarget::PasswordManagerHint, "secret"}, {SelectionTarget::CopyQHidden, "1"}};

// Empty for other targets.
std::string_view historyHint(std::string_view target) {
    const auto* const found =
        std::ranges::find(HistoryHints, target, &std::pair<std::string_view, std::string_view>::first);
    return found == std::end(HistoryHints) ? std::string_view() : found->second;
}

bool isOfPasteboardTypes(const std::vector<std::string>& types) {
    return !types.empty() && std::all_of(types.begin(), types.end(), [](const std::string& type) {
        return type == PasteboardType::RTFD || !targetsOfType(type).empty();
    });
}

void append(std::vector<std::string>& names, std::span<const std::string_view> more) {
    for (const std::string_view name : more) {
        if (std::find(names.begin(), names.end(), name) == names.end()) names.emplace_back(name);
    }
}

}  // namespace

X11PasteboardContent::X11PasteboardContent(XcbConnection& connection, Pasteboard& pasteboard,
                                           std::vector<std::string> types, PasteboardOwner* owner,
                                           const X11ValueForms& forms)
    : connection_(connection),
      pasteboard_(pasteboard),
      types_(std::move(types)),
      owner_(owner),
      forms_(forms),
      isExpansion_(owner != nullptr && isOfPasteboardTypes(types_)),
      hints_(isExpansion_) {}

bool X11PasteboardContent::isHint(std::string_view target) {
    return !historyHint(target).empty();
}

bool X11PasteboardContent::declares(std::string_view type) const {
    return std::find(types_.begin(), types_.end(), type) != types_.end();
}

std::optional<std::string> X11PasteboardContent::data(std::string_view type) {
    if (!declares(type)) return std::nullopt;
    const Bytes bytes = redeemed(type);
    return bytes ? std::optional(*bytes) : std::nullopt;
}

void X11PasteboardContent::set(std::string bytes, std::string_view type) {
    data_.insert_or_assign(std::string(type), std::make_shared<const std::string>(std::move(bytes)));
}

X11PasteboardContent::Bytes X11PasteboardContent::redeemed(std::string_view type) {
    auto found = data_.find(type);
    if (found == data_.end() && owner_) {
        owner_->provideData(pasteboard_, type);
        found = data_.find(type);
    }
    return found == data_.end() ? nullptr : found->second;
}

void X11PasteboardContent::redeemAll() {
    for (const std::string& name : targetNames()) redeemed(typeBehind(name));
}

std::vector<std::string> X11PasteboardContent::targetNames() const {
    std::vector<std::string> names;
    for (const std::string& type : types_) {
        const auto targets = targetsOfType(type);
        // What came from a program is given back under the program's names alone.
        const bool hasNames = std::any_of(targets.begin(), targets.end(), [this](auto name) { return declares(name); });
        if (targets.empty()) {
            const std::string_view own[] = {type};
            append(names, own);
        } else if (!hasNames) {
            append(names, targets);
        }
    }
    if (!isExpansion_) return names;
    // Programs here take rich text as HTML, and many take plain text alone.
    if (declares(PasteboardType::RTFD)) append(names, targetsOfType(PasteboardType::HTML));
    append(names, targetsOfType(PasteboardType::String));
    // Clipboard managers keep nothing of it: it was never the user's own.
    for (const auto& hint : HistoryHints) names.emplace_back(hint.first);
    return names;
}

std::vector<xcb_atom_t> X11PasteboardContent::targets() {
    std::vector<xcb_atom_t> atoms;
    for (const std::string& name : targetNames()) atoms.push_back(connection_.atom(name));
    return atoms;
}

std::string_view X11PasteboardContent::typeBehind(std::string_view target) const {
    return declares(target) ? target : typeOfTarget(target).value_or(target);
}

X11PasteboardContent::Bytes X11PasteboardContent::bytesFor(std::string_view target) {
    const std::string_view hint = historyHint(target);
    if (!hint.empty() && !declares(target)) return std::make_shared<const std::string>(hint);
    Bytes bytes = redeemed(typeBehind(target));
    if (!bytes || declares(target) || target != SelectionTarget::Latin1String) return bytes;
    return std::make_shared<const std::string>(latin1FromUtf8(*bytes));
}

std::optional<X11SelectionValue> X11PasteboardContent::value(xcb_atom_t target) {
    const std::string name = connection_.atomName(target);
    const auto names = targetNames();
    const bool hints = hints_ && isHint(name);
    if (!hints && std::find(names.begin(), names.end(), name) == names.end()) return std::nullopt;
    Bytes bytes = bytesFor(name);
    if (!bytes) return std::nullopt;
    const auto form = declares(name) ? forms_.find(name) : forms_.end();
    if (form == forms_.end()) return X11SelectionValue{target, 8, std::move(bytes)};
    return X11SelectionValue{form->second.first, form->second.second, std::move(bytes)};
}

void X11PasteboardContent::wasTaken(xcb_atom_t target) {
    const std::string name = connection_.atomName(target);
    if (owner_ && !isHint(name)) owner_->dataWasTaken(typeBehind(name));
}

}  // namespace plume
