// From RTF's formats to the attributes of text: what fonts, colours, links and paragraphs of one document come to.
//
// Internal to the RTF reader; one reader, one thread.
#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/RTFDocument.h"
#include "Foundation/text/RTFFormats.h"
#include "Foundation/text/RTFTables.h"
#include "Foundation/text/TextAttributes.h"

namespace plume {

class RTFAttributes {
  public:
    // All outlive this.
    RTFAttributes(const RTFFontTable& fonts, const RTFColorTable& colors, const RTFListTable& lists,
                  const RTFFiles& files);

    // The number by which formats name the link that a field's instruction makes; 0 when it makes none.
    int addLink(std::u16string_view instruction);
    // Likewise for an attached file, 0 when there is no such file.
    int attachmentNumber(std::u16string_view fileName);

    // Holds for the attributes asked for from here on.
    void useParagraphFormat(const RTFParagraphFormat& format);
    SharedAttributes attributesOf(const RTFCharacterFormat& format);

  private:
    struct Link {
        std::u16string address;
        std::u16string toolTip;
    };

    SharedAttributes makeAttributes(const RTFCharacterFormat& format);
    FontAttribute fontOf(const RTFCharacterFormat& format) const;

    const RTFFontTable& fonts_;
    const RTFColorTable& colors_;
    const RTFListTable& lists_;
    const RTFFiles& files_;
    std::vector<Link> links_;
    std::vector<std::shared_ptr<const TextAttachment>> attachments_;
    std::map<std::u16string, int, std::less<>> attachmentNumbers_;

    RTFParagraphFormat paragraphFormat_;  // what the next two were made for
    std::optional<ParagraphStyle> paragraphStyle_;
    std::map<RTFCharacterFormat, SharedAttributes> made_;
    std::size_t madeSize_ = 0;  // estimated bytes of everything made
};

}  // namespace plume
