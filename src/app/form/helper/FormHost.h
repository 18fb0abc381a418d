// The forms that Plume wants drawn, by number, and what becomes of them.
//
// On the main thread; owned by main(). Ends the program when no form has been wanted for ten minutes.
#pragma once

#include <QObject>
#include <QTimer>
#include <map>
#include <memory>

#include "app/form/FormMessages.h"
#include "app/form/helper/HostPipe.h"
#include "app/form/helper/PageProfile.h"
#include "app/form/helper/PageWindow.h"

namespace plume {

class FormHost final : public QObject {
    Q_OBJECT
  public:
    // The pipe outlives it.
    explicit FormHost(HostPipe& pipe);

  private:
    void take(const FormOrder& order);
    void take(const PrepareForm& order);
    void take(const ShowForm& order);
    void take(const UpdateForm& order);
    void take(const CloseForm& order);
    PageWindow* windowOf(FormNumber form) const;
    void closeWindow(FormNumber form);

    HostPipe& pipe_;
    PageProfile profile_;
    std::map<FormNumber, std::unique_ptr<PageWindow>> windows_;
    std::unique_ptr<PageWindow> last_;  // closed and hidden: what draws pages lives as long as one is there
    QTimer idle_;
};

}  // namespace plume
