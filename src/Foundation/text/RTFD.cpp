#include "Foundation/text/RTFD.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFDocument.h"

namespace plume {

namespace {

constexpr std::string_view Signature("rtfd\0\0\0\0", 8);
constexpr std::uint32_t FileKind = 1;
constexpr std::uint32_t DirectoryKind = 3;
// Instead of a length: the length and a padding follow, so that the contents start on a page.
constexpr std::uint32_t AlignedMark = 0x80000000;
constexpr std::size_t PageSize = 4096;
constexpr std::size_t NumberSize = 4;
constexpr std::uint32_t ReadableFileMode = 0644;

constexpr std::string_view TextEntry = "TXT.rtf";
constexpr std::string_view InformationEntry = ".";
constexpr std::string_view ContentsEntry = "..";
constexpr std::string_view NameEntry = "__@PreferredName@__";
constexpr std::string_view Utf8NameEntry = "__@UTF8PreferredName@__";

struct Entry {
    std::string name;
    std::string contents;
};

// ---- Writing ----

void appendNumber(std::string& bytes, std::size_t number) {
    for (std::size_t i = 0; i < NumberSize; ++i) bytes.push_back(static_cast<char>((number >> (8 * i)) & 0xFF));
}

void appendString(std::string& bytes, std::string_view text) {
    appendNumber(bytes, text.size());
    bytes.append(text);
}

void appendFile(std::string& bytes, std::string_view contents) {
    appendNumber(bytes, FileKind);
    if (contents.size() < PageSize) {
        appendString(bytes, contents);
        return;
    }
    const std::size_t start = bytes.size() + 3 * NumberSize;
    const std::size_t padding = (PageSize - start % PageSize) % PageSize;
    appendNumber(bytes, AlignedMark);
    appendNumber(bytes, contents.size());
    appendNumber(bytes, padding);
    bytes.append(padding, '\0');
    bytes.append(contents);
}

// What the file system said of every entry; the times are left at zero, so that equal texts give equal bytes.
std::string informationAbout(const std::vector<Entry>& entries) {
    std::string information;
    appendNumber(information, entries.size());
    for (const Entry& entry : entries) {
        appendString(information, entry.name);
        appendNumber(information, 4 * NumberSize);
        appendNumber(information, 0);
        appendNumber(information, ReadableFileMode);
        appendNumber(information, 0);
        appendNumber(information, 0);
    }
    return information;
}

std::string containerOf(std::vector<Entry> entries) {
    std::string information = informationAbout(entries);
    entries.push_back({std::string(InformationEntry), std::move(information)});
    std::string bytes(Signature);
    appendNumber(bytes, DirectoryKind);
    appendNumber(bytes, entries.size());
    for (const Entry& entry : entries) appendString(bytes, entry.name);
    const std::size_t sizes = bytes.size();
    bytes.append(entries.size() * NumberSize, '\0');
    std::string sizeTable;
    for (const Entry& entry : entries) {
        const std::size_t start = bytes.size();
        appendFile(bytes, entry.contents);
        appendNumber(sizeTable, bytes.size() - start);
    }
    bytes.replace(sizes, sizeTable.size(), sizeTable);
    return bytes;
}

// ---- Reading ----

class ContainerReader {
  public:
    explicit ContainerReader(std::string_view bytes) : bytes_(bytes) {}

    // The files of the outermost folder, in their order.
    Result<std::vector<Entry>> read() {
        std::vector<Entry> entries;
        if (readDirectory(entries)) return entries;
        return Error{"The RTFD data is damaged at byte " + std::to_string(position_) + ": expected " + expected_ + "."};
    }

  private:
    bool fails(const char* expected) {
        expected_ = expected;
        return false;
    }

    bool readNumber(std::size_t& number) {
        if (bytes_.size() - position_ < NumberSize) return fails("a number of four bytes");
        number = 0;
        for (std::size_t i = 0; i < NumberSize; ++i) {
            number |= static_cast<std::size_t>(static_cast<unsigned char>(bytes_[position_ + i])) << (8 * i);
        }
        position_ += NumberSize;
        return true;
    }

    bool readBytes(std::size_t length, std::string& bytes) {
        if (bytes_.size() - position_ < length) return fails("more bytes than there are");
        bytes.assign(bytes_.substr(position_, length));
        position_ += length;
        return true;
    }

