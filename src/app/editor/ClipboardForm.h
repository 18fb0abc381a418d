// The form of the clipboard's content: what is replaced in it.
//
// On the main thread; owns itself as every form does.
#pragma once

#include "app/editor/ChipForm.h"
#include "content/SnippetClipboardVariable.h"

namespace plume {

class ClipboardForm final : public ChipForm {
    Q_OBJECT
  public:
    ClipboardForm(ChipFormServices services, std::shared_ptr<SnippetClipboardVariable> variable);

  protected:
    Shown shown() const override;

  private:
    void addReplacementRows();
    void addMatchingRows();
    void readClipboard();

    const std::shared_ptr<SnippetClipboardVariable> variable_;
    std::optional<std::u16string> clipboard_;  // nothing: it is not known yet, or holds no text
};

}  // namespace plume
