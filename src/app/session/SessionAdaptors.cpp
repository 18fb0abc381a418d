#include "app/session/SessionAdaptors.h"

#include <QUrl>

namespace plume {

namespace {

std::vector<std::string> wordsOf(const char* command, const QStringList& files) {
    std::vector<std::string> words{command};
    for (const QString& file : files) {
        const QUrl url(file);
        words.push_back((url.isLocalFile() ? url.toLocalFile() : file).toStdString());
    }
    return words;
}

// What went wrong is the caller's to hear, what was said is the answer.
QString answerOf(const CommandReply& reply) {
    return QString::fromStdString(reply.status == 0 ? reply.output : reply.error).trimmed();
}

}  // namespace

void LauncherAdaptor::Activate(const QVariantMap& /*platformData*/) {
    service_.perform({"show"});
}

void LauncherAdaptor::Open(const QStringList& uris, const QVariantMap& /*platformData*/) {
    service_.perform(wordsOf("open", uris));
}

void LauncherAdaptor::ActivateAction(const QString& name, const QVariantList& /*parameters*/,
                                     const QVariantMap& /*platformData*/) {
    const std::string action = name.toStdString();
    const bool isCommand = action == "toggle" || action == "quick-search";
    service_.perform(isCommand ? std::vector<std::string>{action} : std::vector<std::string>{"show", action});
}

QString PlumeAdaptor::Import(const QStringList& files) {
    return answerOf(service_.perform(wordsOf("import", files)));
}

QString PlumeAdaptor::Export(const QString& file) {
    return answerOf(service_.perform(wordsOf("export", {file})));
}

QString PlumeAdaptor::State() {
    return answerOf(service_.perform({"status", "--json"}));
}

QString PlumeAdaptor::Version() {
    return answerOf(service_.perform({"--version"}));
}

}  // namespace plume
