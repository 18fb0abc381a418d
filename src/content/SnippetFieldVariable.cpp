#include "content/SnippetFieldVariable.h"

namespace plume {
namespace {

constexpr std::int64_t DefaultWidth = 30;
constexpr std::int64_t DefaultHeight = 5;

}  // namespace

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

}  // namespace plume
