#pragma once

#include <sys/resource.h>

// Processor time, ms: RUSAGE_SELF of this program, RUSAGE_CHILDREN of all that it has started and that have
// ended.
inline double ProcessorTime(int who) {
    rusage usage{};
    getrusage(who, &usage);
    const auto ms = [](const timeval& time) {
        return 1000.0 * static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) / 1000;
    };
    return ms(usage.ru_utime) + ms(usage.ru_stime);
}
