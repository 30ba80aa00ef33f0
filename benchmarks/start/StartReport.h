#pragma once

#include <cstdio>
#include <sys/resource.h>
#include <time.h>
#include <unistd.h>

namespace orvo::start {

/// The most that the process has had in memory.
inline double peakMemoryMiB() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<double>(usage.ru_maxrss) / 1024;
}

/// Says that the first frame stands, when by the monotonic clock, and with how much memory; ends
/// the process.
[[noreturn]] inline void reportAndLeave() {
    timespec now{};
    clock_gettime(CLOCK_MONOTONIC, &now);
    std::printf("%.6f %.2f\n",
                static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9,
                peakMemoryMiB());
    std::fflush(stdout);
    _exit(0);
}

} // namespace orvo::start
