#include "app/form/FormProcess.h"

#include <QAccessible>
#include <algorithm>
#include <system_error>
#include <utility>

#include "app/form/FormPage.h"
#include "app/form/FormWords.h"
#include "app/form/PageForm.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// What a program that does not read may leave unread.
constexpr qint64 MostUnread = 2 * MessageLines::LongestLine;
constexpr int LastWait = 1000;  // milliseconds

}  // namespace

FormProcess::FormProcess(std::filesystem::path program, Listener listener)
    : program_(std::move(program)), listener_(std::move(listener)) {
    // Not from inside of what is being sent.
    connect(this, &FormProcess::overflowed, this, &FormProcess::endDeaf, Qt::QueuedConnection);
}

FormProcess::~FormProcess() {
    // Those too that have been ended and are not gone yet.
    for (QProcess* const each : findChildren<QProcess*>()) {
        each->disconnect(this);
        each->kill();
        each->waitForFinished(LastWait);
    }
}

bool FormProcess::exists() const {
    std::error_code ignored;
    return std::filesystem::is_regular_file(program_, ignored);
}

std::unique_ptr<FormSurface> FormProcess::makeForm(const FormModel& model, const SnippetExpandedContent& content,
                                                   const std::u16string& title, FormSurface::Events events) {
    // The program starts while the page is written.
    if (!process_) start();
    const FormNumber number = ++lastForm_;
    PageForm::Program program{.send =
                                  [this, number](const FormOrder& order) {
                                      if (forms_.contains(number)) send(order);
                                  },
                              .forget =
                                  [this, number] {
                                      if (forms_.erase(number) != 0) send(CloseForm{number});
                                  }};
    auto form = std::make_unique<PageForm>(number, model, std::move(events), std::move(program));
    forms_[number] = form.get();
    send(PrepareForm{number, QString::fromStdString(FormPage::generateHtml(content, model)), toQString(title),
                     FormPage::needsPaper(content), hintLine(model), insertLabel(), cancelLabel()});
    form->update();
    return form;
}

void FormProcess::kill() {
    end("The program that draws forms does not answer.");
}

// ---- The program ----

// Nothing is reported from in here: makeForm() has not returned yet.
void FormProcess::start() {
    lines_ = {};
    isReady_ = false;
    process_ = new QProcess(this);
    QProcess* const process = process_;
    connect(process, &QProcess::started, this, [this] {
        if (listener_.runs) listener_.runs(process_->processId());
    });
    connect(process, &QProcess::readyReadStandardOutput, this, &FormProcess::hear);
    connect(process, &QProcess::finished, this, [this](int code, QProcess::ExitStatus status) { ended(status, code); });
    connect(
        process, &QProcess::errorOccurred, process,
        [this, process](QProcess::ProcessError error) {
            if (process != process_) return;
            if (error == QProcess::FailedToStart) end("The program that draws forms cannot be started.");
            if (error == QProcess::WriteError) end("The program that draws forms does not listen.");
        },
        Qt::QueuedConnection);
    // What it complains of may hold what was typed.
    process->setStandardErrorFile(QProcess::nullDevice());
    // Pages tell of their parts only where somebody asks, because that costs time.
    const QStringList arguments = QAccessible::isActive() ? QStringList{"--accessible"} : QStringList();
    process->start(QString::fromStdString(program_.string()), arguments);
}

void FormProcess::send(const FormOrder& order) {
    if (!process_) return;
    const QByteArray line = lineOf(order);
    if (line.size() <= MessageLines::LongestLine && process_->bytesToWrite() + line.size() <= MostUnread) {
        process_->write(line);
        return;
    }
    Q_EMIT overflowed(process_);
}

void FormProcess::endDeaf(const QObject* process) {
    if (process == process_) end("The program that draws forms does not listen.");
}

void FormProcess::hear() {
    QProcess* const process = process_;
    lines_.append(process->readAllStandardOutput());
    // What a listener does may end the program, and start it anew.
    while (process == process_) {
        const auto line = lines_.next();
        if (!line) break;
        const auto report = reportIn(*line);
        if (!report) return end("The program that draws forms says what cannot be.");
        take(*report);
    }
    if (process == process_ && lines_.isTooLong()) end("The program that draws forms says what cannot be.");
}

void FormProcess::take(const FormReport& report) {
    QProcess* const process = process_;
    if (std::holds_alternative<FormsReady>(report)) {
        isReady_ = true;
        return;
    }
    const FormNumber number = std::visit(
        [](const auto& each) -> FormNumber {
            if constexpr (requires { each.form; }) return each.form;
            return 0;
        },
        report);
    // It may not have heard yet that the form was closed.
    const auto found = forms_.find(number);
    if (found == forms_.end()) return;
    const bool isRight = isReady_ && found->second->take(report);
    if (!isRight && process == process_) end("The program that draws forms says what cannot be.");
}

void FormProcess::ended(QProcess::ExitStatus status, int code) {
    // What it said last counts; what it says may have been that a form was accepted.
    QProcess* const process = process_;
    hear();
    if (process != process_) return;
    end(status == QProcess::CrashExit ? "The program that draws forms has crashed."
                                      : "The program that draws forms has ended with " + std::to_string(code) + ".");
}

void FormProcess::end(const std::string& reason) {
    if (!process_) return;
    QProcess* const process = std::exchange(process_, nullptr);
    process->disconnect(this);
    if (process->state() == QProcess::NotRunning) {
        process->deleteLater();
    } else {
        // It ends soon, and is not waited for here.
        connect(process, &QProcess::finished, process, &QObject::deleteLater);
        process->kill();
    }
    const bool isLoss = !isReady_ || !forms_.empty();
    forms_.clear();
    if (listener_.runs) listener_.runs(0);
    if (isLoss && listener_.lost) listener_.lost(reason);
}

}  // namespace plume
