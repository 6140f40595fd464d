#pragma once

#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

namespace ktr::test {

/// As long as this lives, the process can open no file and no socket beyond those that it has.
class NoMoreFiles {
  public:
    /// The undefined-behaviour sanitizer looks whether memory can be read by writing it into a pipe, and takes an
    /// object for none where it cannot open one.
#ifdef __SANITIZE_ADDRESS__
    static constexpr bool kIsPossible = false;
#else
    static constexpr bool kIsPossible = true;
#endif

    NoMoreFiles() {
        ::getrlimit(RLIMIT_NOFILE, &before_);
        const int lowest = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
        ::close(lowest);
        rlimit none = before_;
        none.rlim_cur = static_cast<rlim_t>(lowest);
        ::setrlimit(RLIMIT_NOFILE, &none);
    }
    ~NoMoreFiles() {
        ::setrlimit(RLIMIT_NOFILE, &before_);
    }
    NoMoreFiles(const NoMoreFiles&) = delete;
    NoMoreFiles& operator=(const NoMoreFiles&) = delete;

  private:
    rlimit before_{};
};

}  // namespace ktr::test
