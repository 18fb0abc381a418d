#include "Foundation/archive/TypedStream.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListLimits.h"
#include "Foundation/archive/TypedStreamObjects.h"
#include "Foundation/text/FontNames.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

constexpr std::size_t LargestFontNameHeader = 16;
// Within as many of an object's values is what is looked for.
constexpr std::size_t MostValues = 16;
constexpr std::size_t CostOfObject = 64;

// A font's name stands in UTF-16 behind its mark, or in ASCII; what follows the name is no letter.
std::u16string fontNameIn(std::string_view blob) {
    const std::size_t mark = blob.substr(0, LargestFontNameHeader).find("\xFF\xFE");
    std::u16string name;
    if (mark == std::string_view::npos) {
        for (const char c : blob.substr(0, blob.find('\0'))) name.push_back(static_cast<unsigned char>(c));
        return name;
    }
    for (std::size_t i = mark + 2; i + 1 < blob.size(); i += 2) {
        const auto unit =
            static_cast<char16_t>(static_cast<unsigned char>(blob[i]) | static_cast<unsigned char>(blob[i + 1]) << 8);
        if (unit < u' ') break;
        name.push_back(unit);
    }
    return name;
}

class TextReader {
  public:
    TextReader(const TypedStreamObjects& stream, std::size_t size) : stream_(stream), left_(mostBytesMadeOf(size)) {}

    // Nothing when the object is no text, or its text is not there.
    std::optional<AttributedString> read(std::size_t object) {
        if (auto plain = string(object)) return AttributedString(*std::move(plain));
        if (!stream_.isA(object, "NSAttributedString")) return std::nullopt;
        const Values& values = valuesOf(object);
        const auto content = values.empty() ? std::nullopt : objectIn(values[0]);
        const auto all = content ? string(*content) : std::nullopt;
        if (!all) return std::nullopt;
        AttributedString text;
        std::size_t next = 1;
        while (text.length() < all->size() && next < values.size()) {
            const auto run = takeRun(values, next);
            if (!run) break;
            text.append(std::u16string_view(*all).substr(text.length(), run->first), run->second);
        }
        text.append(std::u16string_view(*all).substr(text.length()));
        return text;
    }

  private:
    using Values = std::vector<TypedStreamValue>;

    const Values& valuesOf(std::size_t object) const { return stream_.objects[object].values; }
    static std::optional<std::size_t> objectIn(const TypedStreamValue& value) {
        const auto* reference = std::get_if<TypedStreamReference>(&value);
        return reference ? reference->object : std::nullopt;
    }
    static std::optional<double> numberIn(const TypedStreamValue& value) {
        if (const auto* integer = std::get_if<std::int64_t>(&value)) return static_cast<double>(*integer);
        const auto* real = std::get_if<double>(&value);
        return real && std::isfinite(*real) ? std::optional(*real) : std::nullopt;
    }
    // What was read too often reads as nothing.
    bool spend(std::size_t cost) {
        if (cost > left_) return false;
        left_ -= cost;
        return true;
    }

    // Length and attributes; a dictionary follows where its number is new.
    std::optional<std::pair<std::size_t, SharedAttributes>> takeRun(const Values& values, std::size_t& next) {
        if (values.size() - next < 2) return std::nullopt;
        const auto* number = std::get_if<std::int64_t>(&values[next]);
        const auto* length = std::get_if<std::int64_t>(&values[next + 1]);
        if (!number || !length || *number < 1 || *length < 0) return std::nullopt;
        next += 2;
        const auto index = static_cast<std::size_t>(*number);
        if (index > attributes_.size() + 1) return std::nullopt;
        if (index == attributes_.size() + 1) {
            const auto dictionary = next < values.size() ? objectIn(values[next]) : std::nullopt;
            if (!dictionary) return std::nullopt;
            ++next;
            attributes_.push_back(attributesIn(*dictionary));
        }
        return std::pair(static_cast<std::size_t>(*length), attributes_[index - 1]);
    }

    std::optional<std::u16string> string(std::size_t object) {
        if (!stream_.isA(object, "NSString") || valuesOf(object).empty()) return std::nullopt;
        const auto* bytes = std::get_if<std::string_view>(&valuesOf(object).front());
        if (!bytes || !spend(2 * bytes->size())) return std::nullopt;
        return fromUtf8(*bytes);
    }

    SharedAttributes attributesIn(std::size_t dictionary) {
        if (!stream_.isA(dictionary, "NSDictionary") || !spend(sizeof(TextAttributes))) return nullptr;
        auto attributes = std::make_shared<TextAttributes>();
        const Values& values = valuesOf(dictionary);
        for (std::size_t i = 1; i + 1 < values.size(); i += 2) {
            const auto key = objectIn(values[i]);
            const auto value = objectIn(values[i + 1]);
            const auto name = key && value ? string(*key) : std::nullopt;
            if (name) readAttribute(*name, *value, *attributes);
        }
        return attributes;
    }

