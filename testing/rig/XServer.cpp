#include "testing/rig/XServer.h"

#include <fstream>
#include <sstream>
#include <utility>

#include "testing/rig/ReportPipe.h"

namespace plume::rig {

namespace {

constexpr Milliseconds StartBound{20'000};

std::filesystem::path requireServer() {
    auto server = requireFile({"/usr/lib/xorg/Xorg", "/usr/libexec/Xorg", "/usr/bin/Xorg"}, "xserver-xorg-core");
    const std::filesystem::path modules = "/usr/lib/xorg/modules";
    requireFile({modules / "input/inputtest_drv.so"}, "xserver-xorg-core");
    requireFile({modules / "drivers/dummy_drv.so"}, "xserver-xorg-video-dummy");
    requireProgram("xkbcomp", "x11-xkb-utils");  // the server compiles its keymaps with it
    requireFile({"/usr/share/X11/xkb/rules/evdev"}, "xkb-data");
    return server;
}

// A mode of the wanted size at 60 pictures a second, with any blanking the driver accepts.
std::string modeLine(const XServer::Options& options) {
    constexpr int Blanking = 40;
    const int width = options.width + 4 * Blanking;
    const int height = options.height + 4 * Blanking;
    std::ostringstream line;
    line << "  ModeLine \"wanted\" " << width * height * 60.0 / 1e6;
    for (const auto& [size, total] : {std::pair(options.width, width), std::pair(options.height, height)}) {
        line << ' ' << size << ' ' << size + Blanking << ' ' << size + 2 * Blanking << ' ' << total;
    }
    line << '\n';
    return line.str();
}

std::string keyboardSection(const std::string& name, const std::filesystem::path& socket,
                            const XServer::Options& options) {
    std::ostringstream section;
    section << "Section \"InputDevice\"\n  Identifier \"" << name << R"("
  Driver "inputtest"
  Option "DeviceType" "Keyboard"
  Option "XkbRules" "evdev"
  Option "XkbModel" "pc105"
)"
            << "  Option \"SocketPath\" " << socket << "\n  Option \"XkbLayout\" \"" << options.layout
            << "\"\n  Option \"XkbVariant\" \"" << options.variant << "\"\nEndSection\n";
    return section.str();
}

}  // namespace

XServer::XServer(const PrivateDirectory& directory, const Options& options, const Environment& environment)
    : keyboardSocket_(directory.path() / "keyboard"),
      secondKeyboardSocket_(directory.path() / "keyboard2"),
      pointerSocket_(directory.path() / "pointer") {
    const auto server = requireServer();
    const auto configuration = directory.path() / "xorg.conf";
    writeConfiguration(configuration, options);
    ReportPipe number;
    // A seat that is not the machine's own: the server then leaves the virtual terminals alone.
    process_ = std::make_unique<ChildProcess>(ChildProcess::Start{
        .arguments = {server, "-displayfd", std::to_string(number.writer()), "-config", configuration, "-logfile",
                      directory.path() / "xorg.log", "-seat", "plume-tests", "-noreset", "-nolisten", "tcp"},
        .environment = environment,
        .log = directory.path() / "xorg.output",
        .keptDescriptors = {number.writer()}});
    display_ = ":" + number.awaitLine(*process_, StartBound);
}

void XServer::writeConfiguration(const std::filesystem::path& file, const Options& options) const {
    std::ofstream out(file);
    out << R"(Section "ServerFlags"
  Option "AutoAddDevices" "false"
  Option "BlankTime" "0"
EndSection
Section "Device"
  Identifier "video"
  Driver "dummy"
  VideoRam 64000
EndSection
Section "Monitor"
  Identifier "monitor"
  HorizSync 5.0-1000.0
  VertRefresh 5.0-200.0
)" << modeLine(options)
        << R"(EndSection
Section "Screen"
  Identifier "screen"
  Device "video"
  Monitor "monitor"
  DefaultDepth 24
  SubSection "Display"
    Depth 24
)"
        << "    Modes \"wanted\"\n    Virtual " << options.width << ' ' << options.height << R"(
  EndSubSection
EndSection
)" << keyboardSection("test keyboard", keyboardSocket_, options)
        << (options.secondKeyboard ? keyboardSection("second keyboard", secondKeyboardSocket_, options) : "")
        << R"(Section "InputDevice"
  Identifier "test pointer"
  Driver "inputtest"
  Option "DeviceType" "PointerAbsolute"
)"
        << "  Option \"SocketPath\" " << pointerSocket_ << R"(
EndSection
Section "ServerLayout"
  Identifier "layout"
  Screen "screen"
  InputDevice "test keyboard" "CoreKeyboard"
  InputDevice "test pointer" "CorePointer"
)" << (options.secondKeyboard ? "  InputDevice \"second keyboard\" \"SendCoreEvents\"\n" : "")
        << "EndSection\n";
    if (!out.flush()) throw RigError("cannot write " + file.string());
}

}  // namespace plume::rig
