// Puts an expansion on the clipboard as promised data, remembers what was there, and puts that back once the target has
// read the expansion.
//
// Owned by the input service for its whole life; runs on the tap thread, its delayed restores on that thread's run
// loop. Where the pasteboard tells when content was taken, what was there comes back restoreDelay after that, or 1.8 s
// after the paste if nobody takes the expansion. Elsewhere content that nobody reads stays, and the restore tries again
// every restoreDelay.
#pragma once

#include <cstdint>
#include <functional>
#include <limits>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "platform/Pasteboard.h"
#include "platform/RunLoop.h"

namespace plume {

class ClipboardDataProvider final : public PasteboardOwner {
  public:
    ClipboardDataProvider(Pasteboard& pasteboard, RunLoop& runLoop);
    ClipboardDataProvider(const ClipboardDataProvider&) = delete;
    ClipboardDataProvider& operator=(const ClipboardDataProvider&) = delete;

    bool includeHTMLData = false;      // offer HTML besides RTFD and RTF for rich content
    bool excludeParagraphTag = false;  // and that without paragraph elements
    double restoreDelay = 0.3;         // seconds
    // The program in front has taken the expansion; called inside the pasteboard's own call. Only where that tells.
    std::function<void()> onTaken;

    // The keystroke that pastes was sent.
    void wasPasted();
    void setString(std::u16string string);
    void setAttributedString(AttributedString string);

    // Remembers the clipboard's content, unless it is this provider's own.
    void backup();
    // Promises the remembered content again, or tries again later when somebody may still read the expansion. Does
    // nothing when the clipboard holds something newer than the expansion.
    void restore();
    void restoreAfterDelay();
    // Whether a restore was pending.
    bool cancelRestore();
    bool isRestoring() const { return pendingRestore_ || provideBackupData_; }

    // The clipboard holds the expansion, and the user's own content is the remembered one.
    bool isOffering() const;
    // The remembered content by type, in the clipboard's order; nothing when none was remembered.
    const std::optional<std::vector<std::string>>& backupTypes() const { return types_; }
    std::optional<std::string> backupDataForType(std::string_view type) const;

    void provideData(Pasteboard& pasteboard, std::string_view type) override;
    void dataWasTaken(std::string_view type) override;

  private:
    void prepareSetData();
    void provideExpansion(Pasteboard& pasteboard, std::string_view type) const;

    Pasteboard& pasteboard_;
    RunLoop& runLoop_;
    std::optional<std::u16string> stringData_;
    std::optional<AttributedString> attributedStringData_;
    std::int64_t changeCount_ = std::numeric_limits<std::int64_t>::max();
    std::map<std::string, std::string, std::less<>> backupData_;
    std::optional<std::vector<std::string>> types_;
    std::int64_t backupChangeCount_ = 0;  // the clipboard's when the content was remembered
    bool providedData_ = false;           // the expansion was read
    bool restoresWhenTaken_ = false;      // a restore waits for that
    double pasted_ = 0;                   // when its keystroke was sent, or it was offered
    bool provideBackupData_ = false;
    Timer pendingRestore_;
};

// What clipboard placeholders read: the clipboard, or, while an expansion stands there, the user's remembered content.
class UserPasteboard final : public PasteboardReader {
  public:
    UserPasteboard(const Pasteboard& pasteboard, const ClipboardDataProvider& provider)
        : pasteboard_(pasteboard), provider_(provider) {}

    std::vector<std::string> types() const override;
    std::optional<std::u16string> string() const override;
    std::optional<std::string> data(std::string_view type) const override;

  private:
    const Pasteboard& pasteboard_;
    const ClipboardDataProvider& provider_;
};

}  // namespace plume
