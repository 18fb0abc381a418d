// What the tests of the clipboard on X11 share: a desktop, a tap thread with its pasteboard, an owner of promises.
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <condition_variable>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "ports/x11/clipboard/X11Pasteboard.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/SelectionClients.h"
#include "testing/rig/SessionThread.h"

namespace plume::rig {

// Promises content, and notes what it was asked for and what was taken.
class NotingOwner final : public PasteboardOwner {
  public:
    using Contents = std::map<std::string, std::string, std::less<>>;

    explicit NotingOwner(Contents contents) : contents_(std::move(contents)) {}

    void provideData(Pasteboard& pasteboard, std::string_view type) override {
        const auto found = contents_.find(type);
        if (found != contents_.end()) pasteboard.setData(found->second, type);
    }
    void dataWasTaken(std::string_view type) override {
        const std::lock_guard lock(mutex_);
        taken_.emplace_back(type);
        changed_.notify_all();
    }

    std::vector<std::string> taken() const {
        const std::lock_guard lock(mutex_);
        return taken_;
    }
    // What was taken, once that is so many.
    std::vector<std::string> awaitTaken(std::size_t count) {
        std::unique_lock lock(mutex_);
        changed_.wait_for(lock, std::chrono::seconds(10), [&] { return taken_.size() >= count; });
        return taken_;
    }

  private:
    const Contents contents_;
    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<std::string> taken_;
};

class X11PasteboardTest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        thread_ = std::make_unique<SessionThread>(display());
        pasteboard_ = thread_->run([&] { return std::move(X11Pasteboard::open(thread_->session())).value(); });
    }
    void TearDown() override {
        thread_->end();
        pasteboard_.reset();
        thread_.reset();
        awaitNoOwner();
    }

    static const std::string& display() { return rig_->server().display(); }
    static void awaitNoOwner() {
        rig_->client().await("a clipboard without owner", Milliseconds(10'000), [] {
            return rig_->client().selectionOwner("CLIPBOARD") == 0 && rig_->client().selectionOwner("PRIMARY") == 0;
        });
    }

    std::int64_t declare(const std::vector<std::string>& types, PasteboardOwner* owner) {
        return thread_->run([&] { return pasteboard_->declareTypes(types, owner); });
    }
    // Writes a plain text, without an owner.
    void write(std::u16string_view text) {
        thread_->run([&] {
            pasteboard_->declareTypes({std::string(PasteboardType::String)}, nullptr);
            pasteboard_->setString(text, PasteboardType::String);
        });
    }
    std::int64_t changeCount() {
        return thread_->run([&] { return pasteboard_->changeCount(); });
    }
    void awaitChangeAfter(std::int64_t count) {
        rig_->client().await("a change of the clipboard", Milliseconds(10'000), [&] { return changeCount() > count; });
    }
    std::vector<std::string> types() {
        return thread_->run([&] { return pasteboard_->types(); });
    }
    std::optional<std::u16string> string() {
        return thread_->run([&] { return pasteboard_->string(); });
    }
    std::optional<std::string> data(std::string_view type) {
        return thread_->run([&] { return pasteboard_->data(type); });
    }
    // Another program copies, and the pasteboard knows.
    std::unique_ptr<ForeignOwner> copyElsewhere(SelectionOffer offer, ForeignOwner::Options options = {}) {
        const std::int64_t before = changeCount();
        auto owner = std::make_unique<ForeignOwner>(display(), std::move(offer), std::move(options));
        awaitChangeAfter(before);
        return owner;
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::unique_ptr<SessionThread> thread_;
    std::unique_ptr<X11Pasteboard> pasteboard_;
};

// Bytes that are not alike anywhere, so that a lost or swapped piece shows.
inline std::string unevenBytes(std::size_t size) {
    std::string bytes(size, '\0');
    std::uint32_t state = 1;
    for (char& byte : bytes) {
        state = state * 1664525 + 1013904223;
        byte = static_cast<char>(state >> 24);
    }
    return bytes;
}

}  // namespace plume::rig
