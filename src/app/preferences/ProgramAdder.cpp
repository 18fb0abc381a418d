#include "app/preferences/ProgramAdder.h"

#include <QInputDialog>
#include <QMenu>
#include <QPointer>
#include <algorithm>

#include "Foundation/Strings.h"
#include "app/preferences/ProgramCatalog.h"
#include "app/preferences/ProgramChooser.h"
#include "app/qt/Text.h"

namespace plume {

ProgramAdder::ProgramAdder(const ProgramServices& services, ProgramCatalog& programs, QWidget* parent)
    : QPushButton(tr("Add"), parent), services_(services), programs_(programs) {
    setAccessibleName(tr("Add a program"));
    auto* menu = new QMenu(this);
    menu->addAction(tr("&Running Program…"), this, &ProgramAdder::chooseRunning);
    menu->addAction(tr("&Installed Program…"), this, &ProgramAdder::chooseInstalled);
    menu->addAction(tr("&Point at a Window…"), this, &ProgramAdder::pointAtWindow);
    menu->addSeparator();
    menu->addAction(tr("&Type an Identifier…"), this, &ProgramAdder::typeIdentifier);
    setMenu(menu);
}

ProgramChooser* ProgramAdder::openChooser(const QString& title) {
    Q_EMIT told({});
    auto* chooser = new ProgramChooser(title, programs_, window());
    connect(chooser, &ProgramChooser::chosen, this, &ProgramAdder::chosen);
    chooser->open();
    return chooser;
}

void ProgramAdder::chooseRunning() {
    const QPointer<ProgramChooser> chooser = openChooser(tr("Running Programs"));
    const QPointer<ProgramAdder> self(this);
    services_.runningPrograms([self, chooser](const std::vector<RunningApplication>& running) {
        if (!self || !chooser) return;
        Identifiers identifiers;
        for (const RunningApplication& program : running) {
            const std::u16string identifier = program.bundleIdentifier.value_or(u"");
            const bool isThere = std::find(identifiers.begin(), identifiers.end(), identifier) != identifiers.end();
            if (identifier.empty() || isThere) continue;
            self->programs_.learn(identifier, program.localizedName.value_or(u""));
            identifiers.push_back(identifier);
        }
        chooser->setPrograms(identifiers);
    });
}

void ProgramAdder::chooseInstalled() {
    Identifiers identifiers;
    for (const InstalledProgram& program : programs_.installed()) identifiers.push_back(program.identifier);
    openChooser(tr("Installed Programs"))->setPrograms(identifiers);
}

void ProgramAdder::pointAtWindow() {
    Q_EMIT told(tr("Click in a window of the program within 20 seconds."));
    const QPointer<ProgramAdder> self(this);
    services_.nextFrontProgram([self](const std::optional<RunningApplication>& program) {
        if (!self) return;
        if (!program || program->bundleIdentifier.value_or(u"").empty()) {
            Q_EMIT self->told(tr("No window of another program was clicked."));
            return;
        }
        self->programs_.learn(*program->bundleIdentifier, program->localizedName.value_or(u""));
        Q_EMIT self->told({});
        Q_EMIT self->chosen({*program->bundleIdentifier});
    });
}

void ProgramAdder::typeIdentifier() {
    Q_EMIT told({});
    auto* dialog = new QInputDialog(window());
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setWindowTitle(tr("Add a Program"));
    dialog->setLabelText(
        tr("Identifier of the program: the name of its desktop file without “.desktop”, or its window class"));
    dialog->setOkButtonText(tr("&Add Program"));
    dialog->setCancelButtonText(tr("&Cancel"));
    connect(dialog, &QInputDialog::textValueSelected, this, [this](const QString& text) {
        const std::u16string identifier(trimmed(fromQString(text)));
        if (!identifier.empty()) Q_EMIT chosen({identifier});
    });
    dialog->open();
}

}  // namespace plume
