// YAML read into plain values, with the place of each, and with bounds on what a file may ask for.
#pragma once

#include <cstddef>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace plume {

// what() is the sentence for the user: "base.yml: line 3, column 5: expected …". Does not leave the importers.
class YamlError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

// Immutable; aliases share what they stand for.
class YamlValue {
  public:
    enum class Kind { Null, Scalar, List, Map };
    using Pointer = std::shared_ptr<const YamlValue>;

    Kind kind = Kind::Null;
    std::string text;  // of a scalar, UTF-8
    std::vector<Pointer> items;
    std::vector<std::pair<std::string, Pointer>> members;  // in the file's order, no key twice
    std::size_t line = 1;
    std::size_t column = 1;
    std::shared_ptr<const std::string> fileName;

    // A key that is missing and one without a value are the same: null.
    const YamlValue* find(std::string_view key) const;
    // These throw YamlError when the value is of another kind.
    std::string string() const;
    bool boolean() const;
    std::int64_t integer() const;
    const std::vector<Pointer>& list() const;
    // A list of strings, or a single one.
    std::vector<std::string> strings() const;
    const YamlValue& map() const;

    [[noreturn]] void fail(const std::string& expected) const;
};

// The first document of the text, in UTF-8; null for an empty text. Throws YamlError: for mistakes, for keys that stand
// twice in a map, and for files that nest deeper than 64 levels or unfold to more than a million values.
YamlValue::Pointer readYaml(std::string_view utf8, const std::string& fileName);

}  // namespace plume
