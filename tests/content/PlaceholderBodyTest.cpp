#include "content/PlaceholderBody.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace plume {
namespace {

VariableParams paramsOfRows(const std::u16string& body) {
    VariableParams params;
    CSVParser parser(body, u":", CharacterSet::withCharacters(u" "), false, {u"Name", u"Value"});
    const auto rows = parser.arrayOfParsedRows();
    if (!rows) return params;
    for (const auto& row : *rows) {
        const auto value = row.find(u"Value");
        params.insert_or_assign(row.at(u"Name"), value == row.end() ? std::u16string() : value->second);
    }
    return params;
}

std::u16string anyText(const std::string& alphabet) {
    return fromUtf8(*rc::gen::container<std::string>(rc::gen::elementOf(alphabet)));
}

RC_GTEST_PROP(PlaceholderBody, IsReadAsRowsAre, ()) {
    const std::u16string body = anyText("ab :\"\n");
    RC_ASSERT(parseParams(body) == paramsOfRows(body));
}

RC_GTEST_PROP(PlaceholderBody, EscapedParametersAreReadBackAsTheyWere, ()) {
    const std::u16string first = anyText("ab :\"\n");
    const std::u16string second = anyText("ab :\"\n");
    const VariableParams params = parseParams(u"first:" + escapeParam(first) + u" second:" + escapeParam(second));
    RC_ASSERT(params == (VariableParams{{u"first", first}, {u"second", second}}));
}

}  // namespace
}  // namespace plume
