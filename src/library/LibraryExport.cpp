#include "library/LibraryExport.h"

#include <filesystem>
#include <sstream>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace plume {

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

std::string extensionOf(const std::string& fileName) {
    const std::string extension = std::filesystem::path(fileName).extension().string();
    return extension.empty() ? extension : toUtf8(lowercased(fromUtf8(extension.substr(1))));
}

}  // namespace plume
