// Find-and-replace on the clipboard's content for clipboard placeholders.
#pragma once

#include <chrono>
#include <string>

#include "Foundation/text/AttributedString.h"
#include "content/ContentEnvironment.h"
#include "content/SnippetClipboardVariable.h"

namespace plume {

// The content after find-and-replace. A pattern that does not compile, or takes more than the keystroke's road allows,
// leaves the content unchanged and is reported, once for each pattern. What a pattern takes comes off `timeLeft`, and
// none is searched for when nothing is left.
std::u16string processClipboardVariable(const SnippetClipboardVariable& variable, const std::u16string& content,
                                        const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft);
AttributedString processClipboardVariable(const SnippetClipboardVariable& variable, const AttributedString& content,
                                          const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft);

}  // namespace plume
