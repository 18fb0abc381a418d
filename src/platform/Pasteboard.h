// The general pasteboard.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

// Names of the pasteboard types that Plume itself reads and writes; other types are kept as they are.
namespace PasteboardType {
inline constexpr std::string_view String = "NSStringPboardType";
inline constexpr std::string_view RTF = "NSRTFPboardType";
inline constexpr std::string_view RTFD = "NSRTFDPboardType";
}  // namespace PasteboardType

// The reading side: what placeholders need. Never waits long for the owner of the content: an owner that does not
// answer offers nothing.
class PasteboardReader {
  public:
    virtual ~PasteboardReader() = default;
    virtual std::vector<std::string> types() const = 0;
    virtual std::optional<std::u16string> string() const = 0;
    virtual std::optional<std::string> data(std::string_view type) const = 0;
};

}  // namespace plume
