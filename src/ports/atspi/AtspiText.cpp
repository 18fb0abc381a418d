#include "ports/atspi/AtspiText.h"

#include <unicode/ustring.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <limits>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr const char* TextInterface = "org.a11y.atspi.Text";
constexpr std::uint32_t ScreenCoordinates = 0;

constexpr std::int64_t MostOffset = std::numeric_limits<std::int32_t>::max();
constexpr std::int64_t MostUnits = 1'000'000;
constexpr std::int64_t MostCounted = 65'536;
constexpr double LikelyLine = 24;  // pixels that the first line of a text has

std::int64_t sizeOf(const std::u16string& text) {
    return static_cast<std::int64_t>(text.size());
}

// Programs answer with an empty rectangle, or one of negative size, for a place that they do not know.
std::optional<Rectangle> rectangleIn(BusReader reader) {
    std::array<std::int32_t, 4> numbers{};
    for (std::int32_t& number : numbers) {
        const auto read = reader.int32();
        if (!read) return std::nullopt;
        number = *read;
    }
    const auto [x, y, width, height] = numbers;
    if (height <= 0 || width < 0) return std::nullopt;
    return Rectangle{{static_cast<double>(x), static_cast<double>(y)},
                     {static_cast<double>(width), static_cast<double>(height)}};
}

std::optional<bool> isNone(const BusAnswer& count) {
    const auto number = count.values().int32();
    return number ? std::optional(*number == 0) : std::nullopt;
}

std::int64_t charactersIn(std::u16string_view text) {
    return u_countChar32(text.data(), static_cast<std::int32_t>(text.size()));
}

}  // namespace

AtspiTextReader::AtspiTextReader(AtspiBus& bus, AtspiPart part, Anchor anchor)
    : bus_(bus), part_(std::move(part)), anchor_(anchor) {}

bool AtspiTextReader::isPassword() const {
    const auto role = roleNumberOf(bus_, part_);
    return !role || role == AtspiRole::PasswordText;
}

BusAnswer AtspiTextReader::ask(const char* method, std::initializer_list<BusValue> arguments) const {
    return bus_.call(part_, TextInterface, method, arguments);
}

std::optional<std::int64_t> AtspiTextReader::number(const char* property) const {
    return bus_.property(part_, TextInterface, property).values().inside().int32();
}

std::optional<std::u16string> AtspiTextReader::fetch(std::int64_t from, std::int64_t to) const {
    if (from >= to) return std::u16string();
    if (from < 0 || to > MostOffset) return std::nullopt;
    const auto text =
        ask("GetText", {static_cast<std::int32_t>(from), static_cast<std::int32_t>(to)}).values().string();
    return text ? std::optional(fromUtf8(*text)) : std::nullopt;
}

std::optional<bool> AtspiTextReader::selectsNothing() const {
    return isNone(ask("GetNSelections"));
}

AtspiPendingCall AtspiTextReader::askForSelections(AtspiBus& bus, const AtspiPart& part) {
    return bus.callAhead(part, TextInterface, "GetNSelections");
}

std::optional<bool> AtspiTextReader::selectsNothing(const AtspiBus& bus, const AtspiPart& part,
                                                    AtspiPendingCall asked) {
    return isNone(bus.answerTo(part, std::move(asked)));
}

std::optional<TextRange> AtspiTextReader::selectedRange() {
    const auto caret = number("CaretOffset");
    if (!caret || *caret < 0) return std::nullopt;
    std::int64_t start = *caret;
    std::int64_t end = start;
    if (ask("GetNSelections").values().int32().value_or(0) > 0) {
        const BusAnswer answer = ask("GetSelection", {0});
        BusReader bounds = answer.values();
        const auto one = bounds.int32();
        const auto other = bounds.int32();
        // There may be one without anything in it.
        if (one && other && *one >= 0 && *other >= 0 && one != other) {
            start = std::min(*one, *other);
            end = std::max(*one, *other);
        }
    }
    if (isPassword()) return TextRange{start, end - start};
    const std::int64_t counted = std::min(start, MostCounted);
    const auto before = fetch(start - counted, start);
    const auto selected = end - start <= MostCounted ? fetch(start, end) : std::nullopt;
    if (!before) return std::nullopt;
    anchor_ = {start, start - counted + sizeOf(*before)};
    return TextRange{anchor_.units, selected ? sizeOf(*selected) : end - start};
}

