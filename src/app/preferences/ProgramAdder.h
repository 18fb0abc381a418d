// A button by which programs are named: running and installed ones, one that is pointed at, or an identifier by hand.
//
// Main thread. Answers that come when it is gone are dropped.
#pragma once

#include <QPushButton>
#include <string>
#include <vector>

#include "app/preferences/ProgramServices.h"

namespace plume {

class ProgramCatalog;
class ProgramChooser;

class ProgramAdder final : public QPushButton {
    Q_OBJECT
  public:
    using Identifiers = std::vector<std::u16string>;

    // Both outlive it.
    ProgramAdder(const ProgramServices& services, ProgramCatalog& programs, QWidget* parent = nullptr);

  Q_SIGNALS:
    void chosen(const Identifiers& identifiers);
    // What the user is to do now, or what came of it; an empty text: nothing any more.
    void told(const QString& words);

  private:
    void chooseRunning();
    void chooseInstalled();
    void pointAtWindow();
    void typeIdentifier();
    ProgramChooser* openChooser(const QString& title);

    const ProgramServices& services_;
    ProgramCatalog& programs_;
};

}  // namespace plume
