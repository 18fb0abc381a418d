// A library, a clipboard, a keyboard and a clock for the forms of placeholders and the menu that inserts them.
#pragma once

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPointer>
#include <QSpinBox>
#include <QWidget>
#include <chrono>
#include <string>
#include <vector>

#include "app/editor/ChipForm.h"
#include "app/qt/Text.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume::test {

struct ChipWorld {
    ChipWorld() {
        at.resize(400, 300);
        at.show();
        services.groups = [this]() -> const SnippetGroups& { return groups; };
        // A Monday.
        services.environment.now = [] {
            return Date(std::chrono::sys_days(std::chrono::year(2026) / 3 / 9)) + std::chrono::seconds(50706);
        };
        services.environment.timeZone = "UTC";
        services.environment.locale = "en_US";
        services.readClipboard = [this](const auto& told) { told(clipboard); };
        services.keyName = [](KeyCode key) { return key == KeyCode::K ? u"K" : u""; };
        services.beginRecordingKey = [this](auto pressed) { keyPressed = std::move(pressed); };
        services.endRecordingKey = [this] { keyPressed = nullptr; };
    }

    std::shared_ptr<Snippet> add(const std::u16string& abbreviation, const std::u16string& content,
                                 const std::u16string& label = u"") {
        if (groups.empty()) {
            groups.push_back(SnippetGroup::make());
            groups.back()->setName(u"Mail");
        }
        auto snippet = std::make_shared<Snippet>(abbreviation, content);
        if (!label.empty()) snippet->setLabel(label);
        groups.back()->addItem(snippet);
        return snippet;
    }

    ChipForm* open(const std::u16string& body) {
        done.reset();
        return ChipForm::open(&at, body, services, [this](const std::u16string& accepted) { done = accepted; });
    }

    QWidget at;
    SnippetGroups groups;
    std::optional<std::u16string> clipboard = u"a ab ba";
    std::function<void(const GeneralHotKey&)> keyPressed;  // null: nothing is recorded
    ChipFormServices services;
    std::optional<std::u16string> done;  // the body that was accepted
};

// Uses the control that is called so, as the user does.
inline void use(const QWidget& form, const QString& name, const QString& value) {
    auto& control = find<QWidget>(form, name);
    if (auto* tick = qobject_cast<QCheckBox*>(&control)) {
        tick->click();
    } else if (auto* number = qobject_cast<QSpinBox*>(&control)) {
        number->setValue(value.toInt());
    } else if (auto* decimal = qobject_cast<QDoubleSpinBox*>(&control)) {
        decimal->setValue(value.toDouble());
    } else if (auto* lines = qobject_cast<QPlainTextEdit*>(&control)) {
        lines->setPlainText(value);
    } else if (auto* line = qobject_cast<QLineEdit*>(&control)) {
        line->setText(value);
    } else if (auto* choice = qobject_cast<QComboBox*>(&control)) {
        const int place = choice->findText(value, Qt::MatchContains | Qt::MatchCaseSensitive);
        if (place < 0 && !choice->isEditable()) throw std::runtime_error("no choice " + value.toStdString());
        place < 0 ? choice->setEditText(value) : choice->setCurrentIndex(place);
        if (place >= 0) Q_EMIT choice->activated(place);
    } else {
        throw std::runtime_error(name.toStdString() + " is no control");
    }
}

}  // namespace plume::test
