#include <QCheckBox>
#include <QCoreApplication>
#include <QPushButton>

#include "app/preferences/PreferencesPages.h"
#include "app/qt/Sentences.h"

namespace plume {

namespace {

// Fields that are searched; others are for versions to come.
constexpr std::int64_t Abbreviation = 1;
constexpr std::int64_t Content = 2;
constexpr std::int64_t Label = 4;
constexpr std::int64_t Fields = Abbreviation | Content | Label;

class SearchPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(SearchPage)
  public:
    explicit SearchPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Lists at the caret"));
        addChoice("SnippetSelectorKeyModifier", tr("&Key held to pick with a digit:"),
                  {{0, tr("None")}, {1, tr("Shift")}, {2, tr("Control")}, {3, tr("Alt")}, {4, tr("Super")}},
                  tr("In suggestions and in quick search, the digits 1 to 9 pick a snippet while this key is held, "
                     "and 0 picks the tenth."));
        addCheckBox("SuggestAutomatically", tr("&Suggest snippets while I type"),
                    tr("A list comes up by itself after a pause in an abbreviation of which two letters are typed. "
                       "Return takes its selected snippet, Esc closes it."));
        addHeading(tr("Quick search looks in"));
        addFields("SnippetQuickSearchSearchBy", {tr("&Abbreviations"), tr("&Contents"), tr("&Labels")});
        addBit("SnippetQuickSearchWildcardSearch", 1, tr("&Wildcards in quick search"),
               tr("* stands for any text, and ? for any character."));
        addHeading(tr("Quick search"));
        addCheckBox("SnippetQuickSearchBeginsWithTyped", tr("Be&gin with the word before the caret"),
                    tr("The snippet that is chosen takes its place then."));
        addCheckBox("RememberSnippetUses", tr("Show often &used snippets first"),
                    tr("How often each snippet is used is kept on this computer, never what was searched for."));
        addForgetButton();
        addHeading(tr("The snippets window looks in"));
        addFields("MainWindowSearchBy", {tr("A&bbreviations"), tr("C&ontents"), tr("Lab&els")});
        addBit("WildcardSearch", 1, tr("Wildcards in the snippets w&indow"), {});
    }

  protected:
    void showEvent(QShowEvent* event) override {
        forget_->setEnabled(true);
        PreferencesPage::showEvent(event);
    }

  private:
    struct Labels {
        QString abbreviation;
        QString content;
        QString label;
    };

    void addFields(const char* key, const Labels& labels) {
        addSearched(key, Abbreviation, labels.abbreviation);
        addSearched(key, Content, labels.content);
        addSearched(key, Label, labels.label);
    }

    void addForgetButton() {
        forget_ = new QPushButton(tr("&Forget How Often Snippets Were Used"));
        addWide(tr("Forget How Often Snippets Were Used"), forget_);
        connect(forget_, &QPushButton::clicked, this, [this] {
            const Result<void> forgotten = services().forgetSnippetUses();
            complain(forgotten ? QString() : inUsersLanguage(forgotten.error().message));
            // That it is done is seen.
            forget_->setEnabled(!forgotten);
        });
    }

    // A search that looks nowhere would find nothing: the last field stays.
    void addSearched(const char* key, std::int64_t bit, const QString& label) {
        QCheckBox* box = addBit(key, bit, label);
        bind(key, [this, key, bit, box] {
            const bool isLast = (settings().integerForKey(key) & Fields) == bit;
            box->setEnabled(!isLast);
            box->setToolTip(isLast ? tr("At least one is needed.") : QString());
        });
    }

    QPushButton* forget_ = nullptr;
};

}  // namespace

PreferencesPage* makeSearchPage(const PreferencesPage::Around& around) {
    return new SearchPage(around);
}

}  // namespace plume
