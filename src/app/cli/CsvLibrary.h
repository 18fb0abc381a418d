// A library from separated values: one group, a snippet a record.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "library/SnippetGroup.h"

namespace plume {

// The columns are abbreviation, content and label, without a heading; missing ones are empty. The text is UTF-8, UTF-16
// with a byte order mark, or else Mac OS Roman. The error says that there is no record.
Result<std::shared_ptr<SnippetGroup>> readCsvLibrary(std::string_view bytes, const std::u16string& groupName);

}  // namespace plume
