// What the benchmarks share: timing, medians, and the one form in which figures are printed.
#pragma once

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <cstdio>
#include <string>
#include <vector>

namespace plume::bench {

// Nanoseconds that `work` takes.
template <typename Work>
double nanosecondsOf(Work&& work) {
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double, std::nano>(std::chrono::steady_clock::now() - start).count();
}

inline double median(std::vector<double> values) {
    const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), middle, values.end());
    return *middle;
}

// That of the values which `part` of them do not exceed.
inline double percentile(std::vector<double> values, double part) {
    std::sort(values.begin(), values.end());
    const auto place = static_cast<std::size_t>(static_cast<double>(values.size()) * part);
    return values[std::min(place, values.size() - 1)];
}

// The median of `runs` timings of `work`, in nanoseconds.
template <typename Work>
double medianNanoseconds(int runs, Work&& work) {
    std::vector<double> times;
    for (int i = 0; i < runs; ++i) times.push_back(nanosecondsOf(work));
    return median(std::move(times));
}

// "name: value unit", with three significant digits.
inline void print(const std::string& name, double value, const char* unit) {
    if (value >= 100) {
        std::printf("%s: %.0f %s\n", name.c_str(), value, unit);
    } else {
        std::printf("%s: %.3g %s\n", name.c_str(), value, unit);
    }
}

}  // namespace plume::bench
