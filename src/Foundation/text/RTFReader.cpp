#include "Foundation/text/RTFReader.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::string_view Signature = "{\\rtf";
constexpr std::size_t MaximumDepth = 1000;
constexpr char16_t AttachmentCharacter = u'\uFFFC';

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}
bool isDigit(char c) {
    return c >= '0' && c <= '9';
}
bool isAscii(char c) {
    return static_cast<unsigned char>(c) < 0x80;
}

int hexadecimalValue(char c) {
    if (isDigit(c)) return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

}  // namespace

RTFReader::RTFReader(std::string_view bytes, const RTFFiles& files)
    : bytes_(bytes), groups_(1), attributes_(fonts_, colors_, lists_, files) {}

AttributedString RTFReader::read() {
    while (position_ < bytes_.size() && !ended_) {
        switch (bytes_[position_]) {
            case '{':
                openGroup();
                break;
            case '}':
                closeGroup();
                break;
            case '\\':
                readControl();
                break;
            case '\r':
            case '\n':
                ++position_;
                break;
            default:
                readLiteralText();
        }
    }
    flushBytes();
    endParagraph();
    return std::move(result_);
}

// ---- Groups ----

void RTFReader::openGroup() {
    ++position_;
    flushBytes();
    fallbackRemaining_ = 0;
    isIgnorable_ = false;
    if (groups_.size() > MaximumDepth) {
        ++groupsTooDeep_;
        return;
    }
    groups_.push_back(groups_.back());
    group().isField = false;
}

void RTFReader::closeGroup() {
    ++position_;
    flushBytes();
    fallbackRemaining_ = 0;
    isIgnorable_ = false;
    if (groupsTooDeep_ > 0) {
        --groupsTooDeep_;
    } else if (groups_.size() <= 2) {
        ended_ = true;  // its paragraph format still holds for the last paragraph
    } else {
        const Group closed = std::move(groups_.back());
        groups_.pop_back();
        if (groups_.size() < markerGroup_) markerGroup_ = 0;
        if (closed.destination != group().destination) finishDestination(closed);
    }
}

void RTFReader::finishDestination(const Group& closed) {
    switch (closed.destination) {
        case RTFDestination::FontTable:
            fonts_.finishName();
            break;
        case RTFDestination::ListMarker:
            lists_.setMarker(captured_.substr(0, RTFMaximumMarkerLength));
            break;
        case RTFDestination::AttachmentName:
            addAttachment(trimmed(captured_));
            break;
        case RTFDestination::FieldInstruction:
            if (!group().isField) break;
            if (const int link = attributes_.addLink(captured_)) group().character.link = link;
            break;
        default:
            return;
    }
    captured_.clear();
}

void RTFReader::setDestination(RTFDestination destination) {
    // What is left out stays so, whatever stands in it.
    if (group().destination == RTFDestination::Skip) return;
    group().destination = destination;
    captured_.clear();
}

void RTFReader::setCodePage(int codePage) {
    if (RTFCodePages::isKnown(codePage)) codePage_ = codePage;
}

void RTFReader::setDefaultFont(int font) {
    defaultFont_ = font;
    resetCharacterFormat();
}

void RTFReader::resetCharacterFormat() {
    RTFCharacterFormat format;
    format.hasFont = defaultFont_.has_value();
    format.font = defaultFont_.value_or(-1);
    format.link = group().character.link;
    group().character = format;
}

// ---- Control words ----

void RTFReader::readControl() {
    ++position_;
    if (position_ == bytes_.size()) return;
    const char first = bytes_[position_];
    if (isLetter(first)) {
        readWord();
    } else if (first == '\'') {
        ++position_;
        readHexadecimalByte();
    } else {
        ++position_;
        flushBytes();
        readSymbol(first);
    }
}

void RTFReader::readSymbol(char symbol) {
    if (symbol == '*') {
        isIgnorable_ = true;
        return;
    }
    if (isFallback()) return;
    switch (symbol) {
        case '\r':
        case '\n':
            emit(u"\n");
            break;
        case '\t':
            emit(u"\t");
            break;
        case '~':
            emit(u"\u00A0");
            break;
        case '_':
            emit(u"\u2011");
            break;
        case '-':
            emit(u"\u00AD");
            break;
        case '\\':
            emit(u"\\");
            break;
        case '{':
            emit(u"{");
            break;
        case '}':
            emit(u"}");
            break;
        default:
            break;
    }
}

