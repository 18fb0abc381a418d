#include "content/SnippetVariable.h"

#include <algorithm>

#include "Foundation/Strings.h"
#include "content/DelayText.h"
#include "content/VariableBody.h"

namespace plume {
namespace {

constexpr std::int64_t DefaultWidth = 30;
constexpr std::int64_t DefaultHeight = 5;

// A code that no keyboard has must not press some other key: it counts as no key.
KeyCode keyCodeParam(const VariableParams& params) {
    if (!params.contains(u"code")) return KeyCode::None;
    const std::int64_t code = integerParam(params, u"code");
    return code < 0 || code > numberOf(KeyCode::None) ? KeyCode::None : KeyCode{static_cast<std::uint16_t>(code)};
}

EventFlags modifiersParam(const VariableParams& params) {
    return EventFlags::fromBits(
        static_cast<std::uint64_t>(std::max<std::int64_t>(integerParam(params, u"modifiers"), 0)));
}

std::uint64_t countParam(const VariableParams& params) {
    const std::int64_t count = integerParam(params, u"count");
    return count < 1 ? 1 : std::min(static_cast<std::uint64_t>(count), SnippetKeyVariable::MaximumCount);
}

double delayParam(const VariableParams& params) {
    const auto found = params.find(u"delay");
    return found == params.end() ? 0 : std::clamp(delayFromText(found->second), 0.0, SnippetKeyVariable::MaximumDelay);
}

}  // namespace

SnippetVariable::SnippetVariable(const VariableParams& params)
    : isOptional(params.contains(u"optional")),
      isSelected((integerParam(params, u"optional") & 1) != 0),
      isReadonly(params.contains(u"readonly")) {}

std::u16string SnippetVariable::toString() const {
    BodyWriter writer;
    if (isOptional) writer.param(u"optional", isSelected ? 1 : 0);
    if (isReadonly && canSetReadonly()) writer.part(u"readonly");
    return writer.take();
}

std::u16string SnippetContentCaret::toString() const {
    return u"|";
}

SnippetFieldVariable::SnippetFieldVariable(const VariableParams& params)
    : SnippetVariable(params),
      name(textParam(params, u"field")),
      type(static_cast<FieldType>(shortIntegerParam(params, u"type"))),
      value(textParam(params, u"value")),
      defaultIndex(integerParam(params, u"defaultIndex")) {
    setWidth(integerParam(params, u"width"));
    setHeight(integerParam(params, u"height"));
}

void SnippetFieldVariable::setWidth(std::int64_t width) {
    hasWidth_ = width > 0;
    width_ = hasWidth_ ? width : DefaultWidth;
}

void SnippetFieldVariable::setHeight(std::int64_t height) {
    hasHeight_ = height > 0;
    height_ = hasHeight_ ? height : DefaultHeight;
}

std::u16string SnippetFieldVariable::toString() const {
    BodyWriter writer;
    if (name && !name->empty()) {
        writer.param(u"field", *name);
    } else {
        writer.part(u"field");
    }
    writer.paramUnlessZero(u"type", static_cast<std::int64_t>(type));
    // Libraries in use have a menu's default index under this name, so it is written there although it is read from
    // "defaultIndex".
    if (isPopupMenu()) writer.param(u"width", defaultIndex);
    if (value && !value->empty()) writer.param(u"value", *value);
    writer.part(SnippetVariable::toString());
    if (canSetWidth() && hasWidth()) writer.param(u"width", width());
    if (canSetHeight() && hasHeight()) writer.param(u"height", height());
    return writer.take();
}

SnippetKeyVariable::SnippetKeyVariable(const VariableParams& params)
    : SnippetVariable(params),
      key(textParam(params, u"key")),
      keyCode(keyCodeParam(params)),
      count(countParam(params)),
      delay(delayParam(params)),
      modifiers(modifiersParam(params)) {}

SnippetKeyVariable::SnippetKeyVariable(std::u16string label, KeyCode code) : key(std::move(label)), keyCode(code) {}

bool SnippetKeyVariable::shift() const {
    return modifiers.contains(EventFlag::Shift);
}
bool SnippetKeyVariable::control() const {
    return modifiers.contains(EventFlag::Control);
}
bool SnippetKeyVariable::option() const {
    return modifiers.contains(EventFlag::Option);
}
bool SnippetKeyVariable::command() const {
    return modifiers.contains(EventFlag::Command);
}

std::u16string SnippetKeyVariable::toString() const {
    BodyWriter writer;
    writer.param(u"key", key.value_or(std::u16string()));
    writer.param(u"code", numberOf(keyCode));
    if (!modifiers.isEmpty()) writer.unsignedParam(u"modifiers", modifiers.bits());
    if (count >= 2) writer.unsignedParam(u"count", count);
    if (delay > 0) writer.param(u"delay", textFromDelay(delay));
    return writer.take();
}

SnippetClipboardVariable::SnippetClipboardVariable(const VariableParams& params)
    : SnippetVariable(params), find(textParam(params, u"find")), replacement(textParam(params, u"replacement")) {
    const std::int64_t flags = integerParam(params, u"flags");
    regularExpressions = (flags & 1) != 0;
    matchingOption = static_cast<MatchingOption>((flags >> 1) & 3);
    matchCase = (flags & 8) != 0;
}

std::u16string SnippetClipboardVariable::toString() const {
    BodyWriter writer;
    writer.part(u"clipboard");
    writer.paramIfSet(u"find", find);
    writer.paramIfSet(u"replacement", replacement);
    writer.param(u"flags",
                 (regularExpressions ? 1 : 0) + 2 * static_cast<std::int64_t>(matchingOption) + (matchCase ? 8 : 0));
    if (isOptional) writer.part(SnippetVariable::toString());
    return writer.take();
}

SnippetAbbreviationVariable::SnippetAbbreviationVariable(const VariableParams& params)
    : SnippetVariable(params), abbreviation(textParam(params, u"snippet")), uuid(textParam(params, u"uuid")) {}

std::u16string SnippetAbbreviationVariable::toString() const {
    BodyWriter writer;
    writer.param(u"snippet", abbreviation.value_or(std::u16string()));
    writer.paramIfSet(u"uuid", uuid);
    if (isOptional) writer.part(SnippetVariable::toString());
    return writer.take();
}

}  // namespace plume
