// The application on a desktop of its own with a text to type into, and what a benchmark sees of its windows.
#pragma once

#include <poll.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "bench/GeneratedLibrary.h"
#include "testing/rig/PlumeProgram.h"
#include "testing/rig/XcbReply.h"

namespace plume::bench {

class Desk {
  public:
    using Clock = std::chrono::steady_clock;
    using Settings = std::vector<std::pair<std::string, std::string>>;

    static constexpr rig::Milliseconds Bound{5'000};

    // A readable library, and perhaps an archive that is imported besides.
    Desk(const std::string& library, const Settings& settings, const std::string& archive = {}) {
        rig_.session().join();
        const auto folder = rig_.directory() / "home/.config/plume";
        std::filesystem::create_directories(folder);
        std::ofstream(folder / "library.json") << library;
        run({"list"});
        if (!archive.empty()) {
            const auto all = rig_.directory() / "all.plume";
            std::ofstream(all, std::ios::binary) << archive;
            run({"import", all.string()});
        }
        run({"settings", "PlayFeedbackSound", "false"});
        for (const auto& [name, value] : settings) run({"settings", name, value});
        plume_ = rig::PlumeProgram::startApplication(rig_);
        target_ = rig_.startTarget(rig::TargetKind::GtkTextView);
        poll(nullptr, 0, 1'500);
    }

    rig::DesktopRig& rig() { return rig_; }
    rig::TargetProgram& target() { return *target_; }
    pid_t plume() { return plume_->process().pid(); }
    void tap(rig::Key key) {
        rig_.keyboard().tap(key);
        rig_.keyboard().sync();
    }

    // What a part of the screen shows.
    std::string picture(const xcb_rectangle_t& part) {
        auto* connection = rig_.client().connection();
        const auto asked = xcb_get_image(connection, XCB_IMAGE_FORMAT_Z_PIXMAP, rig_.client().root(), part.x, part.y,
                                         part.width, part.height, 0xFFFFFFFF);
        const auto image = rig::own(xcb_get_image_reply(connection, asked, nullptr));
        require(image != nullptr);
        return {reinterpret_cast<const char*>(xcb_get_image_data(image.get())),
                static_cast<std::size_t>(xcb_get_image_data_length(image.get()))};
    }
    // Milliseconds from what `act` does until that part of the screen shows this.
    template <typename Act>
    double untilShown(const xcb_rectangle_t& part, const std::string& expected, const Act& act) {
        const auto began = Clock::now();
        act();
        while (picture(part) != expected) require(since(began) < static_cast<double>(Bound.count()));
        return since(began);
    }
    static double since(Clock::time_point moment) {
        return std::chrono::duration<double, std::milli>(Clock::now() - moment).count();
    }
    static void settle() { poll(nullptr, 0, 300); }

  private:
    void run(const std::vector<std::string>& arguments) { require(rig::runPlume(rig_, arguments).status == 0); }

    rig::DesktopRig rig_;
    std::unique_ptr<rig::PlumeProgram> plume_;
    std::unique_ptr<rig::TargetProgram> target_;
};

}  // namespace plume::bench
