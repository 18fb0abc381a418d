#include "app/form/helper/PageTemplate.h"

#include <QApplication>
#include <QCryptographicHash>
#include <QFile>
#include <QFontInfo>
#include <QPalette>
#include <array>

#include "app/form/helper/FormScheme.h"

namespace plume {

namespace {

// All that a page may run, besides the script that is put into it: what its controls call.
constexpr std::array Handlers = {"return handleKeyUpEvent(event);", "return handleKeyUpEventAlt(event);",
                                 "optionalFieldCheckboxOnChange(event);",
                                 "window.SnippetController.onTextInputOnChange_(event.target.id);"};

QString textOfResource(const char* name) {
    QFile file{QLatin1String(name)};
    return file.open(QIODevice::ReadOnly) ? QString::fromUtf8(file.readAll()) : QString();
}

QString policy() {
    QString handlers;
    for (const char* const handler : Handlers) {
        const QByteArray hash = QCryptographicHash::hash(handler, QCryptographicHash::Sha256).toBase64();
        handlers += QStringLiteral(" 'sha256-%1'").arg(QLatin1String(hash));
    }
    return QStringLiteral(
               "default-src 'none'; img-src data: %1:; style-src 'unsafe-inline'; base-uri 'none'; "
               "form-action 'none'; script-src 'unsafe-hashes'%2")
        .arg(QLatin1String(FormScheme::Name), handlers);
}

bool isDark(const QPalette& palette) {
    return palette.color(QPalette::Window).lightness() < palette.color(QPalette::WindowText).lightness();
}

// As much of `colour` as `share` says, in front of `ground`.
QString mixed(const QColor& colour, const QColor& ground, double share) {
    const auto part = [&](int in, int out) { return qRound(in * share + out * (1 - share)); };
    return QColor(part(colour.red(), ground.red()), part(colour.green(), ground.green()),
                  part(colour.blue(), ground.blue()))
        .name();
}

QString variable(const char* name, const QString& value) {
    return QStringLiteral("--%1:%2;").arg(QLatin1String(name), value);
}

QString fontVariables() {
    const QFont font = QApplication::font();
    QString family = font.family();
    family.remove(QLatin1Char('"')).remove(QLatin1Char('\\')).remove(QLatin1Char('<'));
    return variable("font", QStringLiteral("\"%1\", sans-serif").arg(family)) +
           variable("size", QStringLiteral("%1px").arg(QFontInfo(font).pixelSize()));
}

QString direction() {
    return QGuiApplication::layoutDirection() == Qt::RightToLeft ? QStringLiteral("rtl") : QStringLiteral("ltr");
}

}  // namespace

QByteArray pageOf(const PrepareForm& form) {
    static const QString frame = textOfResource(":/form/index.html");
    static const QString style = textOfResource(":/form/form.css");
    // What follows may hold what looks like a name here: the text comes last, and the template is filled from its
    // front.
    const QList<std::pair<QString, QString>> values = {
        {QStringLiteral("%LANGUAGE%"), QLocale().bcp47Name()},
        {QStringLiteral("%POLICY%"), policy()},
        {QStringLiteral("%TITLE%"), form.title.toHtmlEscaped()},
        {QStringLiteral("%STYLE%"), style},
        {QStringLiteral("%COLOURS%"), coloursOfPage()},
        {QStringLiteral("%GROUND%"), form.isPaper ? QStringLiteral("paper") : QString()},
        {QStringLiteral("<div>"), QStringLiteral("<div>") + form.page},
        {QStringLiteral("%DIRECTION%"), direction()},
        {QStringLiteral("%HINT%"), form.hint.toHtmlEscaped()},
        {QStringLiteral("%CANCEL%"), form.cancelLabel.toHtmlEscaped()},
        {QStringLiteral("%INSERT%"), form.insertLabel.toHtmlEscaped()}};
    QString page;
    QStringView rest = frame;
    for (const auto& [name, value] : values) {
        const qsizetype at = rest.indexOf(name);
        page += rest.first(at);
        page += value;
        rest = rest.sliced(at + name.size());
    }
    page += rest;
    return page.toUtf8();
}

QString coloursOfPage() {
    const QPalette palette = QApplication::palette();
    const bool dark = isDark(palette);
    const auto colour = [&](QPalette::ColorRole role) { return palette.color(role).name(); };
    const QColor window = palette.color(QPalette::Window);
    const QColor text = palette.color(QPalette::WindowText);
    const double ground = dark ? 0.32 : 0.2;
    return QStringLiteral(":root{") + variable("scheme", dark ? QStringLiteral("dark") : QStringLiteral("light")) +
           variable("window", window.name()) + variable("text", text.name()) +
           variable("field", colour(QPalette::Base)) + variable("fieldText", colour(QPalette::Text)) +
           variable("fieldLine", mixed(text, window, 0.45)) + variable("line", mixed(text, window, 0.18)) +
           variable("placeholder", colour(QPalette::PlaceholderText)) + variable("faint", mixed(text, window, 0.75)) +
           variable("accent", colour(QPalette::Highlight)) + variable("link", colour(QPalette::Link)) +
           variable("used", mixed(QColor(QStringLiteral("limegreen")), window, ground)) +
           variable("unused", mixed(QColor(QStringLiteral("crimson")), window, ground)) +
           variable("problem", dark ? QStringLiteral("#ff9a9a") : QStringLiteral("#a3161c")) + fontVariables() +
           QLatin1Char('}');
}

QString scriptOfPage() {
    return QStringLiteral("(function () {\"use strict\";\n") + textOfResource(":/qtwebchannel/qwebchannel.js") +
           textOfResource(":/form/form.js") + QStringLiteral("})();");
}

}  // namespace plume
