// The forms that are open: has each drawn as a page, or in a window of plain controls where pages cannot be drawn, and
// keeps what the user fills in, whatever becomes of the drawing.
//
// On the main thread; whoever puts the application together owns it. The settings outlive it.
#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <string>

#include "app/FormModel.h"
#include "app/FormView.h"
#include "app/form/FormProcess.h"
#include "app/form/FormSurface.h"
#include "app/form/UnsentTextWindow.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"

namespace plume {

class FormWindows final : public FormView {
  public:
    struct Services {
        RunLoop& mainLoop;
        // How large the user made the form of each snippet.
        WritableUserDefaults& settings;
        // The program that draws pages; it need not be there.
        std::filesystem::path program;
        // That program runs, with this process number, or does not: 0.
        std::function<void(std::int64_t process)> programRuns;
        // Tells the user, in one sentence.
        std::function<void(const std::string& sentence)> report;
    };

    explicit FormWindows(Services services);
    ~FormWindows() override;

    void prepare(Id id, std::shared_ptr<SnippetExpandedContent> content, Events events) override;
    void show(Id id, const CaretPlace& place) override;
    void close(Id id) override { forms_.erase(id); }
    void keepUnsent(Id id, const std::string& reason) override;

  private:
    struct OpenForm {
        std::shared_ptr<SnippetExpandedContent> content;
        Events events;
        std::unique_ptr<FormModel> model;
        std::unique_ptr<FormSurface> surface;
        bool isDone = false;  // accepted or cancelled: it is drawn no more
        bool isPage = false;
        std::optional<CaretPlace> place;  // where it was asked for; nothing: not yet
        int losses = 0;                   // of pages
        std::unique_ptr<UnsentTextWindow> unsent;
        Timer limit;
    };

    bool drawsPages();
    void makeSurface(Id id, OpenForm& form);
    FormSurface::Events eventsOf(Id id);
    void showSurface(OpenForm& form);
    void shown(OpenForm& form, std::uint32_t window);
    static void filled(OpenForm& form, std::size_t field, const std::u16string& value);
    void accepted(OpenForm& form);
    void cancelled(OpenForm& form);
    static void end(OpenForm& form);
    void keepSize(const OpenForm& form, const std::optional<Size>& size);
    void tellPlain(const std::string& reason);
    void pagesLost(const std::string& reason);
    void reopen();

    const Services services_;
    FormProcess process_;
    int failures_ = 0;  // of the program, one after the other
    bool toldPlain_ = false;
    Timer reopening_;
    std::map<Id, OpenForm> forms_;
};

// The key under which the size of a snippet's form is kept.
std::string formSizeKey(const Snippet& snippet);

}  // namespace plume
