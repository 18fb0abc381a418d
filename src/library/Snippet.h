// One snippet: an abbreviation and the content that it stands for.
//
// Snippets are identities shared by std::shared_ptr: the group that lists one owns it, and a snippet points back to its
// group without owning it. All operations belong to the thread that owns the library. A change of the abbreviation is
// announced to the group at once, so that indexes stay right.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/Date.h"
#include "Foundation/Uuid.h"
#include "Foundation/archive/KeyedCoding.h"
#include "Foundation/text/AttributedString.h"
#include "library/AbbreviationHash.h"

namespace plume {

class SnippetGroup;

enum class ContentType : std::int64_t { PlainText = 0, RichText = 1, AppleScript = 2, ShellScript = 3 };
enum class CaseSensitivity : std::int64_t { CaseSensitive = 0, IgnoreCase = 1, IgnoreCaseAndAdapt = 2 };

class Snippet final : public KeyedCodable {
  public:
    using Text = std::optional<std::u16string>;

    Snippet();
    Snippet(Text abbreviation, Text plainTextContent);
    // Empty, with an identity that it had before.
    explicit Snippet(const Uuid& uuid);
    // Reads an archived snippet; nothing that the archive holds or lacks makes it fail. A date that is missing stays
    // missing; an unreadable content is none.
    explicit Snippet(const KeyedDecoder& coder);
    // For snapshot() alone: nothing is set.
    class Empty {
        friend class Snippet;
        Empty() = default;
    };
    explicit Snippet(Empty /*nothing*/) {}
    Snippet(const Snippet&) = delete;
    Snippet& operator=(const Snippet&) = delete;

    // Nothing when an archive held a string that is no UUID.
    const std::optional<Uuid>& uuid() const { return uuid_; }

    const Text& abbreviation() const { return abbreviation_; }
    void setAbbreviation(Text abbreviation);
    // hashOfSuffix (library/AbbreviationHash.h) of the abbreviation; that of the empty text when it is nil.
    std::uint64_t abbreviationHash() const { return abbreviationHash_; }
    // The group's prefix and the abbreviation, or the abbreviation alone when either is empty or there is no group.
    Text abbreviationWithPrefix() const;

    // Archives may hold values outside the named ones; they are kept.
    CaseSensitivity caseSensitivity() const { return caseSensitivity_; }
    void setCaseSensitivity(CaseSensitivity value);

    ContentType contentType() const { return contentType_; }
    // Turning rich text into plain text drops its formatting.
    void setContentType(ContentType type);

    const std::optional<AttributedString>& richTextContent() const { return richTextContent_; }
    void setRichTextContent(std::optional<AttributedString> content);
    Text plainTextContent() const;
    void setPlainTextContent(Text content);
    // The content as RTFD bytes.
    std::optional<std::string> contentData() const;
    std::size_t contentLength() const;
    // An empty content counts as content.
    bool hasContent() const { return richTextContent_.has_value(); }
    // No placeholder is opened in the content.
    bool isSimpleSnippet() const;
    bool isScript() const;
    bool isContentEqualTo(const Snippet& other) const;
    // Everything that is archived is equal, identity and dates included.
    bool isSameRecordAs(const Snippet& other) const;

    const Text& label() const { return label_; }
    void setLabel(Text label);
    const Text& note() const { return note_; }
    void setNote(Text note);
    // What lists sort by: the label when there is one, else the plain content.
    Text sortingContent() const;

    const std::optional<Date>& dateCreated() const { return dateCreated_; }
    const std::optional<Date>& dateModified() const { return dateModified_; }
    const std::optional<Date>& lastTimeUsed() const { return lastTimeUsed_; }
    // Now, unless an initialiser is still running.
    void updateDateModified();
    void updateLastTimeUsed();

    // Null without a group, and when the group is gone.
    std::shared_ptr<SnippetGroup> parentGroup() const { return parentGroup_.lock(); }
    void setParentGroup(const std::weak_ptr<SnippetGroup>& group) { parentGroup_ = group; }

    // A duplicate with an identity and dates of its own, in the same group's name (not in its list).
    std::shared_ptr<Snippet> copySnippet() const;
    // The same record, identity and dates included, as it is now, in no group: for a thread of its own, or to be
    // compared with later.
    std::shared_ptr<Snippet> snapshot() const;
    // Whatever differs between the two records becomes as it is in `after`, dates included; all else stays, and the
    // identity always does.
    void takeDifferences(const Snippet& before, const Snippet& after);
    // Grows with every change of what is archived.
    std::uint64_t revision() const { return revision_; }

    std::string_view archiveClassName() const override { return "Snippet"; }
    void encodeWithCoder(KeyedEncoder& coder) const override;

  private:
    void readContent(const KeyedDecoder& coder);
    ArchivedContent archivedContent() const;

    std::optional<Uuid> uuid_;
    bool initialized_ = false;
    std::uint64_t revision_ = 0;
    Text abbreviation_;
    std::uint64_t abbreviationHash_ = EmptySuffixHash;
    CaseSensitivity caseSensitivity_ = CaseSensitivity::CaseSensitive;
    ContentType contentType_ = ContentType::PlainText;
    std::optional<AttributedString> richTextContent_;
    // Archived bytes that could not be read, written back until the snippet is given a content.
    std::shared_ptr<const ArchivedData> unreadContent_;
    Text label_;
    std::optional<Date> dateCreated_;
    std::optional<Date> dateModified_;
    std::optional<Date> lastTimeUsed_;
    Text note_;
    std::weak_ptr<SnippetGroup> parentGroup_;
};

}  // namespace plume
