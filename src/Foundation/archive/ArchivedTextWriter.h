// Attributed text as objects of a keyed archive.
//
// Everything that TextAttributes holds has its place there, but for the text of an editor's chip
// (TextAttachment::cellText). One of these for one archive.
#pragma once

#include <map>

#include "Foundation/archive/ArchiveWriter.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

class ArchivedTextWriter {
  public:
    using Object = ArchiveWriter::Object;

    explicit ArchivedTextWriter(ArchiveWriter& archive) : archive_(archive) {}

    Object add(const AttributedString& text);

  private:
    using Fields = ArchiveWriter::Fields;

    void addRuns(Fields& fields, const std::vector<AttributedString::Run>& runs);
    Object addAttributes(const SharedAttributes& attributes);
    Object addAttributes(const TextAttributes& attributes);
    Object addFont(const FontAttribute& font);
    Object addColor(const ColorAttribute& color);
    Object addLink(const std::u16string& link);
    Object addParagraphStyle(const ParagraphStyle& style);
    Object addTabStops(const std::vector<double>& locations);
    Object addTextLists(const std::vector<TextList>& lists);
    Object addAttachment(const TextAttachment& attachment);
    Object addMutableData(const std::string& bytes);

    ArchiveWriter& archive_;
    // Keeps what it knows, so that no other attributes can come to lie in the same place.
    std::map<SharedAttributes, Object> known_;
};

}  // namespace plume
