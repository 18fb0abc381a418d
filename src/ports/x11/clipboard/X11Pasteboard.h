// The general pasteboard on X11: the CLIPBOARD selection.
//
// Belongs to the tap thread. Reading what another program offers waits for that program, 0.3 s for a first answer and
// one second in all; a program that has not answered is not asked again until the clipboard changes. The session's
// heartbeat is called meanwhile, and the tap's keys wait unread.
//
// What another program offers is told under the program's own names, and under a name of PasteboardType in front of the
// first one that holds it. Content that is given back under all these names offers exactly what it offered before.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "platform/Pasteboard.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/SharedClipboardCopy.h"
#include "ports/x11/clipboard/X11PasteTarget.h"
#include "ports/x11/clipboard/X11PasteboardContent.h"
#include "ports/x11/clipboard/X11SelectionOwner.h"
#include "ports/x11/clipboard/X11SelectionReader.h"
#include "ports/x11/clipboard/X11SelectionTransfers.h"
#include "ports/x11/clipboard/X11TargetsQuestions.h"

namespace plume {

class X11Pasteboard final : public Pasteboard {
  public:
    // The error says what the server lacks. The session outlives the pasteboard.
    static Result<std::unique_ptr<X11Pasteboard>> open(X11Session& session);
    ~X11Pasteboard() override;
    X11Pasteboard(const X11Pasteboard&) = delete;
    X11Pasteboard& operator=(const X11Pasteboard&) = delete;

    // Keeps what is read of other programs' content, as long as it is the newest. Outlives the pasteboard.
    void setSharedCopy(SharedClipboardCopy* copy) { sharedCopy_ = copy; }
    // Offers what another Plume read before it ended. Nobody must hold the clipboard.
    void offer(const std::vector<SharedClipboardCopy::Entry>& entries);
    // Somebody else has put something on the clipboard.
    std::function<void()> ownershipLost;
    // Whether anybody holds the clipboard.
    bool isHeld() const;

    std::vector<std::string> types() const override;
    std::optional<std::u16string> string() const override;
    std::optional<std::string> data(std::string_view type) const override;
    std::int64_t changeCount() const override;
    bool tellsWhenTaken() const override { return true; }
    std::int64_t declareTypes(const std::vector<std::string>& types, PasteboardOwner* owner) override;
    // The PRIMARY selection: the text that was selected before returns with the clipboard's content.
    void setPastesPrimary(bool pastesPrimary) override { pastesPrimary_ = pastesPrimary; }
    void setString(std::u16string_view string, std::string_view type) override;
    void setData(std::string_view bytes, std::string_view type) override;
    void paste(std::function<void()> sendKeystroke) override;
    bool isPasteAwaited() const override { return target_.isAwaited(); }

    // Whether what was declared last stands on the clipboard, for the server too: a paste will find it.
    bool isOffering() const;
    // Before Plume ends: leaves what it offers to a clipboard manager, if there is one; takes at most 0.5 s. What is
    // only promised for one paste is not left.
    void handOver();

  private:
    explicit X11Pasteboard(X11Session& session);
    void noteChange(bool ours);
    void offerPrimary();
    std::shared_ptr<X11PasteboardContent> selectedText();
    void connectOwners();
    bool mayBePasting(xcb_window_t requestor) const;
    void hintForAMoment();
    void keepForTarget();
    std::shared_ptr<X11PasteboardContent> contentBeforeFor(xcb_window_t requestor, xcb_atom_t target);
    std::shared_ptr<X11PasteboardContent> contentBefore();

    X11Session& session_;
    SharedClipboardCopy* sharedCopy_ = nullptr;
    bool pastesPrimary_ = false;
    std::int64_t changeCount_ = 0;
    std::int64_t declaredCount_ = 0;  // of the last declaration
    // What programs gave along with their data: a backup of it is given back alike.
    mutable X11ValueForms forms_;
    const std::unique_ptr<X11SelectionTransfers> transfers_;
    const std::unique_ptr<X11SelectionReader> reader_;  // of the clipboard
    const std::unique_ptr<X11SelectionReader> primaryReader_;
    std::unique_ptr<X11SelectionOwner> clipboard_;
    std::unique_ptr<X11SelectionOwner> primary_;
    Timer hintsEnd_;
    X11PasteTarget target_;
    X11TargetsQuestions questions_;
    std::shared_ptr<X11PasteboardContent> content_;      // what was declared last
    std::shared_ptr<X11PasteboardContent> lateContent_;  // what the target of the last paste is still to have
    // Clients that have asked for a hint, and at which change of the clipboard they first did.
    std::map<xcb_window_t, std::int64_t> managers_;
    std::shared_ptr<X11PasteboardContent> contentBefore_;   // what the user had there, once somebody has asked for it
    std::shared_ptr<X11PasteboardContent> selectedBefore_;  // what PRIMARY held before an expansion was offered there
};

}  // namespace plume