void RTFReader::readWord() {
    const std::size_t start = position_;
    while (position_ < bytes_.size() && isLetter(bytes_[position_])) ++position_;
    const std::string_view word = bytes_.substr(start, position_ - start);
    const RTFParameter parameter{readNumber()};
    // What the end of the bytes cuts through cannot be told from a shorter word or number.
    if (position_ == bytes_.size()) return;
    if (bytes_[position_] == ' ') ++position_;
    flushBytes();
    performWord(word, parameter);
    isIgnorable_ = false;
}

void RTFReader::performWord(std::string_view word, RTFParameter parameter) {
    if (word == "u") return readCodeUnit(parameter);
    if (word == "bin") return skipBinary(parameter);
    if (const char16_t character = rtfCharacterOfWord(word)) {
        if (!isFallback()) emit({&character, 1});
        return;
    }
    fallbackRemaining_ = 0;
    if (groupsTooDeep_ > 0) return;
    const bool isKnown = performRTFControl(*this, word, parameter);
    if (!isKnown && isIgnorable_) setDestination(RTFDestination::Skip);
}

std::optional<int> RTFReader::readNumber() {
    std::size_t digits = position_;
    const bool negative = digits < bytes_.size() && bytes_[digits] == '-';
    if (negative) ++digits;
    if (digits == bytes_.size() || !isDigit(bytes_[digits])) {
        // A lone minus is text, but at the end of the bytes its number may be missing.
        if (digits == bytes_.size()) position_ = digits;
        return std::nullopt;
    }
    std::int64_t number = 0;
    for (; digits < bytes_.size() && isDigit(bytes_[digits]); ++digits) {
        number = std::min<std::int64_t>(number * 10 + (bytes_[digits] - '0'), std::numeric_limits<int>::max());
    }
    position_ = digits;
    return static_cast<int>(negative ? -number : number);
}

void RTFReader::skipBinary(RTFParameter parameter) {
    const auto length = static_cast<std::size_t>(std::max(parameter.valueOr(0), 0));
    position_ += std::min(length, bytes_.size() - position_);
    static_cast<void>(isFallback());
}

void RTFReader::readCodeUnit(RTFParameter parameter) {
    const int value = parameter.valueOr(0);
    if (value > 0xFFFF && value <= 0x10FFFF) {
        const int beyond = value - 0x10000;
        const std::array pair = {static_cast<char16_t>(0xD800 + (beyond >> 10)),
                                 static_cast<char16_t>(0xDC00 + (beyond & 0x3FF))};
        emit({pair.data(), pair.size()});
    } else if (parameter.number && value >= -0x8000 && value <= 0xFFFF) {
        const auto unit = static_cast<char16_t>(value & 0xFFFF);
        emit({&unit, 1});
    }
    fallbackRemaining_ = group().fallbackCount;
}

// ---- Text ----

bool RTFReader::isFallback() {
    if (fallbackRemaining_ == 0) return false;
    --fallbackRemaining_;
    return true;
}

bool RTFReader::takesText() const {
    return groups_.back().destination != RTFDestination::Skip;
}

void RTFReader::readHexadecimalByte() {
    if (bytes_.size() - position_ < 2) {
        position_ = bytes_.size();
        return;
    }
    const int high = hexadecimalValue(bytes_[position_]);
    const int low = hexadecimalValue(bytes_[position_ + 1]);
    if (high < 0 || low < 0) return;
    position_ += 2;
    if (!isFallback()) addByte(static_cast<char>(high * 16 + low));
}

void RTFReader::addByte(char byte) {
    if (!takesText()) return;
    if (isAscii(byte) && pendingBytes_.empty()) {
        const auto unit = static_cast<char16_t>(byte);
        emit({&unit, 1});
    } else {
        pendingBytes_.push_back(byte);
    }
}

