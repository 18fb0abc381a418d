// How the names of content on X11 (targets) and on a pasteboard (types) stand for each other.
//
// Pure functions.
#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

namespace SelectionTarget {
inline constexpr std::string_view Utf8String = "UTF8_STRING";
inline constexpr std::string_view Utf8Text = "text/plain;charset=utf-8";
inline constexpr std::string_view PlainText = "text/plain";
inline constexpr std::string_view Latin1String = "STRING";
inline constexpr std::string_view TextRtf = "text/rtf";
inline constexpr std::string_view ApplicationRtf = "application/rtf";
inline constexpr std::string_view TextHtml = "text/html";
// What clipboard managers look for in content that they are to forget.
inline constexpr std::string_view PasswordManagerHint = "x-kde-passwordManagerHint";
inline constexpr std::string_view CopyQHidden = "application/x-copyq-hidden";
}  // namespace SelectionTarget

// The targets that hold a pasteboard type, the best first; none for types that go by their own names.
std::span<const std::string_view> targetsOfType(std::string_view type);
// The pasteboard type that a target holds.
std::optional<std::string_view> typeOfTarget(std::string_view target);

// Whether asking for the target does something, or tells of the exchange instead of the content.
bool isMetaTarget(std::string_view target);

// The types of content whose owner offers these targets: all that hold content, and in front of the best target of a
// pasteboard type that type.
std::vector<std::string> typesOfTargets(const std::vector<std::string>& targets);
// The target to ask for when a type is wanted: the best one on offer. Empty when there is none.
std::string_view targetForType(std::string_view type, std::span<const std::string> targets);

// Text as Latin-1, with "?" for what it lacks, and back, in UTF-8.
std::string latin1FromUtf8(std::string_view text);
std::string utf8FromLatin1(std::string_view text);

}  // namespace plume
