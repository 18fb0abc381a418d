#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QFontDialog>
#include <QHBoxLayout>
#include <QPushButton>
#include <QSignalBlocker>

#include "Foundation/Strings.h"
#include "app/preferences/PreferencesPages.h"
#include "app/preferences/SettingControls.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

constexpr const char* Sound = "FeedbackSound";
constexpr const char* EditorFont = "DefaultSnippetEditorFont";
constexpr const char* FontName = "NSFontNameAttribute";
constexpr const char* FontSize = "NSFontSizeAttribute";
constexpr double UsualFontSize = 12;

class GeneralPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(GeneralPage)
  public:
    explicit GeneralPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Plume"));
        addCheckBox("IsEnabled", tr("&Expand abbreviations"));
        addStartAtLogin();
        addCheckBox("ShowStatusIcon", tr("Show the &icon in the panel"),
                    tr("Its menu leads to everything that Plume can do."));
        addHeading(tr("Sound"));
        addCheckBox("PlayFeedbackSound", tr("&Play a sound with every expansion"));
        addSound();
        addHeading(tr("Text"));
        const auto unit = [](int count) { return count == 1 ? tr(" point") : tr(" points", "", count); };
        addNumber("FontSizeDelta", tr("&Larger text in lists:"), {-4, 24, unit},
                  tr("How much larger than usual lists and menus are written."));
        addFont();
    }

  private:
    void addStartAtLogin() {
        auto* box = new QCheckBox(tr("&Start Plume when I log in"));
        addWide(box->text(), box);
        box->setChecked(services().startsAtLogin && services().startsAtLogin());
        connect(box, &QCheckBox::toggled, this, [this, box](bool on) {
            const auto done = services().setStartsAtLogin(on);
            complain(done ? QString() : tr("This could not be kept. %1").arg(inUsersLanguage(done.error().message)));
            const QSignalBlocker quiet(box);
            box->setChecked(services().startsAtLogin());
        });
    }

    void addSound() {
        auto* both = new QWidget;
        auto* box = new QComboBox;
        auto* test = new QPushButton(tr("&Test"));
        test->setAccessibleName(tr("Test the sound"));
        ignoreWheelWithoutFocus(*box);
        box->setAccessibleName(tr("Sound"));
        for (const std::string& name : services().soundNames) box->addItem(QString::fromStdString(name));
        auto* row = new QHBoxLayout(both);
        row->setContentsMargins(0, 0, 0, 0);
        row->addWidget(box);
        row->addWidget(test);
        both->setFocusProxy(box);
        addField(tr("So&und:"), both, {}, {QLatin1String(Sound)});
        bind(Sound, [this, box] {
            const QSignalBlocker quiet(box);
            const QString name = toQString(settings().stringForKey(Sound).value_or(u""));
            box->setPlaceholderText(name);
            box->setCurrentIndex(box->findText(name));
        });
        connect(box, &QComboBox::textActivated, this, [this](const QString& name) {
            if (write(Sound, fromQString(name))) services().playSound(name.toStdString());
        });
        connect(test, &QPushButton::clicked, this,
                [this] { services().playSound(toUtf8(settings().stringForKey(Sound).value_or(u""))); });
    }

    QFont editorFont() const {
        const auto value = settings().objectForKey(EditorFont);
        const auto* name = value ? value->find<std::u16string>(FontName) : nullptr;
        const auto* size = value ? value->find<double>(FontSize) : nullptr;
        QFont font(name ? toQString(*name) : QStringLiteral("Helvetica"));
        font.setPointSizeF(size && *size > 0 ? *size : UsualFontSize);
        return font;
    }

    void addFont() {
        auto* button = new QPushButton;
        addField(tr("&Font of new snippets:"), button, {}, {QLatin1String(EditorFont)});
        bind(EditorFont, [this, button] {
            const QFont font = editorFont();
            button->setText(tr("%1, %2 points…").arg(font.family()).arg(font.pointSizeF()));
            button->setAccessibleName(tr("Font of new snippets: %1").arg(button->text()));
        });
        connect(button, &QPushButton::clicked, this, &GeneralPage::chooseFont);
    }

    void chooseFont() {
        auto* dialog = new QFontDialog(editorFont(), window());
        dialog->setAttribute(Qt::WA_DeleteOnClose);
        dialog->setWindowTitle(tr("Font of New Snippets"));
        connect(dialog, &QFontDialog::fontSelected, this, [this](const QFont& font) {
            write(EditorFont,
                  PropertyList::Dictionary{{FontName, fromQString(font.family())}, {FontSize, font.pointSizeF()}});
        });
        dialog->open();
    }
};

}  // namespace

PreferencesPage* makeGeneralPage(const PreferencesPage::Around& around) {
    return new GeneralPage(around);
}

}  // namespace plume
