#include "library/Snippet.h"

#include <tuple>
#include <utility>
#include <variant>

#include "Foundation/text/RTFD.h"
#include "library/AbbreviationHash.h"
#include "library/SnippetGroup.h"

namespace plume {

namespace {

constexpr char16_t PlaceholderOpening = u'\u3010';

}  // namespace

Snippet::Snippet() : Snippet(std::nullopt, std::nullopt) {}

Snippet::Snippet(Text abbreviation, Text plainTextContent) : uuid_(Uuid::random()) {
    dateCreated_ = dateModified_ = lastTimeUsed_ = currentDate();
    setAbbreviation(std::move(abbreviation));
    setPlainTextContent(std::move(plainTextContent));
    initialized_ = true;
}

Snippet::Snippet(const Uuid& uuid) : Snippet() {
    uuid_ = uuid;
}

Snippet::Snippet(const KeyedDecoder& coder) {
    if (coder.containsValueForKey("UUID")) {
        const Text text = coder.decodeString("UUID");
        if (text) uuid_ = Uuid::parse(*text);
    } else {
        uuid_ = Uuid::random();
    }
    setAbbreviation(coder.decodeString("Abbreviation"));
    setLabel(coder.decodeString("Label"));
    setContentType(static_cast<ContentType>(coder.decodeInteger("ContentType")));
    caseSensitivity_ = static_cast<CaseSensitivity>(coder.decodeInteger("CaseSensitivity"));
    readContent(coder);
    dateCreated_ = coder.decodeDate("DateCreated");
    dateModified_ = coder.decodeDate("DateModified");
    lastTimeUsed_ = coder.decodeDate("LastTimeUsed");
    setNote(coder.decodeString("Note"));
    initialized_ = true;
}

void Snippet::readContent(const KeyedDecoder& coder) {
    ArchivedContent content = coder.decodeContent("Content");
    if (auto* text = std::get_if<std::u16string>(&content)) {
        setPlainTextContent(std::move(*text));
    } else if (auto* attributed = std::get_if<AttributedString>(&content)) {
        setRichTextContent(std::move(*attributed));
    } else if (auto* data = std::get_if<ArchivedData>(&content)) {
        // Older libraries hold every content as RTFD.
        Result<AttributedString> rich = attributedStringFromRTFD(data->bytes);
        if (rich) {
            setRichTextContent(std::move(rich).value());
        } else {
            unreadContent_ = std::make_shared<const ArchivedData>(std::move(*data));
        }
    }
}

void Snippet::setAbbreviation(Text abbreviation) {
    const Text previous = std::exchange(abbreviation_, std::move(abbreviation));
    abbreviationHash_ = hashOfSuffix(abbreviation_.value_or(u""));
    ++revision_;
    updateDateModified();
    if (abbreviation_ == previous) return;
    if (const auto group = parentGroup()) group->snippetAbbreviationChanged(*this, previous);
}

Snippet::Text Snippet::abbreviationWithPrefix() const {
    if (!abbreviation_ || abbreviation_->empty()) return abbreviation_;
    const auto group = parentGroup();
    if (!group || !group->hasAbbreviationPrefix()) return abbreviation_;
    return *group->abbreviationPrefix() + *abbreviation_;
}

void Snippet::setCaseSensitivity(CaseSensitivity value) {
    caseSensitivity_ = value;
    ++revision_;
}

void Snippet::setContentType(ContentType type) {
    if (type == contentType_) return;
    contentType_ = type;
    ++revision_;
    if (type == ContentType::PlainText && richTextContent_) {
        richTextContent_ = AttributedString(richTextContent_->string());
    }
    updateDateModified();
}

void Snippet::setRichTextContent(std::optional<AttributedString> content) {
    richTextContent_ = std::move(content);
    unreadContent_.reset();
    ++revision_;
    updateDateModified();
}

Snippet::Text Snippet::plainTextContent() const {
    if (!richTextContent_) return std::nullopt;
    return richTextContent_->string();
}

void Snippet::setPlainTextContent(Text content) {
    if (content) {
        setRichTextContent(AttributedString(std::move(*content)));
    } else {
        setRichTextContent(std::nullopt);
    }
}

std::optional<std::string> Snippet::contentData() const {
    if (!richTextContent_) return std::nullopt;
    return rtfdFromAttributedString(*richTextContent_);
}

std::size_t Snippet::contentLength() const {
    return richTextContent_ ? richTextContent_->length() : 0;
}

bool Snippet::isSimpleSnippet() const {
    return !richTextContent_ || richTextContent_->string().find(PlaceholderOpening) == std::u16string::npos;
}

bool Snippet::isScript() const {
    return contentType_ == ContentType::AppleScript || contentType_ == ContentType::ShellScript;
}

bool Snippet::isContentEqualTo(const Snippet& other) const {
    if (caseSensitivity_ != other.caseSensitivity_ || contentType_ != other.contentType_) return false;
    if (contentType_ == ContentType::RichText) return richTextContent_ == other.richTextContent_;
    if (!richTextContent_ || !other.richTextContent_) return hasContent() == other.hasContent();
    return richTextContent_->string() == other.richTextContent_->string();
}

void Snippet::setLabel(Text label) {
    label_ = std::move(label);
    ++revision_;
    updateDateModified();
}

void Snippet::setNote(Text note) {
    note_ = std::move(note);
    ++revision_;
}

Snippet::Text Snippet::sortingContent() const {
    if (label_ && !label_->empty()) return label_;
    return plainTextContent();
}

void Snippet::updateDateModified() {
    if (initialized_) dateModified_ = currentDate();
}

void Snippet::updateLastTimeUsed() {
    lastTimeUsed_ = currentDate();
    ++revision_;
}

std::shared_ptr<Snippet> Snippet::copySnippet() const {
    auto copy = std::make_shared<Snippet>();
    copy->setAbbreviation(abbreviation_);
    copy->setLabel(label_);
    copy->setContentType(contentType_);
    copy->setRichTextContent(richTextContent_);
    copy->unreadContent_ = unreadContent_;
    copy->setCaseSensitivity(caseSensitivity_);
    copy->setParentGroup(parentGroup_);
    copy->setNote(note_);
    return copy;
}

std::shared_ptr<Snippet> Snippet::snapshot() const {
    auto copy = std::make_shared<Snippet>(Empty());
    copy->uuid_ = uuid_;
    copy->revision_ = revision_;
    copy->abbreviation_ = abbreviation_;
    copy->abbreviationHash_ = abbreviationHash_;
    copy->caseSensitivity_ = caseSensitivity_;
    copy->contentType_ = contentType_;
    copy->richTextContent_ = richTextContent_;
    copy->unreadContent_ = unreadContent_;
    copy->label_ = label_;
    copy->dateCreated_ = dateCreated_;
    copy->dateModified_ = dateModified_;
    copy->lastTimeUsed_ = lastTimeUsed_;
    copy->note_ = note_;
    copy->initialized_ = true;
    return copy;
}

void Snippet::takeDifferences(const Snippet& before, const Snippet& after) {
    const auto modified = dateModified_;
    if (before.abbreviation_ != after.abbreviation_) setAbbreviation(after.abbreviation_);
    dateModified_ = modified;
    const auto take = [&](auto field) {
        if (!(before.*field == after.*field)) this->*field = after.*field;
    };
    take(&Snippet::caseSensitivity_);
    take(&Snippet::contentType_);
    take(&Snippet::richTextContent_);
    take(&Snippet::unreadContent_);
    take(&Snippet::label_);
    take(&Snippet::note_);
    take(&Snippet::dateCreated_);
    take(&Snippet::dateModified_);
    take(&Snippet::lastTimeUsed_);
    ++revision_;
}

bool Snippet::isSameRecordAs(const Snippet& other) const {
    const auto record = [](const Snippet& snippet) {
        return std::tie(snippet.uuid_, snippet.abbreviation_, snippet.caseSensitivity_, snippet.contentType_,
                        snippet.richTextContent_, snippet.label_, snippet.note_, snippet.dateCreated_,
                        snippet.dateModified_, snippet.lastTimeUsed_);
    };
    const bool sameUnread = unreadContent_ && other.unreadContent_ ? *unreadContent_ == *other.unreadContent_
                                                                   : unreadContent_ == other.unreadContent_;
    return sameUnread && record(*this) == record(other);
}

void Snippet::encodeWithCoder(KeyedEncoder& coder) const {
    coder.encodeString("UUID", uuid_ ? Text(uuid_->toString()) : std::nullopt);
    coder.encodeString("Abbreviation", abbreviation_);
    coder.encodeString("Label", label_);
    coder.encodeInteger("ContentType", static_cast<std::int64_t>(contentType_));
    coder.encodeInteger("CaseSensitivity", static_cast<std::int64_t>(caseSensitivity_));
    coder.encodeDate("DateCreated", dateCreated_);
    coder.encodeDate("DateModified", dateModified_);
    coder.encodeDate("LastTimeUsed", lastTimeUsed_);
    coder.encodeString("Note", note_);
    coder.encodeContent("Content", archivedContent());
}

ArchivedContent Snippet::archivedContent() const {
    if (!richTextContent_) {
        if (unreadContent_) return *unreadContent_;
        return std::monostate();
    }
    if (contentType_ == ContentType::PlainText) return richTextContent_->string();
    return *richTextContent_;
}

}  // namespace plume
