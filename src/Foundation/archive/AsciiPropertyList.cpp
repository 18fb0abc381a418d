#include "Foundation/archive/AsciiPropertyList.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListLimits.h"

namespace plume {

namespace {

constexpr std::u16string_view WhiteSpace = u" \t\r\n\v\f\u2028\u2029";
constexpr std::u16string_view PlainMarks = u"_$/:.-+";

bool isPlain(char16_t unit) {
    const bool isLetter = (unit >= u'a' && unit <= u'z') || (unit >= u'A' && unit <= u'Z');
    return isLetter || (unit >= u'0' && unit <= u'9') || PlainMarks.find(unit) != std::u16string_view::npos;
}

int hexValue(char16_t unit) {
    if (unit >= u'0' && unit <= u'9') return unit - u'0';
    if (unit >= u'a' && unit <= u'f') return unit - u'a' + 10;
    if (unit >= u'A' && unit <= u'F') return unit - u'A' + 10;
    return -1;
}

class AsciiReader {
  public:
    explicit AsciiReader(std::u16string_view text) : text_(text) {}

    Result<PropertyList> read() {
        PropertyList list;
        if (readDocument(list)) return list;
        const auto start = text_.begin();
        const auto lines = std::count(start, start + static_cast<std::ptrdiff_t>(position_), u'\n');
        return Error{"The property list is wrong at line " + std::to_string(lines + 1) + ": expected " + expected_ +
                     "."};
    }

  private:
    bool fails(const char* expected) {
        expected_ = expected;
        return false;
    }
    bool atEnd() const { return position_ == text_.size(); }
    bool isNext(char16_t unit) const { return !atEnd() && text_[position_] == unit; }
    bool take(char16_t unit) {
        if (!isNext(unit)) return false;
        ++position_;
        return true;
    }

    bool skipSpace() {
        for (;;) {
            position_ = std::min(text_.find_first_not_of(WhiteSpace, position_), text_.size());
            const std::u16string_view rest = text_.substr(position_);
            if (rest.starts_with(u"//")) {
                position_ = std::min(text_.find_first_of(u"\r\n\u2028\u2029", position_), text_.size());
            } else if (rest.starts_with(u"/*")) {
                const std::size_t end = text_.find(u"*/", position_ + 2);
                if (end == std::u16string_view::npos) return fails("the end of a comment");
                position_ = end + 2;
            } else {
                return true;
            }
        }
    }

    bool readDocument(PropertyList& list) {
        if (!skipSpace()) return false;
        if (atEnd()) return fails("a property list");
        if (!readValue(list, 0) || !skipSpace()) return false;
        if (atEnd()) return true;
        // Files of strings leave the outermost braces out.
        if (!list.as<std::u16string>() || !(isNext(u'=') || isNext(u';'))) return fails("nothing behind the list");
        position_ = 0;
        return readEntries(list, 0) && (atEnd() || fails("a key"));
    }

    bool readValue(PropertyList& value, std::size_t depth) {
        if (depth >= DeepestPropertyList) return fails("fewer values inside of each other");
        if (take(u'{')) return readEntries(value, depth) && (take(u'}') || fails("\"}\" or a key"));
        if (take(u'(')) return readElements(value, depth);
        if (take(u'<')) return readData(value);
        std::u16string text;
        if (!readString(text)) return false;
        value = std::move(text);
        return true;
    }

    bool readEntries(PropertyList& value, std::size_t depth) {
        PropertyList::Dictionary entries;
        while (skipSpace() && !atEnd() && !isNext(u'}')) {
            std::u16string key;
            if (!readString(key) || !skipSpace()) return false;
            PropertyList& entry = entries[toUtf8(key)];
            if (take(u'=')) {
                if (!skipSpace() || !readValue(entry, depth + 1) || !skipSpace()) return false;
            } else {
                entry = std::move(key);  // stands for itself
            }
            if (!take(u';') && !isNext(u'}')) return fails(R"("=" or ";")");
        }
        value = std::move(entries);
        return expected_.empty();
    }

    bool readElements(PropertyList& value, std::size_t depth) {
        PropertyList::Array elements;
        if (!skipSpace()) return false;
        while (!take(u')')) {
            if (!readValue(elements.emplace_back(), depth + 1) || !skipSpace()) return false;
            if (!isNext(u')') && !take(u',')) return fails("\",\" or \")\"");
            if (!skipSpace()) return false;
        }
        value = std::move(elements);
        return true;
    }

    bool readData(PropertyList& value) {
        ArchivedData data;
        std::optional<int> half;
        while (!take(u'>')) {
            if (atEnd()) return fails("\">\"");
            const char16_t unit = text_[position_];
            const int digit = hexValue(unit);
            if (digit < 0 && WhiteSpace.find(unit) == std::u16string_view::npos) return fails("hexadecimal digits");
            ++position_;
            if (digit < 0) continue;
            if (half) data.bytes.push_back(static_cast<char>(*half * 16 + digit));
            half = half ? std::nullopt : std::optional(digit);
        }
        if (half) return fails("an even number of hexadecimal digits before this place");
        value = std::move(data);
        return true;
    }

    bool readString(std::u16string& text) {
        if (isNext(u'"') || isNext(u'\'')) return readQuoted(text);
        const std::size_t start = position_;
        while (!atEnd() && isPlain(text_[position_])) ++position_;
        if (position_ == start) return fails("a value");
        text = text_.substr(start, position_ - start);
        return true;
    }

    bool readQuoted(std::u16string& text) {
        const char16_t quote = text_[position_++];
        while (!take(quote)) {
            if (atEnd()) return fails("the quote at the end of a string");
            const char16_t unit = text_[position_++];
            if (unit != u'\\') {
                text.push_back(unit);
            } else if (!readEscape(text)) {
                return false;
            }
        }
        return true;
    }

    bool readEscape(std::u16string& text) {
        constexpr std::u16string_view Names = u"abfnrtv";
        constexpr std::u16string_view Meanings = u"\a\b\f\n\r\t\v";
        if (atEnd()) return fails("a character behind the backslash");
        const char16_t unit = text_[position_++];
        if (unit == u'U' || unit == u'u') {
            text.push_back(takeNumber(4, 16));
        } else if (unit >= u'0' && unit <= u'7') {
            --position_;
            text.push_back(takeNumber(3, 8));
        } else {
            const std::size_t name = Names.find(unit);
            text.push_back(name == std::u16string_view::npos ? unit : Meanings[name]);
        }
        return true;
    }

    char16_t takeNumber(int mostDigits, int base) {
        int number = 0;
        for (int i = 0; i < mostDigits && !atEnd(); ++i) {
            const int digit = hexValue(text_[position_]);
            if (digit < 0 || digit >= base) break;
            number = number * base + digit;
            ++position_;
        }
        return static_cast<char16_t>(number);
    }

    std::u16string_view text_;
    std::size_t position_ = 0;
    std::string expected_;  // set when something is wrong
};

}  // namespace

Result<PropertyList> readAsciiPropertyList(std::u16string_view text) {
    return AsciiReader(text).read();
}

}  // namespace plume
