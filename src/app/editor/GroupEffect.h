// What a group's settings mean, in a sentence.
//
// Main thread.
#pragma once

#include <QString>
#include <functional>
#include <string>

#include "library/SnippetGroup.h"

namespace plume {

// What is to be typed where, at the example of the group's first abbreviation: "In Thunderbird only: type ;sig, then a
// space." Programs and keyboard layouts are called by what the functions say, layouts without one by their identifiers.
QString effectOf(const SnippetGroup& group, const std::function<QString(const std::u16string&)>& applicationName,
                 const std::function<QString(const std::u16string&)>& inputSourceName = {});

}  // namespace plume
