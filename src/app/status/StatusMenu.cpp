#include "app/status/StatusMenu.h"

#include <QAction>
#include <QApplication>
#include <QFontInfo>
#include <QTimer>
#include <algorithm>

#include "app/qt/Text.h"
#include "app/status/SnippetRowsMenu.h"

namespace plume {

namespace {

constexpr qsizetype TitleLimit = 50;
constexpr double SmallestFont = 6;

bool isShown(const std::shared_ptr<SnippetGroup>& group) {
    return group && group->showInMenuBar();
}

QString titleOf(const SnippetGroup& group, MenuHome home) {
    QString name = harmlessLine(group.name().value_or(u""), TitleLimit);
    if (name.isEmpty()) name = StatusMenu::tr("Untitled group");
    return asMenuText(name, home);
}

}  // namespace

StatusMenu::StatusMenu(StatusMenuServices services, MenuHome home) : services_(std::move(services)), home_(home) {
    addStatusRows();
    addSeparator();
    afterGroups_ = addSeparator();
    addSnippetRows();
    addSeparator();
    addOtherRows();
    addSeparator();
    addRow(*this, tr("&Quit Plume"), services_.quit);
    showStatus();
    connect(this, &QMenu::aboutToShow, this, &StatusMenu::prepare);
    // A panel asks for the rows before it tells that it shows them.
    if (home_ == MenuHome::Bus) prepare();
}

void StatusMenu::setStatus(const Status& status) {
    status_ = status;
    showStatus();
}

void StatusMenu::addStatusRows() {
    enabled_ = addRow(*this, tr("&Enabled"), [this] {
        services_.toggleEnabled();
        showStatus();
    });
    enabled_->setCheckable(true);
    secureInput_ = addAction(QString());
    secureInput_->setEnabled(false);
    listenAgain_ = addRow(*this, tr("&Listen to the Keyboard Again"), services_.tryKeyboardAgain);
}

void StatusMenu::addSnippetRows() {
    addRow(*this, tr("&New Snippet…"), services_.newSnippet);
    addRow(*this, tr("New Snippet from &Clipboard…"), services_.makeSnippetFromClipboard);
    addRow(*this, tr("New Snippet from &Selection…"), services_.makeSnippetFromSelection);
    if (services_.searchSnippets) addRow(*this, tr("Searc&h Snippets…"), services_.searchSnippets);
    if (services_.showMacrosWindow) addRow(*this, tr("E&dit Snippets…"), services_.showMacrosWindow);
}

void StatusMenu::addOtherRows() {
    addRow(*this, tr("&Preferences…"), services_.showPreferences);
    QMenu& help = *addMenu(tr("Help and &Tools"));
    addRow(help, tr("&Why Didn't It Expand?"), services_.showDecisions);
    addRow(help, tr("&Reports"), services_.showReports);
    addRow(help, tr("&Diagnostics…"), services_.showDiagnostics);
    addRow(help, tr("W&elcome…"), services_.showWelcome);
    addRow(help, tr("&About Plume"), services_.showAbout);
    QMenu& library = *addMenu(tr("Li&brary"));
    addRow(library, tr("&Import…"), services_.importFile);
    addRow(library, tr("&Export…"), services_.exportLibrary);
    addRow(library, tr("&Restore…"), services_.restore);
}

QAction* StatusMenu::addRow(QMenu& menu, const QString& text, const std::function<void()>& act) {
    QAction* row = menu.addAction(text);
    connect(row, &QAction::triggered, this, [this, act] { whenGone(act, 0); });
    return row;
}

void StatusMenu::showStatus() {
    enabled_->setChecked(status_.isEnabled);
    secureInput_->setText(asMenuText(toQString(status_.secureInputStatus), home_));
    secureInput_->setVisible(status_.secureInput);
    listenAgain_->setVisible(status_.keyboardIsLost);
}

void StatusMenu::prepare() {
    // A panel's click on a row names the row that it was sent: rows that are right stay.
    if (!hasGroupsOfNow()) addGroupsOfNow();
    for (const Group& group : groups_) group.menu->expire();
    afterGroups_->setVisible(!groups_.empty());
    setFontSize();
}

bool StatusMenu::hasGroupsOfNow() const {
    auto shown = groups_.begin();
    for (const auto& group : services_.groups()) {
        if (!isShown(group)) continue;
        if (shown == groups_.end() || shown->group.lock() != group || shown->title != titleOf(*group, home_))
            return false;
        ++shown;
    }
    return shown == groups_.end();
}

void StatusMenu::addGroupsOfNow() {
    for (const Group& group : groups_) delete group.menu;
    groups_.clear();
    const auto choose = [this](const std::weak_ptr<Snippet>& chosen) {
        // Nobody tells when a panel's menu is gone.
        constexpr int PanelDelay = 100;
        whenGone([this, chosen] { send(chosen); }, home_ == MenuHome::Bus ? PanelDelay : 0);
    };
    for (const auto& group : services_.groups()) {
        if (!isShown(group)) continue;
        auto* menu = new SnippetRowsMenu({group}, home_, choose, this);
        groups_.push_back({titleOf(*group, home_), group, menu});
        menu->setTitle(groups_.back().title);
        insertMenu(afterGroups_, menu);
    }
}

void StatusMenu::setFontSize() {
    QFont menuFont = QApplication::font("QMenu");
    const auto delta = static_cast<double>(services_.fontSizeDelta());
    if (delta != 0) menuFont.setPointSizeF(std::max(QFontInfo(menuFont).pointSizeF() + delta, SmallestFont));
    setFont(menuFont);
    for (auto* menu : findChildren<QMenu*>()) menu->setFont(menuFont);
}

void StatusMenu::whenGone(std::function<void()> act, int delay) {
    auto* wait = new QTimer(this);
    wait->setSingleShot(true);
    connect(wait, &QTimer::timeout, this, [this, wait, act = std::move(act)] {
        constexpr int StillOpen = 20;
        wait->deleteLater();
        if (QApplication::activePopupWidget() != nullptr) {
            whenGone(act, StillOpen);
        } else {
            act();
        }
    });
    wait->start(delay);
}

void StatusMenu::send(const std::weak_ptr<Snippet>& chosen) {
    if (const auto snippet = chosen.lock()) services_.sendSnippetDirectly(snippet);
}

}  // namespace plume
