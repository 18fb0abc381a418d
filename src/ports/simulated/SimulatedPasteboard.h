// A pasteboard in memory.
#pragma once

#include <utility>

#include "platform/Pasteboard.h"

namespace plume {

class SimulatedPasteboard final : public Pasteboard {
  public:
    // What happens when a program other than Plume copies: its types and bytes, in order, or a plain text.
    void copyFromProgram(const std::vector<std::pair<std::string, std::string>>& contents);
    void copyFromProgram(std::u16string_view text);

    // Promised content is asked for now, and once.
    std::vector<std::string> types() const override;
    std::optional<std::u16string> string() const override;
    std::optional<std::string> data(std::string_view type) const override;

    std::int64_t changeCount() const override { return changeCount_; }
    bool tellsWhenTaken() const override { return false; }
    void paste(std::function<void()> sendKeystroke) override { sendKeystroke(); }
    bool isPasteAwaited() const override { return false; }
    std::int64_t declareTypes(const std::vector<std::string>& types, PasteboardOwner* owner) override;
    // Only for declared types.
    void setString(std::u16string_view string, std::string_view type) override;
    void setData(std::string_view bytes, std::string_view type) override;

  private:
    struct Item {
        std::string type;
        std::optional<std::u16string> text;  // as written; its bytes are UTF-8
        std::optional<std::string> bytes;
    };
    Item* itemOf(std::string_view type);
    const Item* redeemed(std::string_view type) const;

    std::vector<Item> items_;
    PasteboardOwner* owner_ = nullptr;
    std::int64_t changeCount_ = 0;
};

}  // namespace plume
