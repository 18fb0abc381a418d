// The general pasteboard.
#pragma once

#include <cstdint>
#include <functional>
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
inline constexpr std::string_view HTML = "NSHTMLPboardType";
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

class Pasteboard;

// Who has promised content and is asked for it when somebody wants it. Not owned by the pasteboard; outlives its
// promises.
class PasteboardOwner {
  public:
    virtual ~PasteboardOwner() = default;
    // Writes the content of `type` with setString or setData, at once. Called on the thread that serves the pasteboard.
    virtual void provideData(Pasteboard& pasteboard, std::string_view type) = 0;
    // The program in front has taken what it asked for. Called only by a pasteboard that tellsWhenTaken().
    virtual void dataWasTaken(std::string_view /*type*/) {}
};

// Reading and writing. Everything here belongs to the tap thread.
class Pasteboard : public PasteboardReader {
  public:
    // Grows with every change of the content, whoever makes it.
    virtual std::int64_t changeCount() const = 0;
    // Whether owners hear when the program in front has taken their content. Where they do, a paste goes on after the
    // keystroke, and others (a clipboard manager) may read promised content too.
    virtual bool tellsWhenTaken() const = 0;
    // Pastes what was declared last: calls `sendKeystroke` when the program in front will find it, at once or from the
    // run loop, 0.2 s later at most.
    virtual void paste(std::function<void()> sendKeystroke) = 0;
    // Whether the program that got the last paste's keystroke is still in front and does nothing: it hangs, or is
    // stopped. It still gets what was pasted when it goes on, also if something else has been declared by then.
    virtual bool isPasteAwaited() const = 0;
    // Replaces the content by these types and returns the new change count. With an owner the data is promised;
    // without one it is written right after. No types at all empty the pasteboard.
    virtual std::int64_t declareTypes(const std::vector<std::string>& types, PasteboardOwner* owner) = 0;
    // What is promised from now on is for a program that pastes what is selected: platforms where that is something of
    // its own offer it there, too, as long as it is promised.
    virtual void setPastesPrimary(bool /*pastesPrimary*/) {}
    virtual void setString(std::u16string_view string, std::string_view type) = 0;
    virtual void setData(std::string_view bytes, std::string_view type) = 0;
};

}  // namespace plume
