// Contents with fields, and a form with an owner around it that has the rules and notes what the user does.
#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTest>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "app/FormModel.h"
#include "app/form/PlainFormWindow.h"
#include "app/qt/Text.h"
#include "content/SnippetExpandedContent.h"
#include "library/Snippet.h"

namespace plume::test {

// A content, written from its beginning to its end.
class Letter {
  public:
    Letter& text(const std::u16string& text) {
        content_.setContent(content_.string() + text);
        return *this;
    }
    Letter& field(const std::u16string& name, FieldType type = FieldType::Singleline,
                  const std::u16string& value = u"") {
        last_ = std::make_shared<SnippetFieldVariable>();
        last_->name = name;
        last_->type = type;
        last_->value = value;
        last_->location = content_.string().size();
        content_.variables.push_back(last_);
        return *this;
    }
    Letter& script(const std::u16string& name, const std::u16string& source, bool isOptional = false) {
        auto variable = std::make_shared<SnippetAbbreviationVariable>();
        variable->snippet = std::make_shared<Snippet>(name, source);
        variable->location = content_.string().size();
        variable->scriptLength = source.size();
        if (isOptional) {
            field(u"", FieldType::Singleline, name).optional(false).readonly();
            last_->script = variable;
        }
        content_.variables.push_back(std::move(variable));
        return text(source);
    }
    Letter& optional(bool isTicked = false) {
        last_->isOptional = true;
        last_->isSelected = isTicked;
        return *this;
    }
    Letter& readonly() {
        last_->isReadonly = true;
        return *this;
    }
    Letter& sized(std::int64_t width, std::int64_t height) {
        last_->setWidth(width);
        last_->setHeight(height);
        return *this;
    }
    const SnippetExpandedContent& content() const { return content_; }

  private:
    SnippetExpandedContent content_;
    std::shared_ptr<SnippetFieldVariable> last_;
};

// One of the kind that a business writes.
inline Letter businessLetter() {
    return Letter()
        .text(u"Dear ")
        .field(u"Salutation", FieldType::PopupMenu, u"Ms\nMr\nDr")
        .text(u" ")
        .field(u"Name")
        .sized(20, 0)
        .text(u",\n\nthank you for your order no. ")
        .field(u"Order", FieldType::Number, u"")
        .text(u" of last week. We are glad to tell you that it leaves our house today and reaches you within ")
        .field(u"days", FieldType::Number, u"3")
        .text(u" days; that makes ")
        .field(u"hours", FieldType::Number, u"days * 24")
        .text(u" hours.\n\n")
        .field(u"Remark", FieldType::Multiline, u"The parcel comes by post.\nPlease look it through at once.")
        .text(u"\n")
        .field(u"Discount", FieldType::Singleline, u"10 % on your next order")
        .optional()
        .text(u" ")
        .field(u"Gift", FieldType::Singleline, u"a small present")
        .optional(true)
        .text(u"\nToday's weather: ")
        .script(u"weather", u"curl wttr.in")
        .script(u"Joke of the day", u"fortune", true)
        .text(u"\n\nKind regards to ")
        .field(u"Name")
        .readonly()
        .text(u"\nAnn Example");
}

// What the owner of a form does, and a record of what it was told.
class FormOwner {
  public:
    explicit FormOwner(Letter letter) : letter_(std::move(letter)), model(letter_.content(), "en_US") {
        window = std::make_unique<PlainFormWindow>(
            model, letter_.content(), u"Order",
            FormSurface::Events{.shown = [this](std::uint32_t /*window*/) { note("shown"); },
                                .filled =
                                    [this](std::size_t field, const std::u16string& value) {
                                        note("filled " + std::to_string(field) + " " + toQString(value).toStdString());
                                        std::ignore = model.fill(field, value);
                                        window->update();
                                    },
                                .selected =
                                    [this](std::size_t field, bool selected) {
                                        note((selected ? "ticked " : "unticked ") + std::to_string(field));
                                        model.setSelected(field, selected);
                                        window->update();
                                    },
                                .accepted = [this] { end("accepted"); },
                                .cancelled = [this] { end("cancelled"); }});
    }

    void open(const FormPlace& place = {}) {
        window->show(place);
        if (!QTest::qWaitForWindowExposed(window.get())) throw std::runtime_error("the form is not shown");
        window->activateWindow();
        if (!QTest::qWaitForWindowActive(window.get())) throw std::runtime_error("the form does not become active");
        QCoreApplication::processEvents();
    }

    // What is called so and can be filled in; of fields of one name the n-th.
    template <typename Widget>
    Widget& find(const QString& name, int index = 0) const {
        for (Widget* each : window->findChildren<Widget*>()) {
            if (each->accessibleName() == name && index-- == 0) return *each;
        }
        throw std::runtime_error("nothing is called " + name.toStdString());
    }
    QLineEdit& line(const QString& name, int index = 0) const { return find<QLineEdit>(name, index); }
    QCheckBox& box(const QString& text) const {
        for (QCheckBox* each : window->findChildren<QCheckBox*>()) {
            if (each->text().remove(QLatin1Char('&')) == text) return *each;
        }
        throw std::runtime_error("no box is called " + text.toStdString());
    }

    // Where the keyboard is.
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = {}) const {
        QTest::keyClick(QApplication::focusWidget(), key, modifiers);
        QCoreApplication::processEvents();
    }
    void type(const QString& text) const {
        QTest::keyClicks(QApplication::focusWidget(), text);
        QCoreApplication::processEvents();
    }
    std::string focus() const {
        const QWidget* focused = QApplication::focusWidget();
        if (!focused) return {};
        const QString name = focused->accessibleName();
        return (name.isEmpty() ? focused->property("text").toString().remove(QLatin1Char('&')) : name).toStdString();
    }
    std::vector<std::string> takeNotes() { return std::exchange(notes_, {}); }

  private:
    Letter letter_;

  public:
    FormModel model;
    std::unique_ptr<PlainFormWindow> window;
    bool destroysAtEnd = true;

  private:
    void note(const std::string& what) { notes_.push_back(what); }
    void end(const std::string& how) {
        note(how);
        if (destroysAtEnd) window.reset();
    }

    std::vector<std::string> notes_;
};

}  // namespace plume::test
