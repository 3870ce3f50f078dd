#pragma once

#include <unistd.h>

#include <fstream>

namespace Korvane::Veldra::Bench {

// The process's resident size now (/proc/self/statm), in KiB.
inline long ResidentKiB() {
    std::ifstream statm("/proc/self/statm");
    long pages = 0, resident = 0;
    statm >> pages >> resident;
    return resident * (sysconf(_SC_PAGESIZE) / 1024);
}

}  // namespace Korvane::Veldra::Bench
