// Stands between a program and the C library (LD_PRELOAD) and lets one kind of call fail: a fault at every file and
// socket call, without a kernel of one's own. What it does stands in the environment:
//   KTR_FAULT_CALL   open, read, write, fsync, rename, close, mkdir, flock, watch, socket, connect, recv, send
//   KTR_FAULT_KIND   an error by its name (EIO, ENOSPC, EINTR, EMFILE, ...), or "short": one byte is read or written
//   KTR_FAULT_FROM   the first call that fails, from 1
//   KTR_FAULT_TIMES  how many in a row (1)
//   KTR_FAULT_COUNT  a file that holds the number of calls: eight bytes, in the machine's order
// Reads and writes of standard streams are left alone, so that the program can say what is wrong.
#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <stdarg.h>
#include <sys/file.h>
#include <sys/inotify.h>
#include <sys/mman.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/types.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace {

struct Plan {
    const char* call = std::getenv("KTR_FAULT_CALL");
    const char* kind = std::getenv("KTR_FAULT_KIND");
    long from = numberOf("KTR_FAULT_FROM", 0);
    long times = numberOf("KTR_FAULT_TIMES", 1);
    int number = errorOf(kind);
    std::atomic<long>* calls = counter();

    /// In a shared mapping: a program may end without a word to anybody.
    static std::atomic<long>* counter() {
        static std::atomic<long> own = 0;
        const char* file = std::getenv("KTR_FAULT_COUNT");
        const long descriptor = file == nullptr ? -1 : ::syscall(SYS_openat, AT_FDCWD, file, O_RDWR | O_CREAT, 0600);
        if (descriptor < 0 || ::ftruncate(static_cast<int>(descriptor), sizeof own) != 0) {
            return &own;
        }
        void* shared = ::mmap(nullptr, sizeof own, PROT_READ | PROT_WRITE, MAP_SHARED, static_cast<int>(descriptor), 0);
        ::syscall(SYS_close, descriptor);
        return shared == MAP_FAILED ? &own : static_cast<std::atomic<long>*>(shared);
    }
    static long numberOf(const char* name, long otherwise) {
        const char* text = std::getenv(name);
        return text == nullptr ? otherwise : std::atol(text);
    }
    static int errorOf(const char* name) {
        struct Named {
            const char* name;
            int number;
        };
        for (const Named& named : {Named{"EIO", EIO}, Named{"ENOSPC", ENOSPC}, Named{"EINTR", EINTR},
                                   Named{"EMFILE", EMFILE}, Named{"EACCES", EACCES}, Named{"ECONNRESET", ECONNRESET}}) {
            if (name != nullptr && std::strcmp(name, named.name) == 0) {
                return named.number;
            }
        }
        return 0;
    }
};

/// Made when it is first asked: other libraries' constructors call already.
Plan& plan() {
    static Plan only;
    return only;
}

/// Whether this call is one that fails.
bool isHit(const char* call) {
    Plan& known = plan();
    if (known.call == nullptr || std::strcmp(known.call, call) != 0) {
        return false;
    }
    const long number = ++*known.calls;
    return known.from > 0 && number >= known.from && number < known.from + known.times;
}

bool isShort() {
    return plan().kind != nullptr && std::strcmp(plan().kind, "short") == 0;
}

template <class Function>
Function real(Function, const char* name) {
    return reinterpret_cast<Function>(::dlsym(RTLD_NEXT, name));
}

/// Whether a descriptor is a file, a pipe or a socket. Counters that the kernel keeps for events are none of them: they
/// know neither input/output errors nor half a number.
bool carriesBytes(int descriptor) {
    struct stat facts {};
    return ::fstat(descriptor, &facts) == 0 && (facts.st_mode & S_IFMT) != 0;
}

/// What is asked of a transfer: all of it, one byte of it, or an error.
template <class Transfer>
ssize_t transferred(const char* call, int descriptor, size_t size, Transfer transfer) {
    if (descriptor <= STDERR_FILENO || size == 0 || !carriesBytes(descriptor) || !isHit(call)) {
        return transfer(size);
    }
    if (isShort()) {
        return transfer(1);
    }
    errno = plan().number;
    return -1;
}

template <class Call>
int called(const char* name, Call call) {
    if (!isHit(name) || isShort()) {
        return call();
    }
    errno = plan().number;
    return -1;
}

mode_t modeOf(int flags, va_list arguments) {
    return (flags & (O_CREAT | O_TMPFILE)) != 0 ? static_cast<mode_t>(va_arg(arguments, int)) : 0;
}

}  // namespace

