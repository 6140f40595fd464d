#include "linux/device/Descriptors.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <vector>

namespace ktr::linux_ {

bool Descriptors::areEnough(int wanted) {
    rlimit limit{};
    // Beyond a usual limit there is nothing to gain, and a huge one costs programs that walk through it.
    constexpr rlim_t kUsual = 1024;
    if (::getrlimit(RLIMIT_NOFILE, &limit) == 0 && limit.rlim_cur < kUsual && limit.rlim_cur < limit.rlim_max) {
        limit.rlim_cur = std::min(limit.rlim_max, kUsual);
        ::setrlimit(RLIMIT_NOFILE, &limit);
    }
    std::vector<int> opened;
    while (opened.size() < static_cast<std::size_t>(wanted)) {
        const int descriptor = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
        if (descriptor < 0) {
            break;
        }
        opened.push_back(descriptor);
    }
    for (const int descriptor : opened) {
        ::close(descriptor);
    }
    return opened.size() == static_cast<std::size_t>(wanted);
}

}  // namespace ktr::linux_
