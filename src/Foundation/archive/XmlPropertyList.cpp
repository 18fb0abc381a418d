#include "Foundation/archive/XmlPropertyList.h"

#include <expat.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "Foundation/Base64.h"
#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListLimits.h"
#include "Foundation/archive/ReferenceDate.h"

namespace plume {

namespace {

using Parser = std::unique_ptr<std::remove_pointer_t<XML_Parser>, decltype(&XML_ParserFree)>;

constexpr std::string_view WhiteSpace = " \t\r\n";

std::string_view withoutSpace(std::string_view text) {
    const std::size_t first = text.find_first_not_of(WhiteSpace);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(WhiteSpace) - first + 1);
}

// ---- Scalars ----

// Decimal, or hexadecimal after "0x". Numbers beyond 64 bits with a sign come as reals.
std::optional<PropertyList> integerFrom(std::string_view text) {
    if (text.starts_with('+')) text.remove_prefix(1);
    const bool negative = text.starts_with('-');
    if (negative) text.remove_prefix(1);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    if (hexadecimal) text.remove_prefix(2);
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, hexadecimal ? 16 : 10);
    if (error != std::errc() || end != text.data() + text.size()) return std::nullopt;
    constexpr std::uint64_t SignBit = std::uint64_t{1} << 63;
    if (number < SignBit || (negative && number == SignBit)) {
        return PropertyList(static_cast<std::int64_t>(negative ? 0 - number : number));
    }
    return PropertyList(negative ? -static_cast<double>(number) : static_cast<double>(number));
}

std::optional<PropertyList> realFrom(std::string_view text) {
    if (text.starts_with('+')) text.remove_prefix(1);
    double number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return PropertyList(number);
}

std::optional<PropertyList> scalarFrom(std::string_view element, std::string_view text) {
    if (element == "string") return PropertyList(fromUtf8(text));
    if (element == "true") return PropertyList(true);
    if (element == "false") return PropertyList(false);
    if (element == "data") {
        auto bytes = bytesFromBase64(text);
        return bytes ? std::optional(PropertyList(ArchivedData{std::move(*bytes)})) : std::nullopt;
    }
    text = withoutSpace(text);
    if (element == "integer") return integerFrom(text);
    if (element == "real") return realFrom(text);
    if (const auto date = dateFromIsoDate(text)) return PropertyList(*date);
    return std::nullopt;
}

constexpr std::array<std::string_view, 7> Scalars = {"string", "integer", "real", "true", "false", "date", "data"};

bool isScalar(std::string_view element) {
    return std::find(Scalars.begin(), Scalars.end(), element) != Scalars.end();
}

// ---- Structure ----

// A dictionary of this single key stands for a reference.
constexpr std::string_view UidKey = "CF$UID";

class XmlReader {
  public:
    explicit XmlReader(XML_Parser parser) : parser_(parser) {
        XML_SetUserData(parser, this);
        XML_SetElementHandler(parser, start, end);
        XML_SetCharacterDataHandler(parser, characters);
        // Property lists have no use of entities of their own; declared, they can blow a text up without bound.
        XML_SetEntityDeclHandler(parser, entityDeclaration);
        XML_SetSkippedEntityHandler(parser, skippedEntity);
    }

    Result<PropertyList> read(std::string_view bytes) {
        if (bytes.size() > MostBytes) return Error{"The XML property list is too long: expected at most 1 GiB."};
        const auto status = XML_Parse(parser_, bytes.data(), static_cast<int>(bytes.size()), XML_TRUE);
        if (!expected_.empty()) return error("expected " + expected_ + ".");
        if (status != XML_STATUS_OK) {
            return error("expected well-formed XML (" + std::string(XML_ErrorString(XML_GetErrorCode(parser_))) + ").");
        }
        if (!root_) return error("expected a value inside of \"plist\".");
        return *std::move(root_);
    }

  private:
    static constexpr std::size_t MostBytes = std::size_t{1} << 30;

    // An array, a dictionary, or (at the bottom) the document itself.
    struct Container {
        bool isDictionary = false;
        PropertyList::Array elements;
        PropertyList::Dictionary entries;
        std::optional<std::string> key;
    };

