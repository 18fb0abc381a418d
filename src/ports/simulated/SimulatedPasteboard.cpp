#include "ports/simulated/SimulatedPasteboard.h"

#include <algorithm>

#include "Foundation/Strings.h"

namespace plume {

void SimulatedPasteboard::copyFromProgram(const std::vector<std::pair<std::string, std::string>>& contents) {
    std::vector<std::string> names;
    names.reserve(contents.size());
    for (const auto& content : contents) names.push_back(content.first);
    declareTypes(names, nullptr);
    for (const auto& content : contents) setData(content.second, content.first);
}

void SimulatedPasteboard::copyFromProgram(std::u16string_view text) {
    const std::string type(PasteboardType::String);
    declareTypes({type}, nullptr);
    setString(text, type);
}

std::vector<std::string> SimulatedPasteboard::types() const {
    std::vector<std::string> names;
    names.reserve(items_.size());
    for (const Item& item : items_) names.push_back(item.type);
    return names;
}

std::optional<std::u16string> SimulatedPasteboard::string() const {
    const Item* item = redeemed(PasteboardType::String);
    if (!item) return std::nullopt;
    if (item->text || !item->bytes) return item->text;
    return fromUtf8(*item->bytes);
}

std::optional<std::string> SimulatedPasteboard::data(std::string_view type) const {
    const Item* item = redeemed(type);
    return item ? item->bytes : std::nullopt;
}

std::int64_t SimulatedPasteboard::declareTypes(const std::vector<std::string>& types, PasteboardOwner* owner) {
    items_.clear();
    for (const std::string& type : types) items_.push_back({type, std::nullopt, std::nullopt});
    owner_ = owner;
    return ++changeCount_;
}

void SimulatedPasteboard::setString(std::u16string_view string, std::string_view type) {
    Item* item = itemOf(type);
    if (!item) return;
    item->text = std::u16string(string);
    item->bytes = toUtf8(string);
}

void SimulatedPasteboard::setData(std::string_view bytes, std::string_view type) {
    Item* item = itemOf(type);
    if (!item) return;
    item->text.reset();
    item->bytes = std::string(bytes);
}

SimulatedPasteboard::Item* SimulatedPasteboard::itemOf(std::string_view type) {
    const auto found = std::find_if(items_.begin(), items_.end(), [&](const Item& item) { return item.type == type; });
    return found == items_.end() ? nullptr : &*found;
}

const SimulatedPasteboard::Item* SimulatedPasteboard::redeemed(std::string_view type) const {
    // Whoever reads does not see the difference between promised and written content, so neither does the interface.
    auto& self = const_cast<SimulatedPasteboard&>(*this);
    const Item* item = self.itemOf(type);
    if (!item || item->bytes || !owner_) return item;
    owner_->provideData(self, type);
    return self.itemOf(type);
}

}  // namespace plume
