#include "app/editor/ClipboardForm.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QPointer>
#include <chrono>
#include <utility>

#include "app/FirstLine.h"
#include "app/editor/FormControls.h"
#include "app/qt/Text.h"
#include "app/search/SnippetRow.h"
#include "content/ClipboardReplacement.h"
#include "content/PatternReplacement.h"

namespace plume {

namespace {

using Matching = SnippetClipboardVariable::MatchingOption;

constexpr auto PatienceWithPatterns = std::chrono::milliseconds(50);
constexpr std::size_t MostTried = 20'000;  // units of the clipboard's text

std::optional<std::u16string> unlessEmpty(std::u16string text) {
    return text.empty() ? std::nullopt : std::optional(std::move(text));
}

}  // namespace

ClipboardForm::ClipboardForm(ChipFormServices services, std::shared_ptr<SnippetClipboardVariable> variable)
    : ChipForm(tr("Clipboard"), std::move(services), variable), variable_(std::move(variable)) {
    addReplacementRows();
    addMatchingRows();
    addOptionalRow();
    readClipboard();
}

void ClipboardForm::addReplacementRows() {
    rows().addRow(tr("&Find:"), makeLine(variable_->find, [this](std::u16string text) {
                      variable_->find = unlessEmpty(std::move(text));
                      changed();
                  }));
    rows().addRow(tr("&Replace with:"), makeLine(variable_->replacement, [this](std::u16string text) {
                      variable_->replacement = unlessEmpty(std::move(text));
                      changed();
                  }));
}

void ClipboardForm::addMatchingRows() {
    const auto number = [](Matching option) { return static_cast<std::int64_t>(option); };
    const Choices options{{number(Matching::Anywhere), tr("Anywhere")},
                          {number(Matching::WordStart), tr("At the start of words")},
                          {number(Matching::WholeWord), tr("Whole words")},
                          {number(Matching::WordEnd), tr("At the end of words")}};
    QComboBox* option = makeChoice(options, number(variable_->matchingOption), {}, [this](std::int64_t chosen) {
        variable_->matchingOption = static_cast<Matching>(chosen);
        changed();
    });
    option->setEnabled(!variable_->regularExpressions);
    QCheckBox* matchCase = makeTick(tr("Capitals and &small letters differ"), variable_->matchCase, [this](bool isOn) {
        variable_->matchCase = isOn;
        changed();
    });
    QCheckBox* pattern = makeTick(tr("Is a regular e&xpression; $1 is its first group"), variable_->regularExpressions,
                                  [this, option](bool isOn) {
                                      variable_->regularExpressions = isOn;
                                      option->setEnabled(!isOn);
                                      changed();
                                  });
    rows().addRow(tr("F&ound:"), option);
    rows().addRow(QString(), matchCase);
    rows().addRow(QString(), pattern);
}

void ClipboardForm::readClipboard() {
    if (!services().readClipboard) return;
    services().readClipboard([form = QPointer(this)](const std::optional<std::u16string>& text) {
        if (!form) return;
        form->clipboard_ = text ? std::optional(text->substr(0, MostTried)) : std::nullopt;
        form->showValue();
    });
}

ChipForm::Shown ClipboardForm::shown() const {
    const bool replaces = !variable_->find.value_or(u"").empty();
    const std::u16string content = clipboard_.value_or(u"");
    const auto deadline = std::chrono::steady_clock::now() + PatienceWithPatterns;
    const auto goOn = [](Range /*match*/, const std::u16string& /*replacement*/) { return true; };
    if (replaces && usesPattern(*variable_) && !visitMatches(*variable_, content, deadline, goOn).empty()) {
        return {{},
                tr("What is to be found is no valid pattern, or takes too long. The clipboard's text stays as it is.")};
    }
    if (!clipboard_) return {tr("There is no text in the clipboard now."), {}};
    std::chrono::nanoseconds timeLeft = PatienceWithPatterns;
    const std::u16string result = processClipboardVariable(*variable_, content, services().environment, timeLeft);
    return {tr("Gives: %1").arg(inOneLine(firstLine(result))), {}};
}

}  // namespace plume
