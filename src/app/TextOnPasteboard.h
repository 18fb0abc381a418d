// A clipboard that holds one text, or nothing: for contents that are shown or tried.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/Pasteboard.h"

namespace plume {

class TextOnPasteboard final : public PasteboardReader {
  public:
    explicit TextOnPasteboard(std::optional<std::u16string> text) : text_(std::move(text)) {}

    std::vector<std::string> types() const override {
        return text_ ? std::vector<std::string>{std::string(PasteboardType::String)} : std::vector<std::string>{};
    }
    std::optional<std::u16string> string() const override { return text_; }
    std::optional<std::string> data(std::string_view /*type*/) const override { return std::nullopt; }

  private:
    const std::optional<std::u16string> text_;
};

}  // namespace plume
