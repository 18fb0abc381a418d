// The program that draws forms as pages, `plume-form`, from this program's side: started when it is first needed, and
// spoken to in lines of JSON.
//
// On the main thread; outlives the forms that it makes. What it says is taken for what a stranger might say.
#pragma once

#include <QObject>
#include <QProcess>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <string>

#include "app/FormModel.h"
#include "app/form/FormMessages.h"
#include "app/form/FormSurface.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

class PageForm;

class FormProcess final : public QObject {
    Q_OBJECT
  public:
    struct Listener {
        // It runs, with this process number, or has ended: 0.
        std::function<void(std::int64_t process)> runs;
        // It has ended while forms were open, or before it was ready: the forms that it drew are gone, and are to be
        // destroyed. `reason` is for the log and the user.
        std::function<void(const std::string& reason)> lost;
    };

    FormProcess(std::filesystem::path program, Listener listener);
    ~FormProcess() override;

    // The program is installed.
    bool exists() const;
    // What the form needs of the program is begun; the page follows when that is there. The model and the content
    // outlive the form.
    std::unique_ptr<FormSurface> makeForm(const FormModel& model, const SnippetExpandedContent& content,
                                          const std::u16string& title, FormSurface::Events events);
    // Ends the program, with all its forms: one that does not answer. The listener has been told that they are lost
    // when this returns.
    void kill();

  private:
    // It leaves unread what is sent to it.
    Q_SIGNAL void overflowed(const QObject* process);

    void start();
    void endDeaf(const QObject* process);
    void send(const FormOrder& order);
    void hear();
    void take(const FormReport& report);
    void ended(QProcess::ExitStatus status, int code);
    void end(const std::string& reason);

    const std::filesystem::path program_;
    const Listener listener_;
    QProcess* process_ = nullptr;  // none runs: null
    MessageLines lines_;
    bool isReady_ = false;
    FormNumber lastForm_ = 0;
    std::map<FormNumber, PageForm*> forms_;  // which the program draws
};

}  // namespace plume