    static XmlReader& of(void* self) { return *static_cast<XmlReader*>(self); }
    static void start(void* self, const XML_Char* name, const XML_Char**) { of(self).startElement(name); }
    static void end(void* self, const XML_Char* name) { of(self).endElement(name); }
    static void characters(void* self, const XML_Char* text, int length) {
        of(self).addText({text, static_cast<std::size_t>(length)});
    }
    static void entityDeclaration(void* self, const XML_Char*, int, const XML_Char*, int, const XML_Char*,
                                  const XML_Char*, const XML_Char*, const XML_Char*) {
        of(self).fail("no declarations of entities");
    }
    static void skippedEntity(void* self, const XML_Char*, int) { of(self).fail("no entities but XML's own"); }

    Error error(const std::string& what) const {
        return Error{"The XML property list is wrong at line " + std::to_string(XML_GetCurrentLineNumber(parser_)) +
                     ": " + what};
    }

    void fail(std::string expected) {
        if (!expected_.empty()) return;
        expected_ = std::move(expected);
        XML_StopParser(parser_, XML_FALSE);
    }

    void startElement(std::string_view name) {
        if (!expected_.empty()) return;
        if (!leaf_.empty()) return fail("no element inside of \"" + leaf_ + "\"");
        if (name == "plist") {
            if (inDocument_ || root_) return fail("\"plist\" only around the whole list");
            inDocument_ = true;
            return;
        }
        const bool isContainer = name == "dict" || name == "array";
        if (name != "key" && !isContainer && !isScalar(name)) return fail("an element of a property list");
        if (!mayFollow(name == "key")) return;
        if (isContainer) {
            if (open_.size() >= DeepestPropertyList) return fail("fewer values inside of each other");
            open_.emplace_back().isDictionary = name == "dict";
        } else {
            leaf_ = name;
            text_.clear();
        }
    }

    bool mayFollow(bool isKey) {
        if (open_.empty()) {
            if (isKey) fail("a value instead of a key");
            if (root_) fail("a single value");
        } else if (!open_.back().isDictionary) {
            if (isKey) fail("no key outside of \"dict\"");
        } else if (open_.back().key.has_value() == isKey) {
            fail(isKey ? "a value behind the key" : "a key before the value");
        }
        return expected_.empty();
    }

    void addText(std::string_view text) {
        if (!expected_.empty()) return;
        if (!leaf_.empty()) {
            text_.append(text);
        } else if (text.find_first_not_of(WhiteSpace) != std::string_view::npos) {
            fail("no text outside of values");
        }
    }

    void endElement(std::string_view name) {
        if (!expected_.empty() || name == "plist") return;
        if (name == "key") {
            open_.back().key = std::exchange(text_, {});
        } else if (!leaf_.empty()) {
            auto value = scalarFrom(leaf_, text_);
            if (!value) return fail("a value that \"" + leaf_ + "\" can hold");
            addValue(*std::move(value));
        } else {
            Container container = std::move(open_.back());
            open_.pop_back();
            if (container.key) return fail("a value behind the last key");
            addValue(valueOf(std::move(container)));
        }
        leaf_.clear();
    }

    static PropertyList valueOf(Container container) {
        if (!container.isDictionary) return std::move(container.elements);
        const auto uid = container.entries.find(UidKey);
        if (uid != container.entries.end() && container.entries.size() == 1) {
            const auto* number = uid->second.as<std::int64_t>();
            if (number && *number >= 0) return PropertyList::Uid{static_cast<std::uint64_t>(*number)};
        }
        return std::move(container.entries);
    }

    void addValue(PropertyList value) {
        if (open_.empty()) {
            root_ = std::move(value);
        } else if (open_.back().isDictionary) {
            open_.back().entries.insert_or_assign(*std::exchange(open_.back().key, std::nullopt), std::move(value));
        } else {
            open_.back().elements.push_back(std::move(value));
        }
    }

    XML_Parser parser_;
    bool inDocument_ = false;
    std::vector<Container> open_;
    std::string leaf_;  // the scalar or key that is being read; empty when there is none
    std::string text_;
    std::optional<PropertyList> root_;
    std::string expected_;  // set when something is wrong
};

}  // namespace

Result<PropertyList> readXmlPropertyList(std::string_view bytes, XmlEncoding encoding) {
    bytes.remove_prefix(std::min(bytes.find_first_not_of(WhiteSpace), bytes.size()));
    const Parser parser(XML_ParserCreate(encoding == XmlEncoding::Utf8 ? "UTF-8" : nullptr), XML_ParserFree);
    if (!parser) return Error{"The XML property list could not be read: expected more memory."};
    return XmlReader(parser.get()).read(bytes);
}

}  // namespace plume
