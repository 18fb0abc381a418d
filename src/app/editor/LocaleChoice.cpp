#include "app/editor/LocaleChoice.h"

#include <QCompleter>
#include <QLineEdit>
#include <QLocale>
#include <algorithm>
#include <map>
#include <utility>
#include <vector>

#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

LocaleChoice::LocaleChoice(const std::optional<std::u16string>& locale) {
    setEditable(true);
    setInsertPolicy(NoInsert);
    setSizeAdjustPolicy(AdjustToMinimumContentsLengthWithIcon);
    setMinimumContentsLength(16);
    completer()->setCompletionMode(QCompleter::PopupCompletion);
    completer()->setFilterMode(Qt::MatchContains);
    lineEdit()->setPlaceholderText(tr("Yours"));
    ignoreWheelWithoutFocus(*this);
    addLocales();
    const QString name = toQString(locale.value_or(u""));
    const int place = findData(name);
    place >= 0 ? setCurrentIndex(place) : setEditText(name);
    connect(this, &QComboBox::editTextChanged, this, &LocaleChoice::typed);
}

void LocaleChoice::addLocales() {
    std::map<QString, QString> names;  // locales of several scripts share an identifier
    for (const QLocale& each :
         QLocale::matchingLocales(QLocale::AnyLanguage, QLocale::AnyScript, QLocale::AnyTerritory)) {
        if (each.language() == QLocale::C || each.nativeLanguageName().isEmpty()) continue;
        names.try_emplace(each.name(), tr("%1 (%2)").arg(each.nativeLanguageName(), each.nativeTerritoryName()));
    }
    std::vector<std::pair<QString, QString>> sorted;
    for (const auto& [identifier, name] : names) sorted.emplace_back(name, identifier);
    std::sort(sorted.begin(), sorted.end(),
              [](const auto& a, const auto& b) { return a.first.localeAwareCompare(b.first) < 0; });
    addItem(QString(), QString());
    for (const auto& [name, identifier] : sorted) addItem(name, identifier);
}

void LocaleChoice::typed(const QString& text) {
    const int place = findText(text, Qt::MatchFixedString);
    const QString name = place >= 0 ? itemData(place).toString() : text.trimmed();
    Q_EMIT edited(name.isEmpty() ? std::nullopt : std::optional(fromQString(name)));
}

}  // namespace plume
