// What imports are compared by.
#pragma once

#include <string>
#include <string_view>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "import/Importers.h"

namespace plume::test {

// "[group]", then "abbreviation|content|label" for each snippet.
inline std::string shown(const ImportedLibrary& library) {
    const auto text = [](const Snippet::Text& value) { return toUtf8(value.value_or(u"nil")); };
    std::string all;
    for (const auto& group : library.groups) {
        all += "[" + text(group->name()) + "]\n";
        for (const auto& snippet : group->items()) {
            all += text(snippet->abbreviation()) + "|" + text(snippet->plainTextContent()) + "|" +
                   text(snippet->label()) + "\n";
        }
    }
    return all;
}

inline std::string remarksOf(const ImportedLibrary& library) {
    std::string all;
    for (const std::string& line : library.remarks) all += line + "\n";
    return all;
}

}  // namespace plume::test
