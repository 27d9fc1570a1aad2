// Linked into the tests that an emulator runs. Qt starts programs by clone() with CLONE_PIDFD where waitid() knows
// P_PIDFD, and qemu-user knows the one but refuses the other. Here neither is known, and Qt forks.
#include <dlfcn.h>
#include <sys/syscall.h>
#include <sys/wait.h>

#include <cerrno>
#include <cstdarg>

extern "C" long syscall(long number, ...) noexcept {
    static const auto libraryCall = reinterpret_cast<long (*)(long, ...)>(dlsym(RTLD_NEXT, "syscall"));
    long arguments[6];
    va_list list;
    va_start(list, number);
    for (long& argument : arguments) argument = va_arg(list, long);
    va_end(list);
    if (number == SYS_waitid && arguments[0] == P_PIDFD) {
        errno = ENOSYS;
        return -1;
    }
    return libraryCall(number, arguments[0], arguments[1], arguments[2], arguments[3], arguments[4], arguments[5]);
}
