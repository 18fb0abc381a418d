// What a placeholder's chip says: "Date: today + 1 week, 28 Nov 2026".
//
// On the main thread, as all translations are.
#pragma once

#include <QCoreApplication>
#include <QString>
#include <string>

#include "content/ContentEnvironment.h"

namespace plume {

class SnippetClipboardVariable;
class SnippetDateVariable;
class SnippetFieldVariable;
class SnippetKeyVariable;
class SnippetTimeVariable;
class SnippetVariable;

// In one line. Empty for what is no placeholder.
QString chipWords(const std::u16string& body, const ContentEnvironment& environment);

class ChipWords {
    Q_DECLARE_TR_FUNCTIONS(ChipWords)
  public:
    explicit ChipWords(const ContentEnvironment& environment) : environment_(environment) {}

    QString of(const SnippetVariable& variable) const;

  private:
    QString ofKind(const SnippetVariable& variable) const;
    QString ofDate(const SnippetDateVariable& date) const;
    QString ofTime(const SnippetTimeVariable& time) const;
    static QString ofClipboard(const SnippetClipboardVariable& clipboard);
    static QString ofField(const SnippetFieldVariable& field);
    static QString ofKey(const SnippetKeyVariable& key);

    const ContentEnvironment& environment_;
};

}  // namespace plume
