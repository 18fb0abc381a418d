// The locale that the user has chosen in the environment, of one kind of text.
#pragma once

#include <string>

namespace plume {

enum class LocaleCategory { Dates, Numbers };

// ICU's name of it ("de_DE"): the first of LC_ALL, the category's own variable (LC_TIME, LC_NUMERIC) and LANG that is
// set and not empty. ICU's default locale is another one: that of messages. "en_US_POSIX" when there is none, or when
// it cannot be read. From any thread, as long as none changes the environment.
std::string userLocale(LocaleCategory category);

}  // namespace plume
