#include "library/SnippetGroup.h"

#include <algorithm>
#include <any>
#include <limits>
#include <tuple>
#include <utility>

namespace plume {

namespace {

constexpr char16_t LineFeed = u'\n';
constexpr std::u16string_view CarriageReturn = u"\r";

// Values that do not fit stop at the limits, so that a meaningless one never turns into one with a meaning.
template <typename Enumeration>
Enumeration decodeSetting(const KeyedDecoder& coder, std::string_view key) {
    using Limits = std::numeric_limits<std::int32_t>;
    const std::int64_t value = coder.decodeInteger(key);
    return static_cast<Enumeration>(std::clamp<std::int64_t>(value, Limits::min(), Limits::max()));
}

template <typename Enumeration>
std::int64_t codeOf(Enumeration value) {
    return static_cast<std::int64_t>(value);
}

// A list is archived only while its option makes use of it.
bool usesList(std::int64_t option) {
    return option == PLFunctionAvailability::ExceptListed || option == PLFunctionAvailability::OnlyListed;
}

// A snippet that stands in several groups is one object in all of them.
std::shared_ptr<Snippet> decodeSnippet(KeyedDecoder& coder) {
    std::any& decoded = coder.decodedObject();
    if (const auto* known = std::any_cast<std::shared_ptr<Snippet>>(&decoded)) return *known;
    auto snippet = std::make_shared<Snippet>(coder);
    decoded = snippet;
    return snippet;
}

}  // namespace

SnippetGroup::SnippetGroup() : uuid_(Uuid::random()), dateCreated_(currentDate()) {}

std::shared_ptr<SnippetGroup> SnippetGroup::make() {
    return std::shared_ptr<SnippetGroup>(new SnippetGroup());
}

std::shared_ptr<SnippetGroup> SnippetGroup::makeWithCoder(const KeyedDecoder& coder) {
    auto group = make();
    if (coder.containsValueForKey("UUID")) {
        const Text text = coder.decodeString("UUID");
        group->uuid_ = text ? Uuid::parse(*text) : std::nullopt;
    }
    if (const auto date = coder.decodeDate("DateCreated")) group->dateCreated_ = date;
    group->name_ = coder.decodeString("Name");
    coder.decodeObjects("Items", [&](KeyedDecoder& item) { group->items_.push_back(decodeSnippet(item)); });
    group->expandAfter_ = decodeSetting<ExpandAfter>(coder, "ExpandAfter");
    group->expandAfterDelimiters_ =
        replaceNewlineCharacterByCarriageReturnCharacter(coder.decodeCharacterSet("ExpandAfterDelimiters"));
    group->expandTrigger_ = decodeSetting<ExpandTrigger>(coder, "ExpandTrigger");
    group->delimiters_ = replaceNewlineCharacterByCarriageReturnCharacter(coder.decodeCharacterSet("Delimiters"));
    group->caseSensitivity_ = static_cast<CaseSensitivity>(coder.decodeInteger("CaseSensitivity"));
    // The two switches differ on purpose: missing, the menu entry is on and suggestions are off.
    if (coder.containsValueForKey("ShowInMenuBar")) group->showInMenuBar_ = coder.decodeBool("ShowInMenuBar");
    group->suggestAbbreviations_ = coder.decodeBool("SuggestAbbreviations");
    group->abbreviationPrefix_ = coder.decodeString("AbbreviationPrefix");
    group->readAvailability(coder);
    group->resetFormatting_ = coder.decodeBool("ResetFormatting");
    for (const auto& snippet : group->items_) snippet->setParentGroup(group);
    return group;
}

void SnippetGroup::readAvailability(const KeyedDecoder& coder) {
    availability_.availability = coder.decodeInteger("EnabledIn");
    availability_.applications = coder.decodeStrings("Applications");
    availability_.inputMethodsOption = coder.decodeInteger("InputMethodsOption");
    availability_.inputMethods = coder.decodeStrings("InputMethods");
}

void SnippetGroup::encodeWithCoder(KeyedEncoder& coder) const {
    coder.encodeString("UUID", uuid_ ? Text(uuid_->toString()) : std::nullopt);
    coder.encodeDate("DateCreated", dateCreated_);
    coder.encodeString("Name", name_);
    std::vector<const KeyedCodable*> items;
    items.reserve(items_.size());
    for (const auto& snippet : items_) items.push_back(snippet.get());
    coder.encodeObjects("Items", items);
    coder.encodeInteger("ExpandAfter", codeOf(expandAfter_));
    if (expandAfterDelimiters_) coder.encodeCharacterSet("ExpandAfterDelimiters", expandAfterDelimiters_);
    coder.encodeInteger("ExpandTrigger", codeOf(expandTrigger_));
    if (delimiters_) coder.encodeCharacterSet("Delimiters", delimiters_);
    coder.encodeInteger("CaseSensitivity", codeOf(caseSensitivity_));
    coder.encodeBool("ShowInMenuBar", showInMenuBar_);
    coder.encodeBool("SuggestAbbreviations", suggestAbbreviations_);
    if (abbreviationPrefix_) coder.encodeString("AbbreviationPrefix", abbreviationPrefix_);
    encodeAvailability(coder);
    coder.encodeBool("ResetFormatting", resetFormatting_);
}

void SnippetGroup::encodeAvailability(KeyedEncoder& coder) const {
    const auto& [availability, applications, inputMethodsOption, inputMethods] = availability_;
    coder.encodeInteger("EnabledIn", availability);
    if (usesList(availability) && applications) coder.encodeStrings("Applications", applications);
    coder.encodeInteger("InputMethodsOption", inputMethodsOption);
    if (usesList(inputMethodsOption) && inputMethods) coder.encodeStrings("InputMethods", inputMethods);
}

void SnippetGroup::addItem(const std::shared_ptr<Snippet>& snippet) {
    insertItem(snippet, items_.size());
}

void SnippetGroup::addItems(const std::vector<std::shared_ptr<Snippet>>& snippets) {
    const std::size_t first = items_.size();
    // Counted beforehand: the group's own items may be what is added.
    const std::size_t count = snippets.size();
    items_.reserve(first + count);
    for (std::size_t i = 0; i < count; ++i) {
        if (!snippets[i]) continue;
        snippets[i]->setParentGroup(weak_from_this());
        items_.push_back(snippets[i]);
    }
    const std::size_t added = items_.size() - first;
    if (added == 0) return;
    notifyObservers([&](SnippetGroupObserver& observer) { observer.itemsAdded(*this, first, added); });
}

void SnippetGroup::insertItem(const std::shared_ptr<Snippet>& snippet, std::size_t index) {
    if (!snippet) return;
    const std::size_t place = std::min(index, items_.size());
    snippet->setParentGroup(weak_from_this());
    items_.insert(items_.begin() + static_cast<std::ptrdiff_t>(place), snippet);
    notifyObservers([&](SnippetGroupObserver& observer) { observer.itemsAdded(*this, place, 1); });
}

void SnippetGroup::removeItem(const std::shared_ptr<Snippet>& snippet) {
    // A copy: the caller's reference may be to the element that goes.
    const std::shared_ptr<Snippet> removed = snippet;
    const auto place = [&] { return std::find(items_.begin(), items_.end(), removed); };
    for (auto found = place(); found != items_.end(); found = place()) {
        const auto index = static_cast<std::size_t>(found - items_.begin());
        items_.erase(found);
        if (removed->parentGroup().get() == this) removed->setParentGroup({});
        notifyObservers([&](SnippetGroupObserver& observer) { observer.itemRemoved(*this, *removed, index); });
    }
}

void SnippetGroup::replaceItems(const std::vector<std::shared_ptr<Snippet>>& snippets) {
    // A copy: they may be this group's own.
    const std::vector<std::shared_ptr<Snippet>> added(snippets.begin(), snippets.end());
    while (!items_.empty()) {
        const std::shared_ptr<Snippet> removed = items_.back();
        items_.pop_back();
        if (removed->parentGroup().get() == this) removed->setParentGroup({});
        notifyObservers([&](SnippetGroupObserver& observer) { observer.itemRemoved(*this, *removed, items_.size()); });
    }
    addItems(added);
}

void SnippetGroup::setExpandTrigger(ExpandTrigger value) {
    if (std::exchange(expandTrigger_, value) != value) notifyMatchingSettingsChanged();
}

void SnippetGroup::setDelimiters(std::optional<CharacterSet> set) {
    if (set == delimiters_) return;
    delimiters_ = std::move(set);
    notifyMatchingSettingsChanged();
}

void SnippetGroup::setAbbreviationPrefix(Text prefix) {
    if (prefix == abbreviationPrefix_) return;
    abbreviationPrefix_ = std::move(prefix);
    notifyMatchingSettingsChanged();
}

bool SnippetGroup::hasAbbreviationPrefix() const {
    return abbreviationPrefix_ && !abbreviationPrefix_->empty();
}

std::shared_ptr<SnippetGroup> SnippetGroup::copySnippetGroup(bool withItems) const {
    auto copy = make();
    copy->name_ = name_;
    copy->abbreviationPrefix_ = abbreviationPrefix_;
    copy->copySettingsFromGroup(*this);
    if (withItems) {
        copy->items_.reserve(items_.size());
        for (const auto& snippet : items_) copy->addItem(snippet->copySnippet());
    }
    return copy;
}

void SnippetGroup::copySettingsFromGroup(const SnippetGroup& other) {
    const bool matchingChanges = expandTrigger_ != other.expandTrigger_ || delimiters_ != other.delimiters_;
    expandAfter_ = other.expandAfter_;
    expandAfterDelimiters_ = other.expandAfterDelimiters_;
    expandTrigger_ = other.expandTrigger_;
    delimiters_ = other.delimiters_;
    caseSensitivity_ = other.caseSensitivity_;
    resetFormatting_ = other.resetFormatting_;
    showInMenuBar_ = other.showInMenuBar_;
    suggestAbbreviations_ = other.suggestAbbreviations_;
    availability_ = other.availability_;
    if (matchingChanges) notifyMatchingSettingsChanged();
}

std::shared_ptr<SnippetGroup> SnippetGroup::snapshot() const {
    auto copy = make();
    copy->uuid_ = uuid_;
    copy->dateCreated_ = dateCreated_;
    copy->name_ = name_;
    copy->abbreviationPrefix_ = abbreviationPrefix_;
    copy->copySettingsFromGroup(*this);
    return copy;
}

bool SnippetGroup::hasSameSettings(const SnippetGroup& other) const {
    const auto settings = [](const SnippetGroup& group) {
        return std::tie(group.name_, group.abbreviationPrefix_, group.expandAfter_, group.expandAfterDelimiters_,
                        group.expandTrigger_, group.delimiters_, group.caseSensitivity_, group.resetFormatting_,
                        group.showInMenuBar_, group.suggestAbbreviations_, group.availability_);
    };
    return settings(*this) == settings(other);
}

void SnippetGroup::takeSettings(const SnippetGroup& other) {
    setName(other.name_);
    setAbbreviationPrefix(other.abbreviationPrefix_);
    copySettingsFromGroup(other);
}

std::shared_ptr<Snippet> SnippetGroup::findSnippetWithAbbreviation(std::u16string_view abbreviation) const {
    const auto found = std::find_if(items_.begin(), items_.end(),
                                    [&](const auto& snippet) { return snippet->abbreviation() == abbreviation; });
    return found == items_.end() ? nullptr : *found;
}

std::optional<CharacterSet> SnippetGroup::replaceNewlineCharacterByCarriageReturnCharacter(
    const std::optional<CharacterSet>& set) {
    if (!set || !set->contains(LineFeed)) return set;
    return set->subtracting(CharacterSet::withCharacters(std::u16string_view(&LineFeed, 1)))
        .united(CharacterSet::withCharacters(CarriageReturn));
}

void SnippetGroup::addGroupObserver(SnippetGroupObserver* observer) {
    observers_.push_back(observer);
}

void SnippetGroup::removeGroupObserver(SnippetGroupObserver* observer) {
    std::erase(observers_, observer);
}

void SnippetGroup::snippetAbbreviationChanged(Snippet& snippet, const Text& previous) {
    notifyObservers([&](SnippetGroupObserver& observer) { observer.abbreviationChanged(*this, snippet, previous); });
}

void SnippetGroup::notifyMatchingSettingsChanged() {
    notifyObservers([&](SnippetGroupObserver& observer) { observer.matchingSettingsChanged(*this); });
}

void SnippetGroup::notifyObservers(const std::function<void(SnippetGroupObserver&)>& tell) {
    const auto observers = observers_;
    for (SnippetGroupObserver* observer : observers) {
        const bool stays = std::find(observers_.begin(), observers_.end(), observer) != observers_.end();
        if (stays) tell(*observer);
    }
}

}  // namespace plume
