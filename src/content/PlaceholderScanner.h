// Replaces the placeholders of one text, and of the texts that this brings in, from front to back.
//
// A nested snippet's content is scanned in its turn, and its brackets may pair with those of the text behind it; values
// of dates and of the clipboard are not scanned. Takes time linear in what is read and written.
#pragma once

#include <memory>
#include <string_view>

#include "Foundation/text/AttributedString.h"
#include "content/ExpansionContext.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

// Null when the context is exhausted.
std::shared_ptr<SnippetExpandedContent> expandPlainText(ExpansionContext& context, std::u16string_view text);
std::shared_ptr<SnippetExpandedContent> expandRichText(ExpansionContext& context, const AttributedString& text);

}  // namespace plume
