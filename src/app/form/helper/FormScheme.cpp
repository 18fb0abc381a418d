#include "app/form/helper/FormScheme.h"

#include <QBuffer>
#include <QFile>
#include <QWebEngineUrlRequestJob>
#include <QWebEngineUrlScheme>
#include <utility>

namespace plume {

namespace {

void answer(QWebEngineUrlRequestJob& request, const QByteArray& type, const QByteArray& bytes) {
    auto* const body = new QBuffer(&request);
    body->setData(bytes);
    request.reply(type, body);
}

QByteArray scriptIcon() {
    QFile file(QStringLiteral(":/form/Script.png"));
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

}  // namespace

void FormScheme::announce() {
    QWebEngineUrlScheme scheme(Name);
    scheme.setSyntax(QWebEngineUrlScheme::Syntax::Host);
    scheme.setFlags(QWebEngineUrlScheme::SecureScheme);
    QWebEngineUrlScheme::registerScheme(scheme);
}

QUrl FormScheme::addressOf(FormNumber form) {
    return {QStringLiteral("%1://form/%2").arg(QLatin1String(Name)).arg(form)};
}

void FormScheme::setPage(FormNumber form, QByteArray html) {
    pages_[addressOf(form).path()] = std::move(html);
}

void FormScheme::requestStarted(QWebEngineUrlRequestJob* request) {
    const QString path = request->requestUrl().path();
    if (path == QLatin1String("/Script.png")) return answer(*request, "image/png", scriptIcon());
    if (!pages_.contains(path)) return request->fail(QWebEngineUrlRequestJob::UrlNotFound);
    answer(*request, "text/html", pages_.take(path));
}

}  // namespace plume
