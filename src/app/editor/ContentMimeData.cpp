#include "app/editor/ContentMimeData.h"

#include <string>
#include <string_view>
#include <utility>

#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/HTMLImport.h"
#include "Foundation/text/RTFD.h"
#include "app/qt/Text.h"
#include "content/ContentRewriter.h"

namespace plume {

namespace {

constexpr QLatin1String OwnType("application/x-plume-content");
constexpr QLatin1String RtfType("text/rtf");
constexpr QLatin1String OtherRtfType("application/rtf");
constexpr QLatin1String HtmlType("text/html");
constexpr QLatin1String PlainType("text/plain");
constexpr char16_t FileUnit = u'\uFFFC';

std::string bytesOf(const QMimeData& data, const QString& type) {
    return data.data(type).toStdString();
}

QByteArray asBytes(const std::string& text) {
    return QByteArray::fromStdString(text);
}

bool hasFile(const SharedAttributes& attributes) {
    return attributes && attributes->attachment && attributes->attachment->cellText.empty();
}

AttributedString withoutEmptyObjects(const AttributedString& text) {
    AttributedStringRewriter rewriter(text);
    const std::u16string& units = text.string();
    for (std::size_t i = units.find(FileUnit); i != std::u16string::npos; i = units.find(FileUnit, i + 1)) {
        rewriter.copyTo(i);
        if (!hasFile(rewriter.attributes())) rewriter.skipTo(i + 1);
    }
    return rewriter.finish();
}

std::u16string withoutObjects(std::u16string text) {
    std::erase(text, FileUnit);
    return text;
}

// Lines end as they do in snippets.
std::u16string linesOf(const QString& text) {
    QString lines = text;
    lines.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    lines.replace(u'\r', u'\n').replace(QChar::ParagraphSeparator, u'\n');
    return fromQString(lines);
}

std::optional<AttributedString> readableRichText(const QMimeData& data) {
    for (const QLatin1String type : {RtfType, OtherRtfType}) {
        if (!data.hasFormat(type)) continue;
        auto text = attributedStringFromRTF(bytesOf(data, type));
        if (text.ok() && !text.value().isEmpty()) return std::move(text).value();
    }
    if (!data.hasHtml()) return std::nullopt;
    AttributedString text = attributedStringFromHTML(data.html().toStdString());
    return text.isEmpty() ? std::nullopt : std::optional(std::move(text));
}

std::optional<AttributedString> anyContent(const QMimeData& data, bool asRich) {
    if (data.hasFormat(OwnType)) {
        auto own = attributedStringFromRTFD(bytesOf(data, OwnType));
        if (own.ok()) return std::move(own).value();
    }
    if (asRich) {
        if (auto rich = readableRichText(data)) return rich;
    }
    if (!data.hasText()) return std::nullopt;
    return AttributedString(linesOf(data.text()));
}

}  // namespace

ContentMimeData::ContentMimeData(AttributedString content, bool isRich)
    : content_(std::move(content)), isRich_(isRich) {}

QStringList ContentMimeData::formats() const {
    if (isRich_) return {OwnType, RtfType, HtmlType, PlainType};
    return {OwnType, PlainType};
}

bool ContentMimeData::hasFormat(const QString& type) const {
    return formats().contains(type);
}

QVariant ContentMimeData::retrieveData(const QString& type, QMetaType /*metaType*/) const {
    if (type == OwnType) return asBytes(rtfdFromAttributedString(content_));
    if (type == PlainType) return toQString(withoutObjects(content_.string()));
    if (!isRich_) return {};
    if (type == RtfType) return asBytes(rtfFromAttributedString(content_));
    if (type == HtmlType) {
        return QString::fromStdString(htmlFromAttributedString(content_, defaultExcludedTags()));
    }
    return {};
}

bool holdsContent(const QMimeData& data) {
    return data.hasFormat(OwnType) || data.hasText() || data.hasHtml() || data.hasFormat(RtfType) ||
           data.hasFormat(OtherRtfType);
}

std::optional<AttributedString> contentFrom(const QMimeData& data, bool asRich) {
    const std::optional<AttributedString> content = anyContent(data, asRich);
    if (!content) return std::nullopt;
    AttributedString result =
        asRich ? withoutEmptyObjects(*content) : AttributedString(withoutObjects(content->string()));
    return result.isEmpty() ? std::nullopt : std::optional(std::move(result));
}

}  // namespace plume