std::optional<std::u16string> AtspiTextReader::string(TextRange range) const {
    if (range.location < 0 || range.length < 0 || range.length > MostUnits || isPassword()) return std::nullopt;
    if (range.location > MostUnits * 1'000) return std::nullopt;
    const std::int64_t back = std::max<std::int64_t>(anchor_.units - range.location, 0);
    const std::int64_t ahead = std::max<std::int64_t>(range.location + range.length - anchor_.units, 0);
    if (back + ahead > 2 * MostUnits) return std::nullopt;
    // As many characters as units always reach far enough; one more, so that no pair is taken apart.
    const auto before = back > 0 ? fetch(std::max<std::int64_t>(anchor_.offset - back - 1, 0), anchor_.offset)
                                 : std::optional(std::u16string());
    const auto after = ahead > 0 ? fetch(anchor_.offset, anchor_.offset + ahead) : std::optional(std::u16string());
    if (!before || !after) return std::nullopt;
    const std::u16string text = *before + *after;
    const std::int64_t start = sizeOf(*before) - (anchor_.units - range.location);
    if (start < 0 || start + range.length > sizeOf(text)) return std::nullopt;
    return text.substr(static_cast<std::size_t>(start), static_cast<std::size_t>(range.length));
}

std::optional<std::u16string> AtspiTextReader::wholeText() const {
    if (isPassword()) return std::nullopt;
    const auto characters = number("CharacterCount");
    if (!characters || *characters < 0 || *characters > MostUnits) return std::nullopt;
    return fetch(0, *characters);
}

std::optional<std::int64_t> AtspiTextReader::offsetOf(std::int64_t units) const {
    const std::int64_t distance = units - anchor_.units;
    if (distance == 0) return anchor_.offset;
    if (distance > MostUnits || -distance > MostUnits) return std::nullopt;
    const std::int64_t from = distance > 0 ? anchor_.offset : std::max<std::int64_t>(anchor_.offset + distance, 0);
    const std::int64_t to = distance > 0 ? anchor_.offset + distance : anchor_.offset;
    const auto text = fetch(from, to);
    if (!text || sizeOf(*text) < std::abs(distance)) return std::nullopt;
    if (sizeOf(*text) == to - from) return anchor_.offset + distance;  // counted in units, or no difference
    const std::u16string_view stretch = *text;
    if (distance > 0) return anchor_.offset + charactersIn(stretch.substr(0, static_cast<std::size_t>(distance)));
    return anchor_.offset - charactersIn(stretch.substr(stretch.size() - static_cast<std::size_t>(-distance)));
}

std::optional<Rectangle> AtspiTextReader::bounds(TextRange range) const {
    if (range.location < 0 || range.length < 0) return std::nullopt;
    const auto start = offsetOf(range.location);
    if (!start) return std::nullopt;
    if (range.length == 0) return caretAt(*start);
    const auto end = offsetOf(range.location + range.length);
    if (!end || *start < 0 || *end > MostOffset) return std::nullopt;
    return rectangleIn(
        ask("GetRangeExtents", {static_cast<std::int32_t>(*start), static_cast<std::int32_t>(*end), ScreenCoordinates})
            .values());
}

std::optional<Rectangle> AtspiTextReader::characterAt(std::int64_t offset) const {
    if (offset < 0 || offset > MostOffset) return std::nullopt;
    return rectangleIn(ask("GetCharacterExtents", {static_cast<std::int32_t>(offset), ScreenCoordinates}).values());
}

std::optional<Rectangle> AtspiTextReader::caretAt(std::int64_t offset) const {
    const std::int64_t characters = number("CharacterCount").value_or(0);
    // Of an empty text some programs tell where its first character would be.
    if (offset < characters || characters == 0) {
        if (const auto next = characterAt(offset)) return Rectangle{next->origin, {0, next->size.height}};
    }
    auto field = screenBounds(bus_, part_);
    const auto last = characterAt(offset - 1);
    if (field && !last) field->size.height = std::min(field->size.height, LikelyLine);
    if (!last) return field;  // an empty text
    const bool startsLine = !isPassword() && fetch(offset - 1, offset) == u"\n";
    if (startsLine && field) {
        const double top = last->origin.y + last->size.height;
        return Rectangle{{field->origin.x, top}, {0, last->size.height}};
    }
    return Rectangle{{last->origin.x + last->size.width, last->origin.y}, {0, last->size.height}};
}

std::optional<Rectangle> screenBounds(AtspiBus& bus, const AtspiPart& part) {
    const BusAnswer answer = bus.call(part, "org.a11y.atspi.Component", "GetExtents", {ScreenCoordinates});
    return rectangleIn(answer.values().inside());
}

}  // namespace plume