    bool readDirectory(std::vector<Entry>& entries) {
        if (!bytes_.starts_with(Signature)) return fails("\"rtfd\" and a zero");
        position_ = Signature.size();
        std::size_t kind = 0;
        std::size_t count = 0;
        if (!readNumber(kind)) return false;
        if (kind != DirectoryKind) return fails("a folder before this byte");
        if (!readNumber(count)) return false;
        // Each entry takes at least the length of its name and its size.
        if (count > (bytes_.size() - position_) / (2 * NumberSize)) return fails("fewer entries before this byte");
        std::vector<std::string> names(count);
        for (std::string& name : names) {
            std::size_t length = 0;
            if (!readNumber(length) || !readBytes(length, name)) return false;
        }
        std::vector<std::size_t> sizes(count);
        for (std::size_t& size : sizes) {
            if (!readNumber(size)) return false;
        }
        for (std::size_t i = 0; i < count; ++i) {
            if (!readEntry(std::move(names[i]), sizes[i], entries)) return false;
        }
        return true;
    }

    bool readEntry(std::string name, std::size_t size, std::vector<Entry>& entries) {
        if (bytes_.size() - position_ < size) return fails("the bytes of an entry");
        const std::size_t end = position_ + size;
        std::size_t kind = 0;
        if (!readNumber(kind)) return false;
        if (kind == FileKind) {
            Entry entry{std::move(name), {}};
            if (!readFile(end, entry.contents)) return false;
            entries.push_back(std::move(entry));
        } else if (kind != DirectoryKind) {
            return fails("a file or a folder before this byte");
        }
        position_ = end;
        return true;
    }

    bool readFile(std::size_t end, std::string& contents) {
        std::size_t length = 0;
        std::size_t padding = 0;
        if (!readNumber(length)) return false;
        if (length == AlignedMark && !(readNumber(length) && readNumber(padding))) return false;
        if (position_ > end || padding > end - position_ || length > end - position_ - padding) {
            return fails("a file that fits its entry before this byte");
        }
        position_ += padding;
        return readBytes(length, contents);
    }

    std::string_view bytes_;
    std::size_t position_ = 0;
    std::string expected_;
};

Entry* findEntry(std::vector<Entry>& entries, std::string_view name) {
    const auto found =
        std::find_if(entries.begin(), entries.end(), [&](const Entry& entry) { return entry.name == name; });
    return found == entries.end() ? nullptr : &*found;
}

// ---- Documents ----

bool isContainer(std::string_view bytes) {
    return bytes.starts_with(Signature.substr(0, NumberSize));
}

std::string containerFromDocument(const RTFDocument& document) {
    std::vector<Entry> entries{{std::string(TextEntry), document.rtf}};
    for (const auto& [name, contents] : document.files) entries.push_back({toUtf8(name), contents});
    return containerOf(std::move(entries));
}

// Folders among the files are left out.
Result<RTFDocument> documentFromContainer(std::string_view bytes) {
    auto entries = ContainerReader(bytes).read();
    if (!entries) return entries.error();
    RTFDocument document;
    bool hasText = false;
    for (Entry& entry : entries.value()) {
        if (entry.name == TextEntry) {
            document.rtf = std::move(entry.contents);
            hasText = true;
        } else if (entry.name != InformationEntry) {
            document.files.emplace(fromUtf8(entry.name), std::move(entry.contents));
        }
    }
    if (!hasText) return Error{"The RTFD data holds no text: expected a file TXT.rtf in it."};
    return document;
}

}  // namespace

std::string rtfFromAttributedString(const AttributedString& text) {
    return rtfDocumentFromAttributedString(text, RTFAttachments::Leave).rtf;
}

Result<AttributedString> attributedStringFromRTF(std::string_view bytes) {
    return attributedStringFromRTFDocument(bytes, {});
}

std::string rtfdFromAttributedString(const AttributedString& text) {
    return containerFromDocument(rtfDocumentFromAttributedString(text, RTFAttachments::Keep));
}

Result<AttributedString> attributedStringFromRTFD(std::string_view bytes) {
    if (!isContainer(bytes)) return attributedStringFromRTF(bytes);
    auto document = documentFromContainer(bytes);
    if (!document) return document.error();
    return attributedStringFromRTFDocument(document.value().rtf, document.value().files);
}

std::string flatContainerFromAttachment(const TextAttachment& attachment) {
    const std::string name = toUtf8(attachment.fileName);
    return containerOf({{std::string(ContentsEntry), attachment.contents},
                        {std::string(NameEntry), name},
                        {std::string(Utf8NameEntry), name}});
}

Result<TextAttachment> attachmentFromFlatContainer(std::string_view bytes) {
    auto entries = ContainerReader(bytes).read();
    if (!entries) return entries.error();
    Entry* contents = findEntry(entries.value(), ContentsEntry);
    if (!contents) return Error{"The attached file has no contents: expected an entry \"..\" in its data."};
    TextAttachment attachment;
    attachment.contents = std::move(contents->contents);
    const Entry* name = findEntry(entries.value(), Utf8NameEntry);
    if (!name) name = findEntry(entries.value(), NameEntry);
    if (name) attachment.fileName = fromUtf8(name->contents);
    return attachment;
}

}  // namespace plume
