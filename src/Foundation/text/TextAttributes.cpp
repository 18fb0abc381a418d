#include "Foundation/text/TextAttributes.h"

namespace plume {

namespace {

bool sameAttachment(const TextAttributes& a, const TextAttributes& b) {
    if (a.attachment == b.attachment) return true;
    return a.attachment && b.attachment && *a.attachment == *b.attachment;
}

const TextAttributes& orNone(const SharedAttributes& attributes) {
    static const TextAttributes none;
    return attributes ? *attributes : none;
}

}  // namespace

bool TextAttributes::operator==(const TextAttributes& other) const {
    return font == other.font && foregroundColor == other.foregroundColor && backgroundColor == other.backgroundColor &&
           underlineStyle == other.underlineStyle && strikethroughStyle == other.strikethroughStyle &&
           superscript == other.superscript && baselineOffset == other.baselineOffset && link == other.link &&
           toolTip == other.toolTip && paragraphStyle == other.paragraphStyle && sameAttachment(*this, other);
}

bool sameAttributes(const SharedAttributes& a, const SharedAttributes& b) {
    return a == b || orNone(a) == orNone(b);
}

}  // namespace plume
