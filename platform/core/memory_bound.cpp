// The process's resident memory as the system counts it, against the bound.
#include "platform/core/memory_bound.h"

#include <unistd.h>

#ifdef __APPLE__
#include <mach/mach.h>
#endif

#include <algorithm>
#include <cstdio>

namespace {

constexpr size_t kMostBytes = size_t{4} << 30;
size_t boundForTesting = 0;

size_t PageBytes() {
    return static_cast<size_t>(sysconf(_SC_PAGESIZE));
}

size_t ResidentBytes() {
#ifdef __APPLE__
    mach_task_basic_info_data_t info{};
    mach_msg_type_number_t count = MACH_TASK_BASIC_INFO_COUNT;
    if (task_info(mach_task_self(), MACH_TASK_BASIC_INFO, reinterpret_cast<task_info_t>(&info),
                  &count) != KERN_SUCCESS) {
        return 0;
    }
    return info.resident_size;
#else
    size_t pages = 0;
    size_t resident = 0;
    if (std::FILE* statm = std::fopen("/proc/self/statm", "r")) {
        if (std::fscanf(statm, "%zu %zu", &pages, &resident) != 2) {
            resident = 0;
        }
        std::fclose(statm);
    }
    return resident * PageBytes();
#endif
}

}  // namespace

bool PastMemoryBound() {
    static const size_t bound =
        std::min(kMostBytes, static_cast<size_t>(sysconf(_SC_PHYS_PAGES)) * PageBytes() / 4);
    return ResidentBytes() > (boundForTesting ? boundForTesting : bound);
}

void SetMemoryBoundForTesting(size_t bytes) {
    boundForTesting = bytes;
}
