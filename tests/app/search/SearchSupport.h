// A library, and a search window with a program around it that notes what it is asked.
#pragma once

#include <gtest/gtest.h>

#include <QAbstractItemModel>
#include <QApplication>
#include <QDir>
#include <QKeyEvent>
#include <QTest>
#include <QTextBrowser>
#include <string>
#include <utility>
#include <vector>

#include "app/qt/ColorScheme.h"
#include "app/qt/Text.h"
#include "app/search/SnippetRow.h"
#include "library/LibraryArchive.h"

namespace plume::test {

inline std::shared_ptr<SnippetGroup> addGroup(SnippetGroups& groups, const std::u16string& name,
                                              const std::u16string& prefix = u"") {
    groups.push_back(SnippetGroup::make());
    groups.back()->setName(name);
    groups.back()->setAbbreviationPrefix(prefix);
    return groups.back();
}

inline std::shared_ptr<Snippet> addSnippet(SnippetGroup& group, const std::u16string& abbreviation,
                                           const std::u16string& content, const std::u16string& label = u"",
                                           ContentType type = ContentType::PlainText) {
    auto snippet = std::make_shared<Snippet>(abbreviation, content);
    snippet->setContentType(type);
    if (!label.empty()) snippet->setLabel(label);
    group.addItem(snippet);
    return snippet;
}

inline SnippetRow rowAt(const QAbstractItemModel& model, int row) {
    return model.index(row, 0).data(SnippetRow::Role).value<SnippetRow>();
}

// A key with what the keyboard calls it.
inline void pressKey(QWidget& field, int key, Qt::KeyboardModifiers modifiers, quint32 scanCode, const QString& text) {
    QKeyEvent press(QEvent::KeyPress, key, modifiers, scanCode, 0, 0, text);
    QCoreApplication::sendEvent(&field, &press);
}

// Light and dark, into the folder that PLUME_PICTURES names; the scale is QT_SCALE_FACTOR's.
inline void takePicture(QWidget& window, const QString& name) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    if (folder.isEmpty()) return;
    const QString scale = qEnvironmentVariableIsSet("QT_SCALE_FACTOR") ? QStringLiteral("-200") : QString();
    for (const bool isDark : {true, false}) {
        setColorScheme(isDark);
        QTest::qWait(20);
        window.grab().save(QDir(folder).filePath(name + (isDark ? "-dark" : "") + scale + ".png"));
    }
}

class RightToLeft {
  public:
    RightToLeft() { QGuiApplication::setLayoutDirection(Qt::RightToLeft); }
    ~RightToLeft() { QGuiApplication::setLayoutDirection(Qt::LeftToRight); }
    RightToLeft(const RightToLeft&) = delete;
    RightToLeft& operator=(const RightToLeft&) = delete;
};

}  // namespace plume::test
