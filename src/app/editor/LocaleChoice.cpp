#include "app/editor/LocaleChoice.h"

#include <unicode/locid.h>

#include <QCompleter>
#include <QLineEdit>
#include <algorithm>
#include <span>
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
    std::int32_t count = 0;
    const icu::Locale* locales = icu::Locale::getAvailableLocales(count);
    const icu::Locale shownIn(locale().name().toUtf8().constData());
    std::vector<std::pair<QString, QString>> named;
    for (const icu::Locale& each : std::span(locales, static_cast<std::size_t>(count))) {
        icu::UnicodeString name;
        each.getDisplayName(shownIn, name);
        named.emplace_back(QString::fromUtf16(name.getBuffer(), name.length()), QString::fromUtf8(each.getName()));
    }
    std::sort(named.begin(), named.end(),
              [](const auto& a, const auto& b) { return a.first.localeAwareCompare(b.first) < 0; });
    addItem(QString(), QString());
    for (const auto& [name, identifier] : named) addItem(name, identifier);
}

void LocaleChoice::typed(const QString& text) {
    const int place = findText(text, Qt::MatchFixedString);
    const QString name = place >= 0 ? itemData(place).toString() : text.trimmed();
    Q_EMIT edited(name.isEmpty() ? std::nullopt : std::optional(fromQString(name)));
}

}  // namespace plume
