// A universally unique identifier.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace plume {

class Uuid {
  public:
    // A fresh random one (version 4).
    static Uuid random();
    // The canonical form (8-4-4-4-12 hexadecimal digits, either case), or nullopt.
    static std::optional<Uuid> parse(std::u16string_view text);

    // The canonical upper-case form.
    std::u16string toString() const;

    bool operator==(const Uuid&) const = default;
    auto operator<=>(const Uuid&) const = default;

  private:
    explicit Uuid(const std::array<std::uint8_t, 16>& bytes) : bytes_(bytes) {}
    std::array<std::uint8_t, 16> bytes_;
};

}  // namespace plume
