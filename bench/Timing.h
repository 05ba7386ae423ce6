#pragma once

#include <algorithm>
#include <time.h>
#include <vector>

// Times are taken on this thread's own processor clock, so that other work on
// a shared machine does not inflate them.
inline double ThreadSeconds()
{
    timespec now{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
}

inline double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}
