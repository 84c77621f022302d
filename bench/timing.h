// The clock, the median and the memory figures that every benchmark reports with.
#pragma once

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

inline double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

// The median of first[i] / second[i]: runs made in the same round share the machine's speed of
// the moment, so this holds steadier than the ratio of two medians when that speed drifts.
inline double MedianOfRatios(const std::vector<double>& first, const std::vector<double>& second) {
    std::vector<double> ratios;
    for (size_t i = 0; i < first.size() && i < second.size(); ++i) {
        ratios.push_back(first[i] / second[i]);
    }
    return Median(ratios);
}

template <class F>
double Milliseconds(F&& work) {
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start)
        .count();
}

// A shell command's wall time, the yardstick's share of a run.
inline double TimeCommand(const std::string& command) {
    return Milliseconds([&] {
        if (std::system(command.c_str()) != 0) {
            std::fprintf(stderr, "failed: %s\n", command.c_str());
        }
    });
}

// A line of /proc/self/status, such as "VmRSS" or "VmHWM", in kilobytes; 0 if it is missing.
inline long StatusKilobytes(const std::string& key) {
    std::ifstream status("/proc/self/status");
    std::string line;
    while (std::getline(status, line)) {
        if (line.rfind(key + ":", 0) == 0) {
            return std::atol(line.c_str() + key.size() + 1);
        }
    }
    return 0;
}
