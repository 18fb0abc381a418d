// Attributed text from a keyed archive. One of these for one archive.
#pragma once

#include <optional>
#include <unordered_map>

#include "Foundation/archive/ArchiveReader.h"
#include "Foundation/archive/KeyedArchive.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

class ArchivedTextReader {
  public:
    // Which outlives this.
    explicit ArchivedTextReader(ArchiveReader& archive) : archive_(archive) {}

    // Nothing when the object is no attributed text. Text that no run covers has no attributes.
    std::optional<ArchivedRichText> read(const ArchivedValue& object);
    std::optional<AttributedString> readAttributedString(const ArchivedValue& object);

  private:
    // What one dictionary of attributes says.
    struct Attributes {
        SharedAttributes attributes;
        std::map<std::u16string, PropertyList> others;
        std::size_t othersCost = 0;
    };

    // Calls `receive` for each run with its length and its attributes.
    template <typename Receive>
    void readRuns(const ArchivedValue& object, std::size_t length, const Receive& receive);

    const Attributes& attributesOf(const ArchivedValue& dictionary);
    Attributes readAttributes(const ArchivedValue& dictionary);
    bool readAttribute(std::string_view name, const ArchivedValue& value, TextAttributes& attributes);
    std::vector<std::pair<std::size_t, std::size_t>> runsOf(const ArchivedValue& object, std::size_t length);
    std::optional<FontAttribute> fontOf(const ArchivedValue& object);
    std::optional<ColorAttribute> colorOf(const ArchivedValue& object);
    std::optional<ParagraphStyle> paragraphStyleOf(const ArchivedValue& object);
    std::shared_ptr<const TextAttachment> attachmentOf(const ArchivedValue& object);

    ArchiveReader& archive_;
    std::unordered_map<std::size_t, Attributes> known_;  // by the dictionary's place
    Attributes inline_;
    std::unordered_map<std::size_t, std::shared_ptr<const TextAttachment>> attachments_;
};

}  // namespace plume
