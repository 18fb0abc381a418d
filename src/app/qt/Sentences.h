// What the parts without windows say, in the user's language.
//
// They say it in English, which also is what the log has; here the sentences are known by their words. On the main
// thread.
#pragma once

#include <QString>
#include <string>

namespace plume {

// What a sentence quotes, like the reason that the system gives, is translated, too, where it is known. A sentence that
// is not known stays as it is.
QString inUsersLanguage(const QString& sentence);
inline QString inUsersLanguage(const std::string& sentence) {
    return inUsersLanguage(QString::fromStdString(sentence));
}

}  // namespace plume
