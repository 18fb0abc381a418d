#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>

#include "ports/atspi/AtspiAccessibility.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"

namespace plume::rig {

// One desktop for all. The tests say who is in front and that somebody types, as the keyboard's port does.
class AccessibilityDesktop : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        if (rig_) return;
        rig_ = std::make_unique<DesktopRig>();
        rig_->session().join();
        accessibility_ = std::make_unique<AtspiAccessibility>();
        ASSERT_TRUE(waitUntil([] { return accessibility_->status() != AccessibilityStatus::Starting; }));
    }

    static std::unique_ptr<TargetProgram> startFocused(TargetKind kind) {
        auto target = rig_->startTarget(kind);
        comesToFront(*target);
        return target;
    }

    static void comesToFront(const TargetProgram& target) {
        accessibility_->setFrontProcess(target.pid());
        if (target.kind() == TargetKind::Xterm) return;
        EXPECT_TRUE(awaitTyping([&] { return accessibility_->focusedProcess() == target.pid(); }));
    }

    // With somebody who types all the while.
    static bool awaitTyping(const std::function<bool()>& condition) {
        return waitUntil([&] {
            accessibility_->userTypes();
            return condition();
        });
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    static inline std::unique_ptr<AtspiAccessibility> accessibility_;
};

}  // namespace plume::rig
