#include "library/FileNameTime.h"

#include <array>
#include <chrono>
#include <ctime>

namespace plume {

std::string fileNameTime(Date date) {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(std::chrono::floor<std::chrono::seconds>(date));
    std::tm local{};
    localtime_r(&seconds, &local);
    std::array<char, 64> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%d %H-%M-%S", &local);
    return text.data();
}

}  // namespace plume
