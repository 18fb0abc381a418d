#include "input/delivery/ClipboardDataProvider.h"

#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

// Within two seconds from the paste the user's clipboard is back, come what may.
constexpr double LongestOffer = 1.8;  // seconds

bool isWithinALine(std::u16string_view text) {
    return text.find_first_of(u"\n\r\u2029") == std::u16string_view::npos;
}

}  // namespace

ClipboardDataProvider::ClipboardDataProvider(Pasteboard& pasteboard, RunLoop& runLoop)
    : pasteboard_(pasteboard), runLoop_(runLoop) {}

void ClipboardDataProvider::prepareSetData() {
    // What is remembered would pass for the user's latest content while it is older than that.
    if (types_ && pasteboard_.changeCount() != backupChangeCount_) backup();
    provideBackupData_ = false;
    providedData_ = false;
    stringData_.reset();
    attributedStringData_.reset();
    wasPasted();
}

void ClipboardDataProvider::wasPasted() {
    pasted_ = runLoop_.now();
}

void ClipboardDataProvider::setString(std::u16string string) {
    prepareSetData();
    stringData_ = std::move(string);
    changeCount_ = pasteboard_.declareTypes({std::string(PasteboardType::String)}, this);
}

void ClipboardDataProvider::setAttributedString(AttributedString string) {
    prepareSetData();
    attributedStringData_ = std::move(string);
    // No plain text: a target that takes rich text must not settle for less.
    std::vector<std::string> types = {std::string(PasteboardType::RTFD), std::string(PasteboardType::RTF)};
    if (includeHTMLData) types.emplace_back(PasteboardType::HTML);
    changeCount_ = pasteboard_.declareTypes(types, this);
}

void ClipboardDataProvider::provideData(Pasteboard& pasteboard, std::string_view type) {
    if (provideBackupData_) {
        const auto found = backupData_.find(type);
        if (found != backupData_.end()) pasteboard.setData(found->second, type);
        return;
    }
    provideExpansion(pasteboard, type);
    // Where takers are named, whoever else reads (a clipboard manager) does not count.
    if (!pasteboard_.tellsWhenTaken()) providedData_ = true;
}

void ClipboardDataProvider::dataWasTaken(std::string_view /*type*/) {
    // What was given back before the program took it comes to it all the same, and only then does taking count.
    if (provideBackupData_ && providedData_) return;
    providedData_ = true;
    if (restoresWhenTaken_) restoreAfterDelay();
    if (onTaken) onTaken();
}

void ClipboardDataProvider::provideExpansion(Pasteboard& pasteboard, std::string_view type) const {
    if (stringData_) {
        pasteboard.setString(*stringData_, PasteboardType::String);
    } else if (!attributedStringData_) {
        return;
    } else if (type == PasteboardType::String) {
        pasteboard.setString(attributedStringData_->string(), type);
    } else if (type == PasteboardType::RTFD) {
        pasteboard.setData(rtfdFromAttributedString(*attributedStringData_), type);
    } else if (type == PasteboardType::RTF) {
        pasteboard.setData(rtfFromAttributedString(*attributedStringData_), type);
    } else if (type == PasteboardType::HTML) {
        auto excluded = defaultExcludedTags();
        // Programs start a new paragraph for each that is pasted, which words within a line are not.
        if (excludeParagraphTag || isWithinALine(attributedStringData_->string())) excluded.emplace_back("p");
        pasteboard.setData(htmlFromAttributedString(*attributedStringData_, excluded), type);
    }
}

void ClipboardDataProvider::backup() {
    if (pasteboard_.changeCount() == changeCount_) return;
    backupData_.clear();
    backupChangeCount_ = pasteboard_.changeCount();
    types_ = pasteboard_.types();
    for (const auto& type : *types_) {
        if (auto data = pasteboard_.data(type)) backupData_[type] = std::move(*data);
    }
}

void ClipboardDataProvider::restore() {
    pendingRestore_.cancel();
    if (!types_) return;
    // Somebody has copied something since: that is what the user wants to find there.
    if (pasteboard_.changeCount() != changeCount_) return;
    if (!providedData_) {
        if (!pasteboard_.tellsWhenTaken()) return restoreAfterDelay();
        const double left = pasted_ + LongestOffer - runLoop_.now();
        if (left > 0) {
            restoresWhenTaken_ = true;
            pendingRestore_ = runLoop_.performAfterDelay(left, [this] { restore(); });
            return;
        }
    }
    // Until the clipboard has changed, whoever is asked for is asked for the expansion.
    changeCount_ = pasteboard_.declareTypes(*types_, this);
    provideBackupData_ = true;
    restoresWhenTaken_ = false;
}

void ClipboardDataProvider::restoreAfterDelay() {
    restoresWhenTaken_ = false;
    pendingRestore_ = runLoop_.performAfterDelay(restoreDelay, [this] { restore(); });
}

bool ClipboardDataProvider::cancelRestore() {
    const bool wasPending = pendingRestore_ || restoresWhenTaken_;
    pendingRestore_.cancel();
    restoresWhenTaken_ = false;
    return wasPending;
}

bool ClipboardDataProvider::isOffering() const {
    return !provideBackupData_ && types_ && pasteboard_.changeCount() == changeCount_;
}

std::optional<std::string> ClipboardDataProvider::backupDataForType(std::string_view type) const {
    const auto found = backupData_.find(type);
    return found == backupData_.end() ? std::nullopt : std::optional(found->second);
}

std::vector<std::string> UserPasteboard::types() const {
    return provider_.isOffering() ? *provider_.backupTypes() : pasteboard_.types();
}

std::optional<std::u16string> UserPasteboard::string() const {
    if (!provider_.isOffering()) return pasteboard_.string();
    const auto bytes = provider_.backupDataForType(PasteboardType::String);
    return bytes ? std::optional(fromUtf8(*bytes)) : std::nullopt;
}

std::optional<std::string> UserPasteboard::data(std::string_view type) const {
    return provider_.isOffering() ? provider_.backupDataForType(type) : pasteboard_.data(type);
}

}  // namespace plume
