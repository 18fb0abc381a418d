#include "platform/desktop/AtspiText.h"

#include <unicode/ustring.h>

#include <algorithm>
#include <cstdlib>
#include <string_view>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::int64_t MostUnits = 1'000'000;
constexpr std::int64_t MostCounted = 65'536;

std::int64_t sizeOf(const std::u16string& text) {
    return static_cast<std::int64_t>(text.size());
}

// Programs answer with an empty rectangle, or one of negative size, for a place that they do not know.
std::optional<Rectangle> rectangleFrom(GlibOwned<AtspiRect> rect) {
    if (!rect || rect->height <= 0 || rect->width < 0) return std::nullopt;
    return Rectangle{{static_cast<double>(rect->x), static_cast<double>(rect->y)},
                     {static_cast<double>(rect->width), static_cast<double>(rect->height)}};
}

std::int64_t charactersIn(std::u16string_view text) {
    return u_countChar32(text.data(), static_cast<std::int32_t>(text.size()));
}

}  // namespace

AtspiTextReader::AtspiTextReader(AtspiAccessible* part, Anchor anchor)
    : part_(part), text_(atspi_accessible_get_text_iface(part)), anchor_(anchor) {}

bool AtspiTextReader::isPassword() const {
    return atspi_accessible_get_role(part_, nullptr) == ATSPI_ROLE_PASSWORD_TEXT;
}

std::optional<std::u16string> AtspiTextReader::fetch(std::int64_t from, std::int64_t to) const {
    if (from >= to) return std::u16string();
    if (!text_ || to > G_MAXINT) return std::nullopt;
    AtspiError error;
    const GlibOwned<char> bytes(
        atspi_text_get_text(text_.get(), static_cast<int>(from), static_cast<int>(to), error.out()));
    if (!bytes || error.isSet()) return std::nullopt;
    return fromUtf8(bytes.get());
}

std::optional<TextRange> AtspiTextReader::selectedRange() {
    if (!text_) return std::nullopt;
    AtspiError error;
    std::int64_t start = atspi_text_get_caret_offset(text_.get(), error.out());
    std::int64_t end = start;
    if (start < 0 || error.isSet()) return std::nullopt;
    if (atspi_text_get_n_selections(text_.get(), nullptr) > 0) {
        // There may be one without anything in it.
        const GlibOwned<AtspiRange> selected(atspi_text_get_selection(text_.get(), 0, nullptr));
        if (selected && selected->start_offset >= 0 && selected->start_offset != selected->end_offset) {
            start = std::min(selected->start_offset, selected->end_offset);
            end = std::max(selected->start_offset, selected->end_offset);
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
    if (!text_ || isPassword()) return std::nullopt;
    AtspiError error;
    const int characters = atspi_text_get_character_count(text_.get(), error.out());
    if (error.isSet() || characters < 0 || characters > MostUnits) return std::nullopt;
    return fetch(0, characters);
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
    if (!text_ || range.location < 0 || range.length < 0) return std::nullopt;
    const auto start = offsetOf(range.location);
    if (!start) return std::nullopt;
    if (range.length == 0) return caretAt(*start);
    const auto end = offsetOf(range.location + range.length);
    if (!end || *end > G_MAXINT) return std::nullopt;
    return rectangleFrom(GlibOwned<AtspiRect>(atspi_text_get_range_extents(
        text_.get(), static_cast<int>(*start), static_cast<int>(*end), ATSPI_COORD_TYPE_SCREEN, nullptr)));
}

std::optional<Rectangle> AtspiTextReader::characterAt(std::int64_t offset) const {
    if (offset < 0 || offset > G_MAXINT) return std::nullopt;
    return rectangleFrom(GlibOwned<AtspiRect>(
        atspi_text_get_character_extents(text_.get(), static_cast<int>(offset), ATSPI_COORD_TYPE_SCREEN, nullptr)));
}

std::optional<Rectangle> AtspiTextReader::caretAt(std::int64_t offset) const {
    const int characters = atspi_text_get_character_count(text_.get(), nullptr);
    if (offset < characters) {
        if (const auto next = characterAt(offset)) return Rectangle{next->origin, {0, next->size.height}};
    }
    const auto field = screenBounds(part_);
    const auto last = characterAt(offset - 1);
    if (!last) return field;  // an empty text
    const bool startsLine = !isPassword() && fetch(offset - 1, offset) == u"\n";
    if (startsLine && field) {
        const double top = last->origin.y + last->size.height;
        return Rectangle{{field->origin.x, top}, {0, last->size.height}};
    }
    return Rectangle{{last->origin.x + last->size.width, last->origin.y}, {0, last->size.height}};
}

std::optional<Rectangle> screenBounds(AtspiAccessible* part) {
    const GObjectOwned<AtspiComponent> component(atspi_accessible_get_component_iface(part));
    if (!component) return std::nullopt;
    return rectangleFrom(
        GlibOwned<AtspiRect>(atspi_component_get_extents(component.get(), ATSPI_COORD_TYPE_SCREEN, nullptr)));
}

}  // namespace plume
