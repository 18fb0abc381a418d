#include "library/LibraryExport.h"

#include <filesystem>
#include <sstream>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

constexpr double HeadingSize = 18;
constexpr double TextSize = 12;

SharedAttributes attributesOf(const char16_t* family, double size, bool bold) {
    TextAttributes attributes;
    attributes.font = FontAttribute{.family = family, .size = size, .bold = bold};
    return std::make_shared<const TextAttributes>(std::move(attributes));
}

void appendSnippet(AttributedString& text, const Snippet& snippet) {
    static const SharedAttributes bold = attributesOf(u"Helvetica", TextSize, true);
    static const SharedAttributes plain = attributesOf(u"Helvetica", TextSize, false);
    static const SharedAttributes source = attributesOf(u"Courier", TextSize, false);
    text.append(snippet.abbreviationWithPrefix().value_or(u""), bold);
    if (snippet.label() && !snippet.label()->empty()) text.append(u" – " + *snippet.label(), plain);
    text.append(u"\n", plain);
    if (snippet.contentType() == ContentType::RichText && snippet.richTextContent()) {
        text.append(*snippet.richTextContent());
    } else {
        text.append(snippet.plainTextContent().value_or(u""), snippet.isScript() ? source : plain);
    }
    text.append(u"\n\n", plain);
}

}  // namespace

std::string csvFromLibrary(const SnippetGroups& groups) {
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u',');
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            writer.writeLineOfFields({snippet->abbreviationWithPrefix(), snippet->plainTextContent()});
        }
    }
    return stream.str();
}

std::string csvFromGroup(const SnippetGroup& group) {
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u',');
    for (const auto& snippet : group.items()) {
        writer.writeLineOfFields({snippet->abbreviationWithPrefix(), snippet->plainTextContent(), snippet->label()});
    }
    return stream.str();
}

std::string rtfFromGroups(const SnippetGroups& groups) {
    static const SharedAttributes heading = attributesOf(u"Helvetica", HeadingSize, true);
    AttributedString text;
    for (const auto& group : groups) {
        text.append(group->name().value_or(u"") + u"\n\n", heading);
        for (const auto& snippet : group->items()) appendSnippet(text, *snippet);
    }
    return rtfFromAttributedString(text);
}

std::string extensionOf(const std::string& fileName) {
    const std::string extension = std::filesystem::path(fileName).extension().string();
    return extension.empty() ? extension : toUtf8(lowercased(fromUtf8(extension.substr(1))));
}

}  // namespace plume
