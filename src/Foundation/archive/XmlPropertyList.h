// The reader of property lists in XML; internal to readPropertyList().
#pragma once

#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

enum class XmlEncoding { AsDeclared, Utf8 };

// White space before the document is skipped.
Result<PropertyList> readXmlPropertyList(std::string_view bytes, XmlEncoding encoding);

}  // namespace plume