void RTFReader::readLiteralText() {
    while (fallbackRemaining_ > 0) {
        --fallbackRemaining_;
        ++position_;
        if (position_ == bytes_.size() ||
            std::string_view("\\{}\r\n").find(bytes_[position_]) != std::string_view::npos)
            return;
    }
    const std::size_t start = position_;
    bool ascii = true;
    for (; position_ < bytes_.size(); ++position_) {
        const char c = bytes_[position_];
        if (c == '\\' || c == '{' || c == '}' || c == '\r' || c == '\n') break;
        ascii = ascii && isAscii(c);
    }
    const std::string_view literal = bytes_.substr(start, position_ - start);
    if (!takesText()) return;
    if (ascii && pendingBytes_.empty()) {
        units_.assign(literal.begin(), literal.end());
        emit(units_);
    } else {
        pendingBytes_.append(literal);
    }
}

void RTFReader::flushBytes() {
    if (pendingBytes_.empty()) return;
    const RTFFont* font = fonts_.find(group().character.font);
    units_.clear();
    codePages_.appendText(font && font->codePage != 0 ? font->codePage : codePage_, pendingBytes_, units_);
    pendingBytes_.clear();
    emit(units_);
}

void RTFReader::emit(std::u16string_view text) {
    switch (group().destination) {
        case RTFDestination::Body:
            if (!group().character.hidden) addToBody(text);
            break;
        case RTFDestination::FontTable:
            fonts_.addText(text);
            break;
        case RTFDestination::ColorTable:
            colors_.addText(text, false);
            break;
        case RTFDestination::ExpandedColorTable:
            colors_.addText(text, true);
            break;
        case RTFDestination::ListMarker:
        case RTFDestination::FieldInstruction:
        case RTFDestination::AttachmentName:
            captured_.append(text);
            break;
        case RTFDestination::ListTable:
        case RTFDestination::ListOverrideTable:
        case RTFDestination::Skip:
            break;
    }
}

void RTFReader::addToBody(std::u16string_view text) {
    if (markerGroup_ != 0 && !text.empty()) {
        markerGroup_ = 0;
        text.remove_prefix(std::min(text.find_first_not_of(u' '), text.size()));
        if (!text.starts_with(u'\t')) addRun(u"\t", group().character);
    }
    while (!text.empty()) {
        const std::size_t newline = text.find(u'\n');
        const std::size_t length = newline == std::u16string_view::npos ? text.size() : newline + 1;
        addRun(text.substr(0, length), group().character);
        if (newline != std::u16string_view::npos) endParagraph();
        text.remove_prefix(length);
    }
}

void RTFReader::addRun(std::u16string_view text, const RTFCharacterFormat& format) {
    paragraph_.append(text);
    if (!runs_.empty() && runs_.back().format == format) {
        runs_.back().length += text.size();
    } else {
        runs_.push_back({text.size(), format});
    }
}

// A paragraph's style is the one that holds where it ends, so its text waits until then.
void RTFReader::endParagraph() {
    if (runs_.empty()) return;
    attributes_.useParagraphFormat(group().paragraph);
    std::u16string_view text = paragraph_;
    for (const Run& run : runs_) {
        result_.append(text.substr(0, run.length), attributes_.attributesOf(run.format));
        text.remove_prefix(run.length);
    }
    paragraph_.clear();
    runs_.clear();
}

void RTFReader::addAttachment(std::u16string_view name) {
    // One character stands after the group, for readers that do not show files.
    fallbackRemaining_ = 1;
    RTFCharacterFormat format = group().character;
    format.attachment = attributes_.attachmentNumber(name);
    if (format.attachment == 0 || group().destination != RTFDestination::Body || format.hidden) return;
    addRun({&AttachmentCharacter, 1}, format);
}

Result<AttributedString> attributedStringFromRTFDocument(std::string_view rtf, const RTFFiles& files) {
    if (!rtf.starts_with(Signature)) return Error{R"(This is not RTF: expected "{\rtf" at the start.)"};
    return RTFReader(rtf, files).read();
}

}  // namespace plume