    void readAttribute(std::u16string_view name, std::size_t value, TextAttributes& attributes) {
        if (name == u"NSFont") {
            attributes.font = font(value);
        } else if (name == u"NSColor") {
            attributes.foregroundColor = color(value);
        } else if (name == u"NSBackgroundColor") {
            attributes.backgroundColor = color(value);
        } else if (name == u"NSUnderline") {
            attributes.underlineStyle = integer(value);
        } else if (name == u"NSStrikethrough") {
            attributes.strikethroughStyle = integer(value);
        } else if (name == u"NSSuperScript") {
            attributes.superscript = integer(value);
        } else if (name == u"NSBaselineOffset") {
            attributes.baselineOffset = number(value);
        } else if (name == u"NSLink") {
            attributes.link = address(value);
        } else if (name == u"NSToolTip") {
            attributes.toolTip = string(value);
        } else if (name == u"NSParagraphStyle") {
            attributes.paragraphStyle = paragraphStyle(value);
        } else if (name == u"NSAttachment") {
            attributes.attachment = attachment(value);
        }
    }

    std::optional<FontAttribute> font(std::size_t object) {
        std::optional<FontAttribute> font;
        const Values& values = valuesOf(object);
        for (std::size_t i = 0; i < std::min(values.size(), MostValues); ++i) {
            const auto* blob = std::get_if<std::string_view>(&values[i]);
            if (!font && blob && spend(2 * blob->size())) {
                font = fontFromFaceName(fontNameIn(*blob));
            } else if (const auto size = numberIn(values[i]); font && size) {
                font->size = *size;
                return font;
            }
        }
        return font && font->family.empty() ? std::nullopt : font;
    }

    std::optional<ColorAttribute> color(std::size_t object) {
        const Values& values = valuesOf(object);
        const auto* kind = values.empty() ? nullptr : std::get_if<std::int64_t>(&values.front());
        std::vector<double> parts;
        for (std::size_t i = 1; i < std::min<std::size_t>(values.size(), 5); ++i) {
            parts.push_back(std::clamp(numberIn(values[i]).value_or(0), 0.0, 1.0));
        }
        const bool isRgb = kind && (*kind == 1 || *kind == 2) && parts.size() >= 3;
        const bool isGray = kind && (*kind == 3 || *kind == 4) && !parts.empty();
        if (isRgb) return ColorAttribute{parts[0], parts[1], parts[2], parts.size() > 3 ? parts[3] : 1};
        if (isGray) return ColorAttribute{parts[0], parts[0], parts[0], parts.size() > 1 ? parts[1] : 1};
        return std::nullopt;
    }

    // Numbers are boxed behind the name of their type.
    std::optional<double> number(std::size_t object) {
        const Values& values = valuesOf(object);
        return values.empty() ? std::nullopt : numberIn(values.back());
    }
    std::int64_t integer(std::size_t object) {
        const Values& values = valuesOf(object);
        const auto* value = values.empty() ? nullptr : std::get_if<std::int64_t>(&values.back());
        return value ? *value : 0;
    }

    std::optional<std::u16string> address(std::size_t object) {
        if (auto text = string(object)) return text;
        const Values& values = valuesOf(object);
        for (std::size_t i = 0; i < std::min(values.size(), MostValues); ++i) {
            const auto inside = objectIn(values[i]);
            auto text = inside ? string(*inside) : std::nullopt;
            if (text) return text;
        }
        return std::nullopt;
    }

    // Of a paragraph's style the alignment is known.
    std::optional<ParagraphStyle> paragraphStyle(std::size_t object) {
        const Values& values = valuesOf(object);
        const auto* alignment = values.empty() ? nullptr : std::get_if<std::int64_t>(&values.front());
        if (!alignment || *alignment < 0 || *alignment >= static_cast<std::int64_t>(TextAlignment::Natural)) {
            return std::nullopt;
        }
        ParagraphStyle style;
        style.alignment = static_cast<TextAlignment>(*alignment);
        return style;
    }

    // The file stands in data, in a wrapper, in the attachment.
    std::shared_ptr<const TextAttachment> attachment(std::size_t object) {
        const auto known = attachments_.find(object);
        if (known != attachments_.end()) return known->second;
        auto& found = attachments_[object];
        const auto container = dataIn(object, 0);
        if (!container || !spend(container->size())) return found;
        auto read = attachmentFromFlatContainer(*container);
        if (read) found = std::make_shared<const TextAttachment>(std::move(read).value());
        return found;
    }

    std::optional<std::string_view> dataIn(std::size_t object, int depth) {
        constexpr int DeepestData = 3;
        const Values& values = valuesOf(object);
        for (std::size_t i = 0; i < std::min(values.size(), MostValues) && spend(CostOfObject); ++i) {
            const auto* bytes = std::get_if<std::string_view>(&values[i]);
            if (bytes && stream_.isA(object, "NSData")) return *bytes;
            const auto inside = depth < DeepestData ? objectIn(values[i]) : std::nullopt;
            const auto found = inside ? dataIn(*inside, depth + 1) : std::nullopt;
            if (found) return found;
        }
        return std::nullopt;
    }

    const TypedStreamObjects& stream_;
    std::size_t left_;                          // how many bytes may yet be made
    std::vector<SharedAttributes> attributes_;  // by the numbers of dictionaries, from 1
    std::map<std::size_t, std::shared_ptr<const TextAttachment>> attachments_;
};

}  // namespace

Result<AttributedString> attributedStringFromTypedStream(std::string_view bytes) {
    const TypedStreamObjects stream = readTypedStream(bytes);
    std::optional<AttributedString> text;
    if (stream.root) text = TextReader(stream, bytes.size()).read(*stream.root);
    if (text) return *std::move(text);
    return stream.damage.value_or(Error{"The typed stream holds no text: expected an NSAttributedString or NSString."});
}

}  // namespace plume
