#include "Foundation/text/AttributedString.h"

#include <algorithm>
#include <atomic>
#include <utility>

namespace plume {

namespace {

// Runs in order, equal neighbours joined, with the place where each of them ends for the search by position.
class RunList {
  public:
    std::vector<AttributedString::Run> runs;
    std::vector<std::size_t> ends;

    std::size_t length() const { return ends.empty() ? 0 : ends.back(); }

    void append(std::size_t count, const SharedAttributes& attributes) {
        if (count == 0) return;
        if (!runs.empty() && sameAttributes(runs.back().attributes, attributes)) {
            runs.back().length += count;
            ends.back() += count;
        } else {
            push(count, attributes);
        }
    }

    // The index of the run that `position`, which is before the end, stands in.
    std::size_t indexAt(std::size_t position) const {
        return static_cast<std::size_t>(std::upper_bound(ends.begin(), ends.end(), position) - ends.begin());
    }

    // The runs of `range` of another list; only the first of them can be equal to the last one here.
    void append(const RunList& other, Range range) {
        if (range.length == 0) return;
        std::size_t i = other.indexAt(range.location);
        std::size_t position = std::min(other.ends[i], range.end());
        append(position - range.location, other.runs[i].attributes);
        while (position < range.end()) {
            ++i;
            const std::size_t end = std::min(other.ends[i], range.end());
            push(end - position, other.runs[i].attributes);
            position = end;
        }
    }

  private:
    void push(std::size_t count, const SharedAttributes& attributes) {
        ends.push_back(length() + count);
        runs.push_back({count, attributes});
    }
};

Range clamped(Range range, std::size_t length) {
    const std::size_t location = std::min(range.location, length);
    return {location, std::min(range.length, length - location)};
}

// Attributes that say nothing are written as null, so that callers can tell plain text by it.
SharedAttributes normalized(SharedAttributes attributes) {
    return sameAttributes(attributes, nullptr) ? nullptr : std::move(attributes);
}

}  // namespace

struct AttributedString::Storage {
    Storage() = default;
    Storage(std::u16string aText, RunList aList) : text(std::move(aText)), list(std::move(aList)) {}

    std::u16string text;
    RunList list;
    // Set for good once a second string refers to the storage: from then on nobody changes it. A count of owners would
    // not do, as the last other owner may just have read it on another thread.
    std::atomic<bool> shared = false;
};

AttributedString::AttributedString() = default;

AttributedString::AttributedString(std::u16string text, SharedAttributes attributes) {
    if (text.empty()) return;
    storage_ = std::make_shared<Storage>();
    storage_->list.append(text.size(), normalized(std::move(attributes)));
    storage_->text = std::move(text);
}

AttributedString::AttributedString(const AttributedString& other) : storage_(other.storage_) {
    if (storage_) storage_->shared.store(true, std::memory_order_relaxed);
}

AttributedString& AttributedString::operator=(const AttributedString& other) {
    if (this != &other) *this = AttributedString(other);
    return *this;
}

const AttributedString::Storage& AttributedString::storage() const {
    static const Storage empty;
    return storage_ ? *storage_ : empty;
}

AttributedString::Storage& AttributedString::mutableStorage() {
    if (!storage_) {
        storage_ = std::make_shared<Storage>();
    } else if (storage_->shared.load(std::memory_order_relaxed)) {
        storage_ = std::make_shared<Storage>(storage_->text, storage_->list);
    }
    return *storage_;
}

const std::u16string& AttributedString::string() const {
    return storage().text;
}

std::size_t AttributedString::length() const {
    return storage().text.size();
}

const std::vector<AttributedString::Run>& AttributedString::runs() const {
    return storage().list.runs;
}

SharedAttributes AttributedString::attributesAt(std::size_t index) const {
    const RunList& list = storage().list;
    if (list.runs.empty()) return nullptr;
    return list.runs[list.indexAt(std::min(index, length() - 1))].attributes;
}

AttributedString AttributedString::substring(Range range) const {
    const Storage& source = storage();
    range = clamped(range, length());
    AttributedString result;
    if (range.length == 0) return result;
    result.storage_ = std::make_shared<Storage>();
    result.storage_->text.assign(source.text, range.location, range.length);
    result.storage_->list.append(source.list, range);
    return result;
}

void AttributedString::append(std::u16string_view text, SharedAttributes attributes) {
    if (text.empty()) return;
    const std::shared_ptr<Storage> previous = storage_;  // `text` may be part of it
    Storage& own = mutableStorage();
    own.text.append(text);
    own.list.append(text.size(), normalized(std::move(attributes)));
}

void AttributedString::append(const AttributedString& other) {
    if (other.isEmpty()) return;
    if (isEmpty()) {
        *this = other;
        return;
    }
    if (this == &other) return append(AttributedString(other));
    Storage& own = mutableStorage();
    own.text.append(other.string());
    own.list.append(other.storage().list, {0, other.length()});
}

void AttributedString::insert(std::size_t index, const AttributedString& other) {
    replace(Range{index, 0}, other);
}

void AttributedString::replace(Range range, std::u16string_view text) {
    range = clamped(range, length());
    SharedAttributes attributes;
    if (range.length > 0) {
        attributes = attributesAt(range.location);
    } else if (range.location > 0) {
        attributes = attributesAt(range.location - 1);
    }
    replace(range, AttributedString(std::u16string(text), std::move(attributes)));
}

void AttributedString::replace(Range range, const AttributedString& other) {
    range = clamped(range, length());
    if (range.length == 0 && other.isEmpty()) return;
    if (range.location == length()) return append(other);
    Storage& own = mutableStorage();
    // `other` may be this very string: the new runs are complete before anything changes.
    RunList list;
    list.append(own.list, {0, range.location});
    list.append(other.storage().list, {0, other.length()});
    list.append(own.list, {range.end(), own.text.size() - range.end()});
    own.list = std::move(list);
    own.text.replace(range.location, range.length, other.string());
}

void AttributedString::erase(Range range) {
    replace(range, AttributedString());
}

void AttributedString::setAttributes(Range range, SharedAttributes attributes) {
    range = clamped(range, length());
    if (range.length == 0) return;
    Storage& own = mutableStorage();
    RunList list;
    list.append(own.list, {0, range.location});
    list.append(range.length, normalized(std::move(attributes)));
    list.append(own.list, {range.end(), own.text.size() - range.end()});
    own.list = std::move(list);
}

AttributedString AttributedString::upperCaseAttributedString() const {
    AttributedString result;
    std::size_t position = 0;
    for (const Run& run : runs()) {
        result.append(uppercased(std::u16string_view(string()).substr(position, run.length)), run.attributes);
        position += run.length;
    }
    return result;
}

bool AttributedString::operator==(const AttributedString& other) const {
    if (storage_ == other.storage_) return true;
    const auto sameRun = [](const Run& a, const Run& b) {
        return a.length == b.length && sameAttributes(a.attributes, b.attributes);
    };
    return string() == other.string() && std::ranges::equal(runs(), other.runs(), sameRun);
}

}  // namespace plume
