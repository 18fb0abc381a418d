// The flat container: one file, or a folder of files, as one run of bytes.
//
// Readers accept foreign bytes and never look outside them. Pure; from any thread.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/text/RTFDocument.h"
#include "Foundation/text/TextAttributes.h"

namespace plume {

bool isFlatContainer(std::string_view bytes);

// A document and the files it shows. Folders among these are left out.
std::string flatContainerFromDocument(const RTFDocument& document);
Result<RTFDocument> documentFromFlatContainer(std::string_view bytes);

// One attached file with its name, as archives keep it.
std::string flatContainerFromAttachment(const TextAttachment& attachment);
Result<TextAttachment> attachmentFromFlatContainer(std::string_view bytes);

}  // namespace plume
