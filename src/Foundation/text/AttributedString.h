// Text with attributes: runs of shared attributes over a UTF-16 string.
//
// A value type: copies are cheap (they share their storage until one of them changes) and independent. Neighbouring
// runs with equal attributes are always joined, so two strings that look the same are equal. Positions past the end are
// brought back to the end; nothing here fails. One string may be read, not changed, from several threads; copies of it
// may be changed on different threads. A string that was moved from is empty.
//
// Appending costs what is appended, a substring what it holds; edits elsewhere cost the length of the whole.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/TextAttributes.h"

namespace plume {

class AttributedString {
  public:
    struct Run {
        std::size_t length = 0;
        SharedAttributes attributes;  // null: none
    };

    AttributedString();
    // Attributes that say nothing are kept as null, here and wherever attributes are given.
    explicit AttributedString(std::u16string text, SharedAttributes attributes = nullptr);
    AttributedString(const AttributedString& other);
    AttributedString(AttributedString&& other) noexcept = default;
    AttributedString& operator=(const AttributedString& other);
    AttributedString& operator=(AttributedString&& other) noexcept = default;
    ~AttributedString() = default;

    const std::u16string& string() const;
    std::size_t length() const;
    bool isEmpty() const { return length() == 0; }

    // The runs in order; their lengths sum to length().
    const std::vector<Run>& runs() const;
    // Attributes of the unit at `index`; at or past the end those of the last unit, null for an empty text.
    SharedAttributes attributesAt(std::size_t index) const;

    AttributedString substring(Range range) const;

    void append(std::u16string_view text, SharedAttributes attributes = nullptr);
    void append(const AttributedString& other);
    void insert(std::size_t index, const AttributedString& other);
    // The inserted text takes the attributes of the first replaced unit, or, for an empty range, of the unit before it.
    void replace(Range range, std::u16string_view text);
    void replace(Range range, const AttributedString& other);
    void erase(Range range);
    void setAttributes(Range range, SharedAttributes attributes);

    // Each run mapped by itself: lengths may change, attributes stay with their text.
    AttributedString upperCaseAttributedString() const;

    bool operator==(const AttributedString& other) const;

  private:
    struct Storage;
    const Storage& storage() const;
    Storage& mutableStorage();
    std::shared_ptr<Storage> storage_;  // null: empty
};

}  // namespace plume
