// The names under which some formats hold fonts: one for each face ("Helvetica-BoldOblique"), where Plume holds the
// family and what is special about the face. Pure; from any thread.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/text/TextAttributes.h"

namespace plume {

// A name that says nothing of a face is taken for the family.
FontAttribute fontFromFaceName(std::u16string_view name);
// fontFromFaceName() gives the family and the face back; the size is not part of the name.
std::u16string faceNameOf(const FontAttribute& font);

}  // namespace plume
