#include "content/SnippetVariable.h"

namespace plume {

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

}  // namespace plume
