#include <QCoreApplication>

#include "Foundation/Strings.h"
#include "app/preferences/PreferencesPages.h"
#include "app/preferences/SettingControls.h"
#include "library/PLFunctionAvailability.h"

namespace plume {

namespace {

constexpr const char* LayoutOption = "AutoCorrectInputMethodsOption";
constexpr const char* Layouts = "AutoCorrectInputMethods";

class CorrectionPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(CorrectionPage)
  public:
    explicit CorrectionPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Sentences"));
        addCheckBox("CapitalizeNewSentences", tr("Begin every &sentence with a capital"));
        addLines("CapitalizationExcludedAbbreviations", tr("&No sentence ends with:"), tr("One in each line."));
        addHeading(tr("Words"));
        addCheckBox("CorrectDoubleCapitals", tr("Correct &two capitals at the start of a word"));
        addLines("DoubleCapitalsCorrectionExclusion", tr("&Leave these words:"), tr("One in each line."));
        addHeading(tr("Where"));
        addAvailability("AutoCorrectIn", "AutoCorrectApplications", tr("&Correct:"));
        addLayouts();
    }

  private:
    void addLayouts() {
        addChoice(LayoutOption, tr("&Keyboard layouts:"),
                  {{PLFunctionAvailability::Everywhere, tr("With all layouts")},
                   {PLFunctionAvailability::ExceptListed, tr("With all layouts except those below")},
                   {PLFunctionAvailability::OnlyListed, tr("Only with the layouts below")}});
        auto* lines = new LinesEdit;
        addField(tr("Layo&uts:"), lines, tr("One in each line, like “us”, “de(nodeadkeys)” or “ibus:libpinyin”."),
                 {QLatin1String(Layouts)});
        bind(Layouts, [this, lines] { lines->showText(layouts()); });
        bind(LayoutOption, [this, lines] {
            lines->setEnabled(settings().integerForKey(LayoutOption) != PLFunctionAvailability::Everywhere);
        });
        connect(lines, &LinesEdit::edited, this, [this](const std::u16string& text) { keepLayouts(text); });
    }

    std::u16string layouts() const {
        std::u16string text;
        for (const std::u16string& layout :
             settings().stringArrayForKey(Layouts).value_or(std::vector<std::u16string>())) {
            if (!text.empty()) text += u'\n';
            text += layout;
        }
        return text;
    }

    void keepLayouts(const std::u16string& text) {
        PropertyList::Array layouts;
        for (const std::u16string& line : split(text, u'\n')) {
            if (const std::u16string layout(trimmed(line)); !layout.empty()) layouts.emplace_back(layout);
        }
        write(Layouts, std::move(layouts));
    }
};

}  // namespace

PreferencesPage* makeCorrectionPage(const PreferencesPage::Around& around) {
    return new CorrectionPage(around);
}

}  // namespace plume