extern "C" {

#define KTR_OPEN(name)                                                                  \
    int name(const char* file, int flags, ...) {                                        \
        va_list arguments;                                                              \
        va_start(arguments, flags);                                                     \
        const mode_t mode = modeOf(flags, arguments);                                   \
        va_end(arguments);                                                              \
        return called("open", [&] { return real(&::name, #name)(file, flags, mode); }); \
    }
KTR_OPEN(open)
KTR_OPEN(open64)

#define KTR_OPENAT(name)                                                                        \
    int name(int folder, const char* file, int flags, ...) {                                    \
        va_list arguments;                                                                      \
        va_start(arguments, flags);                                                             \
        const mode_t mode = modeOf(flags, arguments);                                           \
        va_end(arguments);                                                                      \
        return called("open", [&] { return real(&::name, #name)(folder, file, flags, mode); }); \
    }
KTR_OPENAT(openat)
KTR_OPENAT(openat64)

#define KTR_FOPEN(name)                              \
    FILE* name(const char* file, const char* mode) { \
        if (isHit("open") && !isShort()) {           \
            errno = plan().number;                   \
            return nullptr;                          \
        }                                            \
        return real(&::name, #name)(file, mode);     \
    }
KTR_FOPEN(fopen)
KTR_FOPEN(fopen64)

ssize_t read(int descriptor, void* bytes, size_t size) {
    return transferred("read", descriptor, size,
                       [&](size_t count) { return real(&::read, "read")(descriptor, bytes, count); });
}
ssize_t write(int descriptor, const void* bytes, size_t size) {
    return transferred("write", descriptor, size,
                       [&](size_t count) { return real(&::write, "write")(descriptor, bytes, count); });
}
ssize_t recv(int descriptor, void* bytes, size_t size, int flags) {
    return transferred("recv", descriptor, size,
                       [&](size_t count) { return real(&::recv, "recv")(descriptor, bytes, count, flags); });
}
ssize_t send(int descriptor, const void* bytes, size_t size, int flags) {
    return transferred("send", descriptor, size,
                       [&](size_t count) { return real(&::send, "send")(descriptor, bytes, count, flags); });
}
ssize_t pread64(int descriptor, void* bytes, size_t size, off64_t from) {
    return transferred("read", descriptor, size,
                       [&](size_t count) { return real(&::pread64, "pread64")(descriptor, bytes, count, from); });
}
/// All of it or an error: half a message is the receiver's affair, and there are recv and read for that.
ssize_t recvmsg(int descriptor, msghdr* message, int flags) {
    if (!isShort() && carriesBytes(descriptor) && isHit("recv")) {
        errno = plan().number;
        return -1;
    }
    return real(&::recvmsg, "recvmsg")(descriptor, message, flags);
}
ssize_t sendmsg(int descriptor, const msghdr* message, int flags) {
    if (!isShort() && carriesBytes(descriptor) && isHit("send")) {
        errno = plan().number;
        return -1;
    }
    return real(&::sendmsg, "sendmsg")(descriptor, message, flags);
}
int mkdir(const char* folder, mode_t mode) noexcept {
    return called("mkdir", [&] { return real(&::mkdir, "mkdir")(folder, mode); });
}
int flock(int descriptor, int how) noexcept {
    return called("flock", [&] { return real(&::flock, "flock")(descriptor, how); });
}
int inotify_init1(int flags) noexcept {
    return called("watch", [&] { return real(&::inotify_init1, "inotify_init1")(flags); });
}
int inotify_add_watch(int descriptor, const char* file, uint32_t events) noexcept {
    return called("watch", [&] { return real(&::inotify_add_watch, "inotify_add_watch")(descriptor, file, events); });
}
int fsync(int descriptor) {
    return called("fsync", [&] { return real(&::fsync, "fsync")(descriptor); });
}
int rename(const char* from, const char* to) noexcept {
    return called("rename", [&] { return real(&::rename, "rename")(from, to); });
}
int renameat2(int fromFolder, const char* from, int toFolder, const char* to, unsigned flags) noexcept {
    return called("rename", [&] { return real(&::renameat2, "renameat2")(fromFolder, from, toFolder, to, flags); });
}
/// The descriptor is gone whatever is said, as the kernel has it.
int close(int descriptor) {
    const bool hit = descriptor > STDERR_FILENO && isHit("close") && !isShort();
    const int result = real(&::close, "close")(descriptor);
    if (!hit) {
        return result;
    }
    errno = plan().number;
    return -1;
}
int socket(int domain, int type, int protocol) noexcept {
    return called("socket", [&] { return real(&::socket, "socket")(domain, type, protocol); });
}
int connect(int descriptor, const sockaddr* address, socklen_t length) {
    return called("connect", [&] { return real(&::connect, "connect")(descriptor, address, length); });
}

}  // extern "C"
