// The language and region in which dates are written: the user's own, one of a list, or a typed identifier.
//
// On the main thread; its form owns it.
#pragma once

#include <QComboBox>
#include <optional>
#include <string>

namespace plume {

class LocaleChoice final : public QComboBox {
    Q_OBJECT
  public:
    explicit LocaleChoice(const std::optional<std::u16string>& locale);

    // By the user; nothing: the user's own.
    Q_SIGNAL void edited(const std::optional<std::u16string>& locale);

  private:
    void addLocales();
    void typed(const QString& text);
};

}  // namespace plume
