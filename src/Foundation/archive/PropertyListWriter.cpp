#include "Foundation/archive/PropertyListWriter.h"

#include <array>
#include <charconv>
#include <string_view>
#include <type_traits>
#include <variant>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/archive/BinaryObjectWriter.h"
#include "Foundation/archive/ReferenceDate.h"

namespace plume {

namespace {

// ---- Binary ----

class BinaryValues {
  public:
    using Number = BinaryObjectWriter::Number;

    std::string finish(const PropertyList& list) { return writer_.finish(add(list)); }

  private:
    Number add(const PropertyList& list) {
        return std::visit([this](const auto& value) { return addValue(value); }, list.value);
    }
    Number addValue(bool value) { return writer_.boolean(value); }
    Number addValue(std::int64_t value) { return writer_.integer(value); }
    Number addValue(double value) { return writer_.real(value); }
    Number addValue(const std::u16string& text) { return writer_.string(text); }
    Number addValue(Date date) { return writer_.date(referenceSeconds(date)); }
    Number addValue(const ArchivedData& data) { return writer_.data(data.bytes); }
    Number addValue(PropertyList::Uid uid) { return writer_.uid(uid.number); }
    Number addValue(const PropertyList::Array& array) {
        std::vector<Number> elements;
        elements.reserve(array.size());
        for (const PropertyList& element : array) elements.push_back(add(element));
        return writer_.array(elements);
    }
    Number addValue(const PropertyList::Dictionary& dictionary) {
        std::vector<BinaryObjectWriter::Entry> entries;
        for (const auto& [key, value] : dictionary) entries.emplace_back(writer_.string(fromUtf8(key)), add(value));
        return writer_.dictionary(entries.data(), entries.size());
    }

    BinaryObjectWriter writer_;
};

// ---- XML ----

bool isCharacterOfXml(char16_t unit) {
    if (unit < u' ') return unit == u'\t' || unit == u'\n' || unit == u'\r';
    return unit != u'\uFFFE' && unit != u'\uFFFF';
}

std::string escaped(std::u16string text) {
    for (char16_t& unit : text) {
        if (!isCharacterOfXml(unit)) unit = u'\uFFFD';
    }
    std::string result;
    for (const char c : toUtf8(text)) {
        switch (c) {
            case '&':
                result += "&amp;";
                break;
            case '<':
                result += "&lt;";
                break;
            case '>':
                result += "&gt;";
                break;
            case '\r':
                result += "&#13;";
                break;  // a bare one is read as a line feed
            default:
                result += c;
        }
    }
    return result;
}

std::string base64(std::string_view bytes) {
    constexpr std::string_view Digits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    for (std::size_t i = 0; i < bytes.size(); i += 3) {
        const std::string_view group = bytes.substr(i, 3);
        unsigned bits = 0;
        for (std::size_t j = 0; j < 3; ++j)
            bits = bits << 8 | (j < group.size() ? static_cast<unsigned char>(group[j]) : 0U);
        for (std::size_t j = 0; j < 4; ++j) text += j <= group.size() ? Digits[bits >> (18 - 6 * j) & 0x3F] : '=';
    }
    return text;
}

class XmlValues {
  public:
    std::string finish(const PropertyList& list) {
        bytes_ =
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" "
            "\"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">\n"
            "<plist version=\"1.0\">\n";
        add(list);
        bytes_ += "</plist>\n";
        return std::move(bytes_);
    }

  private:
    void add(const PropertyList& list) {
        std::visit([this](const auto& value) { addValue(value); }, list.value);
    }
    void addLine(std::string_view line) { bytes_.append(depth_, '\t').append(line) += '\n'; }
    void addElement(const std::string& name, const std::string& content) {
        addLine("<" + name + ">" + content + "</" + name + ">");
    }

    void addValue(bool value) { addLine(value ? "<true/>" : "<false/>"); }
    void addValue(std::int64_t value) { addElement("integer", std::to_string(value)); }
    void addValue(double value) {
        std::array<char, 32> text{};
        const auto end = std::to_chars(text.data(), text.data() + text.size(), value).ptr;
        addElement("real", std::string(text.data(), end));
    }
    void addValue(const std::u16string& text) { addElement("string", escaped(text)); }
    void addValue(Date date) { addElement("date", isoDate(date)); }
    void addValue(const ArchivedData& data) { addElement("data", base64(data.bytes)); }
    void addValue(PropertyList::Uid uid) {
        addValue(PropertyList::Dictionary{{"CF$UID", static_cast<std::int64_t>(uid.number)}});
    }
    void addValue(const PropertyList::Array& array) {
        addLine("<array>");
        ++depth_;
        for (const PropertyList& element : array) add(element);
        --depth_;
        addLine("</array>");
    }
    void addValue(const PropertyList::Dictionary& dictionary) {
        addLine("<dict>");
        ++depth_;
        for (const auto& [key, value] : dictionary) {
            addElement("key", escaped(fromUtf8(key)));
            add(value);
        }
        --depth_;
        addLine("</dict>");
    }

    std::string bytes_;
    std::size_t depth_ = 0;
};

}  // namespace

std::string binaryPropertyList(const PropertyList& list) {
    return BinaryValues().finish(list);
}

std::string xmlPropertyList(const PropertyList& list) {
    return XmlValues().finish(list);
}

}  // namespace plume
