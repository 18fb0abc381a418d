#include "testing/real/RealProgram.h"

namespace plume::real {

const std::vector<RealProgram>& realPrograms() {
    static const std::vector<RealProgram> all = [] {
        std::vector<RealProgram> programs;
        for (const auto& table : {editors(), others(), terminals(), offices(), browsers()}) {
            programs.insert(programs.end(), table.begin(), table.end());
        }
        return programs;
    }();
    return all;
}

}  // namespace plume::real
