#include "testing/real/TextReader.h"

#include <fstream>
#include <iterator>
#include <utility>

#include "testing/real/CopyWatch.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/SelectionClients.h"

namespace plume::real {

namespace {

using rig::Key;
using rig::Milliseconds;

constexpr Milliseconds CopyBound{1'000};

class CopyingReader final : public TextReader {
  public:
    CopyingReader(rig::DesktopRig& rig, xcb_window_t window)
        : rig_(rig), window_(window), watch_(rig.server().display()), requestor_(rig.server().display()) {}

    std::string read() override {
        watch_.forget();
        rig_.keyboard().chord({Key::LeftControl}, U'a');
        rig_.keyboard().chord({Key::LeftControl}, U'c');
        // Plume's own window may own it for a moment, when it puts the user's clipboard back.
        const bool copied = watch_.awaitOwner(
            CopyBound, [this](xcb_window_t owner) { return rig_.client().areOfSameClient(owner, window_); });
        if (!copied) return {};
        const auto data = requestor_.request("CLIPBOARD", "UTF8_STRING");
        return data ? data->bytes : std::string();
    }

  private:
    rig::DesktopRig& rig_;
    xcb_window_t window_;
    CopyWatch watch_;
    rig::SelectionRequestor requestor_;
};

// The reverse of what the page does: brackets and ends of lines stand as %XX.
std::string decodePercent(const std::string& text) {
    std::string decoded;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '%' && i + 2 < text.size()) {
            decoded += static_cast<char>(std::stoi(text.substr(i + 1, 2), nullptr, 16));
            i += 2;
        } else {
            decoded += text[i];
        }
    }
    return decoded;
}

class TitleReader final : public TextReader {
  public:
    TitleReader(rig::DesktopRig& rig, xcb_window_t window) : rig_(rig), window_(window) {}

    std::string read() override {
        std::string title = rig_.client().property(window_, "_NET_WM_NAME");
        const auto start = title.find('[');
        const auto end = title.find(']');
        if (start == std::string::npos || end == std::string::npos || end < start) return title;
        return decodePercent(title.substr(start + 1, end - start - 1));
    }

  private:
    rig::DesktopRig& rig_;
    xcb_window_t window_;
};

std::string contentOf(const std::filesystem::path& file) {
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
}

class FileReader final : public TextReader {
  public:
    explicit FileReader(std::filesystem::path file) : file_(std::move(file)) {}
    std::string read() override {
        std::string text = contentOf(file_);
        if (!text.empty() && text.back() == '\n') text.pop_back();
        return text;
    }

  private:
    std::filesystem::path file_;
};

// The shell adds each answer and a mark to the file.
class LineReader final : public TextReader {
  public:
    LineReader(rig::DesktopRig& rig, std::filesystem::path file) : rig_(rig), file_(std::move(file)) {}

    std::string read() override {
        const std::size_t before = contentOf(file_).size();
        rig_.keyboard().tap(Key::Return);
        rig_.keyboard().sync();
        std::string added;
        rig::waitUntil(
            [&] {
                added = contentOf(file_).substr(before);
                return added.ends_with('\0');
            },
            CopyBound);
        if (!added.empty()) added.pop_back();
        return added;
    }
    bool leavesText() const override { return false; }

  private:
    rig::DesktopRig& rig_;
    std::filesystem::path file_;
};

}  // namespace

std::unique_ptr<TextReader> makeReader(Reading reading, rig::DesktopRig& rig, xcb_window_t window,
                                       const std::filesystem::path& file) {
    switch (reading) {
        case Reading::Copying:
            return std::make_unique<CopyingReader>(rig, window);
        case Reading::Title:
            return std::make_unique<TitleReader>(rig, window);
        case Reading::Lines:
            return std::make_unique<LineReader>(rig, file);
        case Reading::File:
            return std::make_unique<FileReader>(file);
    }
    throw rig::RigError("no such way of reading");
}

}  // namespace plume::real
