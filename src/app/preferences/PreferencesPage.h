// A page of the settings window: rows of controls, each of which shows a setting and changes it at once.
//
// A page is made from the top down in its constructor. Controls follow their settings, whoever changes them; what
// cannot be kept is told, and the control goes back to what holds. Main thread; the window owns it.
#pragma once

#include <QStringList>
#include <QWidget>
#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "app/preferences/PreferencesServices.h"
#include "app/preferences/ProgramCatalog.h"

class QCheckBox;
class QComboBox;
class QDoubleSpinBox;
class QFormLayout;
class QLabel;
class QSpinBox;

namespace plume {

class ApplicationList;
class LinesEdit;

class PreferencesPage : public QWidget {
    Q_OBJECT
  public:
    // What it refers to outlives the page.
    struct Around {
        const PreferencesServices& services;
        ProgramCatalog& programs;
        // Shows what went wrong; an empty text takes it away again.
        std::function<void(const QString&)> complain;
    };
    // What can be found by a search.
    struct Row {
        QString label;
        QString help;
        QStringList keys;
        QWidget* control;  // gets the focus
    };
    using Keys = std::vector<std::string>;

    explicit PreferencesPage(Around around);

    const std::vector<Row>& rows() const { return rows_; }
    // The settings that "Restore Defaults" gives up.
    const Keys& ownKeys() const { return ownKeys_; }
    virtual void restoreDefaults();
    // Keeps what was typed last. Before the page goes.
    void finish();
    // Shows these settings as they are now.
    virtual void follow(const Keys& keys);

  protected:
    using Choices = std::vector<std::pair<std::int64_t, QString>>;
    struct Numbers {
        int least;
        int most;
        std::function<QString(int)> unit;  // what follows each of them
    };

    const PreferencesServices& services() const { return around_.services; }
    WritableUserDefaults& settings() const { return around_.services.settings; }
    ProgramCatalog& programs() const { return around_.programs; }
    void complain(const QString& reason) const { around_.complain(reason); }
    // False when it could not be kept, which has been told then.
    bool write(std::string_view key, PropertyList value);
    bool giveUp(std::string_view key);

    // ---- From the top down ----
    void addHeading(const QString& text);
    // Words between the rows; theirs can change.
    QLabel* addNote(const QString& text);
    QCheckBox* addCheckBox(const char* key, const QString& label, const QString& help = {});
    // A bit of a whole number.
    QCheckBox* addBit(const char* key, std::int64_t bit, const QString& label, const QString& help = {});
    QComboBox* addChoice(const char* key, const QString& label, const Choices& choices, const QString& help = {});
    QSpinBox* addNumber(const char* key, const QString& label, const Numbers& numbers, const QString& help = {});
    QDoubleSpinBox* addSeconds(const char* key, const QString& label, double most, const QString& help = {});
    LinesEdit* addLines(const char* key, const QString& label, const QString& help = {});
    // In which programs something is done: everywhere, except in those of a list, only there.
    ApplicationList* addAvailability(const char* optionKey, const char* listKey, const QString& label);
    // Other controls, with a label before them, or over the page's whole width.
    void addField(const QString& label, QWidget* field, const QString& help = {}, const QStringList& keys = {});
    void addWide(const QString& label, QWidget* field, const QString& help = {}, const QStringList& keys = {});
    // The rest of the page.
    void addFilling(const QString& label, QWidget* field, const QStringList& keys = {});

    // `show` shows the setting: now, and whenever it has changed.
    void bind(const char* key, std::function<void()> show);

  private:
    static QWidget* withHelp(QWidget* field, const QString& help, int indent);
    void remember(const QString& label, QWidget* field, const QString& help, const QStringList& keys);
    void showAgain(std::string_view key);

    const Around around_;
    QFormLayout* form_;
    std::vector<Row> rows_;
    Keys ownKeys_;
    std::vector<std::pair<std::string, std::function<void()>>> shows_;
};

}  // namespace plume
