// One form that the program for pages draws: tells it what the model says, as far as the page does not show that yet,
// and turns what it reports into events.
//
// On the main thread. Outlives the program's end, and does nothing then.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "app/FormModel.h"
#include "app/form/FormMessages.h"
#include "app/form/FormSurface.h"

namespace plume {

class PageForm final : public FormSurface {
  public:
    struct Program {
        std::function<void(const FormOrder& order)> send;
        // The form is not there any more.
        std::function<void()> forget;
    };

    // The model outlives it.
    PageForm(FormNumber number, const FormModel& model, Events events, Program program);
    ~PageForm() override { program_.forget(); }

    void show(const FormPlace& place) override;
    void update() override;
    std::optional<Size> size() const override { return size_; }

    // What the program says of this form. Not when that cannot be of it: there is no such field, for one. The form may
    // have ended when this returns.
    bool take(const FormReport& report);

  private:
    ShownField fieldNow(std::size_t index) const;
    bool isField(std::int64_t index) const;
    std::optional<std::u16string> takeValue(const FormFilled& report);

    bool heard(const FormShown& report);
    bool heard(const FormFilled& report);
    bool heard(const FormSelected& report);
    bool heard(const FormAccepted& report);
    bool heard(const FormCancelled& report);
    bool heard(const FormStayed& report);
    bool heard(const FormSized& report);

    const FormNumber number_;
    const FormModel& model_;
    const Events events_;
    const Program program_;
    std::vector<ShownField> shown_;  // what the page shows
    std::vector<bool> unreadable_;   // number fields in which no number stands
    QString length_;
    std::optional<Size> size_;
};

}  // namespace plume
