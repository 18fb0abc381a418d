#include "app/form/FormWindows.h"

#include <QClipboard>
#include <QGuiApplication>
#include <array>
#include <charconv>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"
#include "app/form/PlainFormWindow.h"
#include "app/qt/Text.h"
#include "library/Snippet.h"

namespace plume {

namespace {

// Seconds until a form that does not come is drawn in another way: what is typed for it waits so long.
constexpr double LongestDrawing = 2.5;
// After so many failures nobody waits for another one.
constexpr int MostFailures = 3;
// A page that was lost so often comes back as a window of plain controls.
constexpr int MostLosses = 2;
constexpr double SmallestSide = 100;
constexpr double LargestSide = 10'000;

// "{420, 260}"
std::u16string sizeString(const Size& size) {
    return fromUtf8("{" + std::to_string(static_cast<int>(size.width)) + ", " +
                    std::to_string(static_cast<int>(size.height)) + "}");
}

std::optional<Size> sizeFrom(std::string_view text) {
    std::array<double, 2> sides{};
    std::size_t at = 0;
    for (double& side : sides) {
        at = text.find_first_of("0123456789", at);
        if (at == std::string_view::npos) return std::nullopt;
        const auto [end, error] = std::from_chars(text.data() + at, text.data() + text.size(), side);
        if (error != std::errc() || side < SmallestSide || side > LargestSide) return std::nullopt;
        at = static_cast<std::size_t>(end - text.data());
    }
    return Size{sides[0], sides[1]};
}

std::u16string titleOf(const SnippetExpandedContent& content) {
    const std::u16string label = content.originalSnippet->label().value_or(u"");
    return label.empty() ? content.originalSnippet->abbreviation().value_or(u"") : label;
}

}  // namespace

std::string formSizeKey(const Snippet& snippet) {
    return "FieldsEditorSize " + toUtf8(snippet.abbreviation().value_or(u""));
}

FormWindows::FormWindows(Services services)
    : services_(std::move(services)),
      process_(services_.program,
               {.runs = services_.programRuns, .lost = [this](const std::string& reason) { pagesLost(reason); }}) {}

FormWindows::~FormWindows() = default;

bool FormWindows::drawsPages() {
    if (services_.settings.boolForKey("PlainForms")) return false;
    if (!process_.exists()) tellPlain("the program plume-form is not installed.");
    return process_.exists() && failures_ < MostFailures;
}

void FormWindows::prepare(Id id, std::shared_ptr<SnippetExpandedContent> content, Events events) {
    OpenForm& form = forms_[id];
    form.content = std::move(content);
    form.events = std::move(events);
    form.model = std::make_unique<FormModel>(*form.content, std::string());
    makeSurface(id, form);
}

void FormWindows::makeSurface(Id id, OpenForm& form) {
    const std::u16string title = titleOf(*form.content);
    form.isPage = drawsPages() && form.losses < MostLosses;
    if (form.isPage) {
        form.surface = process_.makeForm(*form.model, *form.content, title, eventsOf(id));
    } else {
        form.surface = std::make_unique<PlainFormWindow>(*form.model, *form.content, title, eventsOf(id));
    }
}

void FormWindows::tellPlain(const std::string& reason) {
    if (std::exchange(toldPlain_, true)) return;
    services_.report("A form is shown as a plain window, because no page can be drawn: " + reason);
}

FormSurface::Events FormWindows::eventsOf(Id id) {
    const auto onForm = [this, id](auto call) {
        if (const auto form = forms_.find(id); form != forms_.end()) call(form->second);
    };
    return {.shown = [this, onForm](
                         std::uint32_t window) { onForm([this, window](OpenForm& form) { shown(form, window); }); },
            .filled =
                [onForm](std::size_t field, const std::u16string& value) {
                    onForm([field, &value](OpenForm& form) { filled(form, field, value); });
                },
            .selected =
                [onForm](std::size_t field, bool selected) {
                    onForm([field, selected](OpenForm& form) {
                        form.model->setSelected(field, selected);
                        form.surface->update();
                    });
                },
            .accepted = [this, onForm] { onForm([this](OpenForm& form) { accepted(form); }); },
            .cancelled = [this, onForm] { onForm([this](OpenForm& form) { cancelled(form); }); },
            .stayed = [onForm] { onForm([](const OpenForm& form) { form.events.stayed(); }); }};
}

void FormWindows::show(Id id, const CaretPlace& place) {
    const auto form = forms_.find(id);
    if (form == forms_.end()) return;
    form->second.place = place;
    showSurface(form->second);
}

void FormWindows::showSurface(OpenForm& form) {
    if (form.isPage) {
        form.limit = services_.mainLoop.performAfterDelay(LongestDrawing, [this] { process_.kill(); });
    }
    const auto size = services_.settings.stringForKey(formSizeKey(*form.content->originalSnippet));
    form.surface->show({*form.place, size ? sizeFrom(toUtf8(*size)) : std::nullopt});
}

void FormWindows::shown(OpenForm& form, std::uint32_t window) {
    form.limit.cancel();
    if (form.isPage) failures_ = 0;
    form.events.shown(window);
}

void FormWindows::filled(OpenForm& form, std::size_t field, const std::u16string& value) {
    // A page may say anything.
    if (field >= form.model->fields().size()) return;
    static_cast<void>(form.model->fill(field, value));
    form.surface->update();
}

void FormWindows::accepted(OpenForm& form) {
    form.model->accept();
    const std::optional<Size> size = form.surface->size();
    end(form);
    form.events.accepted();
    // Last: it is written to the disk.
    keepSize(form, size);
}

void FormWindows::cancelled(OpenForm& form) {
    const std::optional<Size> size = form.surface->size();
    end(form);
    form.events.cancelled();
    keepSize(form, size);
}

void FormWindows::end(OpenForm& form) {
    form.isDone = true;
    form.surface = nullptr;
    form.limit.cancel();
}

void FormWindows::keepSize(const OpenForm& form, const std::optional<Size>& size) {
    const std::string key = formSizeKey(*form.content->originalSnippet);
    const auto value = size ? std::optional(sizeString(*size)) : std::nullopt;
    if (!value || services_.settings.stringForKey(key) == value) return;
    if (const auto kept = services_.settings.setObject(key, PropertyList(*value)); !kept) {
        services_.report(kept.error().message);
    }
}

void FormWindows::pagesLost(const std::string& reason) {
    for (auto& [id, form] : forms_) {
        if (!form.isPage || !form.surface) continue;
        if (++form.losses == MostLosses) tellPlain(reason);
        form.limit.cancel();
        form.surface = nullptr;
        form.events.lost();
    }
    if (++failures_ == MostFailures) tellPlain(reason);
    reopening_ = services_.mainLoop.performAfterDelay(0, [this] { reopen(); });
}

// With what had been typed into them: that is the model's.
void FormWindows::reopen() {
    for (auto& [id, form] : forms_) {
        if (form.surface || form.isDone) continue;
        makeSurface(id, form);
        if (form.place) showSurface(form);
    }
}

void FormWindows::keepUnsent(Id id, const std::string& reason) {
    const auto found = forms_.find(id);
    if (found == forms_.end()) return;
    OpenForm& form = found->second;
    const auto end = [this, id](void (*then)(const Events&)) {
        const auto open = forms_.find(id);
        if (open == forms_.end() || !open->second.unsent) return;
        open->second.unsent->hide();
        // It is calling.
        open->second.unsent.release()->deleteLater();
        then(open->second.events);
    };
    const std::u16string text = form.model->text();
    form.unsent = std::make_unique<UnsentTextWindow>(
        text, reason,
        UnsentTextWindow::Actions{.copy = [text] { QGuiApplication::clipboard()->setText(toQString(text)); },
                                  .tryAgain = [end] { end([](const Events& events) { events.accepted(); }); },
                                  .drop = [end] { end([](const Events& events) { events.cancelled(); }); }});
    form.unsent->show();
}

}  // namespace plume
