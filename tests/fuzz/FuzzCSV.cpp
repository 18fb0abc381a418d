// Any text is read as separated values; what was read is written and comes back the same.
#include <cstdint>
#include <cstdlib>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace {

using plume::CSVParser;
using Rows = std::vector<CSVParser::Row>;

Rows read(std::u16string text, std::u16string separator, bool hasHeader, std::vector<std::u16string>& names) {
    CSVParser parser(std::move(text), std::move(separator), std::nullopt, hasHeader, {});
    Rows rows = parser.arrayOfParsedRows().value_or(Rows());
    names = parser.fieldNames();
    return rows;
}

// A record of one empty field is an empty line, which readers skip.
bool isEmptyLine(const CSVParser::Row& row) {
    return row.empty() || (row.size() == 1 && row.begin()->second.empty());
}

void checkWriting(const Rows& rows, const std::vector<std::u16string>& names) {
    std::ostringstream stream;
    plume::CsvWriter writer(stream, plume::CsvEncoding::Utf8, u',');
    Rows written;
    for (const CSVParser::Row& row : rows) {
        if (isEmptyLine(row)) continue;
        for (const auto& name : names) {
            if (const auto field = row.find(name); field != row.end()) writer.writeField(field->second);
        }
        writer.finishLine();
        written.push_back(row);
    }
    if (!writer.closeStream()) std::abort();
    std::vector<std::u16string> namesAgain;
    if (read(plume::fromUtf8(stream.str()), u",", false, namesAgain) != written) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    static const std::u16string separators[] = {u",", u";", u"\t", u"::"};
    const std::u16string separator = separators[data[0] % 4];
    const std::u16string text = plume::fromUtf8({reinterpret_cast<const char*>(data) + 1, size - 1});
    std::vector<std::u16string> names;
    read(text, separator, true, names);
    const Rows rows = read(text, separator, false, names);
    checkWriting(rows, names);
    return 0;
}
