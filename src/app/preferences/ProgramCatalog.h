// What programs are called and look like, by their identifiers.
//
// Asks for the installed programs when it is first needed, which takes a moment. Main thread; the window owns it.
#pragma once

#include <QIcon>
#include <QString>
#include <map>
#include <string>
#include <vector>

#include "app/preferences/ProgramServices.h"

namespace plume {

class ProgramCatalog {
  public:
    // The services outlive it.
    explicit ProgramCatalog(const ProgramServices& services) : services_(services) {}

    const std::vector<InstalledProgram>& installed();
    // The identifier itself when nobody knows it. Letter case makes no difference.
    QString nameOf(const std::u16string& identifier);
    // A plain one when there is no other.
    QIcon iconOf(const std::u16string& identifier);
    // A running program told its name, which counts where it is not installed.
    void learn(const std::u16string& identifier, const std::u16string& name);

  private:
    const InstalledProgram* find(const std::u16string& identifier);

    const ProgramServices& services_;
    bool isAsked_ = false;
    std::vector<InstalledProgram> installed_;
    std::map<std::u16string, std::size_t> places_;
    std::map<std::u16string, std::u16string> learnt_;
};

}  // namespace plume
