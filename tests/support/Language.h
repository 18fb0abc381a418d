// Windows that are made while it lives speak another language, as users of that language see them.
#pragma once

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QKeySequence>
#include <QLabel>
#include <QTranslator>
#include <filesystem>
#include <map>

#include "app/qt/Translations.h"

namespace plume::test {

// Where the build puts what windows say in other languages.
inline std::filesystem::path translationFolder() {
    return std::filesystem::path(QCoreApplication::applicationDirPath().toStdString()) / "../share/plume/translations";
}

class SpokenLanguage {
  public:
    explicit SpokenLanguage(const QString& language) { installTranslations(*qApp, translationFolder(), {language}); }
    ~SpokenLanguage() { qDeleteAll(qApp->findChildren<QTranslator*>(Qt::FindDirectChildrenOnly)); }
    SpokenLanguage(const SpokenLanguage&) = delete;
    SpokenLanguage& operator=(const SpokenLanguage&) = delete;
};

// What a page or a menu is given one after the other, of which none may be chosen by the same letter.
class Mnemonics {
  public:
    void add(const QString& text) {
        const QKeySequence key = QKeySequence::mnemonic(text);
        if (key.isEmpty()) return;
        EXPECT_TRUE(taken_.emplace(key.toString(), text).second)
            << text.toStdString() << ", " << taken_[key.toString()].toStdString();
    }
    // Everything in the window that can be seen.
    void addAll(const QWidget& window) {
        for (const auto* button : window.findChildren<QAbstractButton*>()) {
            if (button->isVisible()) add(button->text());
        }
        for (const auto* label : window.findChildren<QLabel*>()) {
            if (label->isVisible() && label->buddy()) add(label->text());
        }
    }

  private:
    std::map<QString, QString> taken_;
};

}  // namespace plume::test
