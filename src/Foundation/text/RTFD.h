// Rich text as bytes: RTF, and flat RTFD (RTF together with its attached files in one blob).
//
// Readers accept foreign bytes: they are bounded in depth, memory and time, and whatever they cannot understand is left
// out of the text. Writers write what AttributedString holds. Pure; from any thread.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

// 7-bit RTF 1.x; attachments are left out.
std::string rtfFromAttributedString(const AttributedString& text);
// Fails only when the bytes do not start as RTF does; a text cut short gives what stands before the cut.
Result<AttributedString> attributedStringFromRTF(std::string_view bytes);

std::string rtfdFromAttributedString(const AttributedString& text);
// Fails when the blob is damaged, with the offset in the message. Plain RTF is accepted too.
Result<AttributedString> attributedStringFromRTFD(std::string_view bytes);

// One attached file with its name, in the same kind of blob, as archives keep it.
std::string flatContainerFromAttachment(const TextAttachment& attachment);
Result<TextAttachment> attachmentFromFlatContainer(std::string_view bytes);

}  // namespace plume
