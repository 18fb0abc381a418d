// What the user sees at the first start: what Plume is, a place to try it, other libraries, and how it is started.
//
// On the main thread; owns itself, and is gone when it is closed.
#pragma once

#include <vector>

#include "app/windows/SmallWindow.h"
#include "app/windows/WelcomeServices.h"
#include "platform/UserDefaults.h"

class QCheckBox;
class QGridLayout;
class QLabel;
class QPlainTextEdit;
class QScrollArea;
class QVBoxLayout;

namespace plume {

class WelcomeWindow final : public SmallWindow {
    Q_OBJECT
  public:
    WelcomeWindow(WelcomeServices services, WritableUserDefaults& settings);
    ~WelcomeWindow() override;

  private:
    struct Trial {
        QString expansion;
        QLabel* tick;
        bool isDone = false;
    };

    void addIntroduction(QVBoxLayout& layout);
    void addTrials(QVBoxLayout& layout);
    void addTrial(QGridLayout& grid, const WelcomeServices::Trial& trial);
    void addFoundLibraries(QVBoxLayout& layout);
    void addFoundLibrary(QGridLayout& grid, const WelcomeServices::FoundLibrary& library);
    void addStart(QVBoxLayout& layout);
    void tickWhatAppeared();
    void setStartsAtLogin(bool starts);
    void lookForIcon();
    // Grows to what the page needs now.
    void makeRoom();

    const WelcomeServices services_;
    std::vector<Trial> trials_;
    QScrollArea* area_;
    QPlainTextEdit* field_ = nullptr;
    QLabel* allDone_ = nullptr;
    QCheckBox* startsAtLogin_ = nullptr;
    QLabel* noIcon_ = nullptr;
    int looksInVain_ = 0;
};

}  // namespace plume
