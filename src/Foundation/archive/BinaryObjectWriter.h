// Writes binary property lists object by object.
//
// Every value is given a number, by which arrays and dictionaries refer to it; a value equal to one that was written
// before, with the same parts, is that one. One of these, one thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace plume {

class BinaryObjectWriter {
  public:
    using Number = std::uint32_t;
    using Entry = std::pair<Number, Number>;  // key and value

    BinaryObjectWriter();

    Number boolean(bool value);
    Number integer(std::int64_t value);
    Number real(double value);
    // Seconds since 2001.
    Number date(double seconds);
    Number data(std::string_view bytes);
    Number string(std::u16string_view text);
    Number ascii(std::string_view text);
    Number uid(std::uint64_t uid);
    Number array(const std::vector<Number>& elements);
    Number dictionary(const Entry* entries, std::size_t count);

    std::size_t count() const { return starts_.size(); }
    // The finished list whose outermost value is this one.
    std::string finish(Number root) const;

  private:
    void begin() { start_ = objects_.size(); }
    void put(unsigned byte) { objects_.push_back(static_cast<char>(byte)); }
    void putNumber(std::uint64_t number, std::size_t size);
    void putCount(unsigned marker, std::size_t count);
    void putReal(unsigned marker, double value);
    Number end();
    void grow();
    void appendObject(std::string& bytes, std::size_t index, std::size_t referenceSize) const;

    // The objects as they will be, but with references of four bytes.
    std::string objects_;
    std::vector<std::size_t> starts_;
    std::size_t start_ = 0;  // of the object that is being put
    // Where to look for an equal object: a table open to the next place, of numbers + 1; 0 is free.
    std::vector<Number> table_;
    std::vector<std::uint32_t> hashes_;  // of the objects
};

}  // namespace plume
