// What a stored library has to show for its suite to be run on it.
#pragma once

#include <functional>
#include <memory>

#include "platform/LibraryStorage.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

class ContractStorage {
  public:
    virtual ~ContractStorage() = default;
    // As another process has it; all have the same library. Belongs to the bench.
    virtual LibraryStorage& open() = 0;
    // Lets the main loop work until the condition holds; false when it does not in good time.
    virtual bool runUntil(const std::function<bool()>& condition) = 0;
};

class LibraryStorageContract : public testing::TestWithParam<ContractPort<ContractStorage>> {
  protected:
    using Generation = LibraryStorage::Generation;
    static constexpr Generation Refused = -1;

    // The generation that was written, Refused when it was outdated.
    static Generation written(const LibraryStorage::Written& result) {
        EXPECT_TRUE(result) << result.error().message;
        const auto* generation = result ? std::get_if<Generation>(&result.value()) : nullptr;
        return generation ? *generation : Refused;
    }

    std::unique_ptr<ContractStorage> bench_ = GetParam().make();
    LibraryStorage& mine_ = bench_->open();
    LibraryStorage& other_ = bench_->open();
};

}  // namespace plume
