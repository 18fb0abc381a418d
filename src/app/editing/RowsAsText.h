// Snippets as rows of a table in plain text, as spreadsheets copy and paste them: abbreviation, content, label.
//
// Columns are parted by tabs; a field that holds a tab, a line break or a double quote stands in double quotes.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "library/Snippet.h"

namespace plume {

std::u16string textFromRows(const std::vector<std::shared_ptr<Snippet>>& snippets);

// A text without tabs is the content of one snippet, an empty one is none. A row that has no content is left out.
std::vector<std::shared_ptr<Snippet>> rowsFromText(const std::u16string& text);

}  // namespace plume
