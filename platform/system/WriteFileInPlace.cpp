#include "platform/system/WriteFileInPlace.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <memory>
#include <system_error>

namespace kelvo {
namespace {

struct FileCloser {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, FileCloser>;

Failure failed(int error) { return {std::generic_category().message(error)}; }

bool isOwnFile(const struct stat& status) { return S_ISREG(status.st_mode) && status.st_uid == ::geteuid(); }

/// Empties what is there only after a look at it. A pipe that somebody left there does not hold the caller up.
File openOwnFile(const std::string& path) {
    const int fd = ::open(path.c_str(), O_WRONLY | O_CREAT | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC, S_IRUSR | S_IWUSR);
    if (fd < 0) return nullptr;
    File file(::fdopen(fd, "wb"));
    struct stat status {};
    if (::fstat(fd, &status) != 0) return nullptr;
    if (!isOwnFile(status)) {
        file.reset();
        errno = EPERM;
        return nullptr;
    }
    if (::ftruncate(fd, 0) != 0) return nullptr;
    return file;
}

}  // namespace

Result<void> writeFileInPlace(const std::string& path, ByteView bytes) {
    File file = openOwnFile(path);
    if (!file) return failed(errno);
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), file.get()) == bytes.size();
    const int writeError = errno;
    const bool closed = std::fclose(file.release()) == 0;  // a full disk may show only here
    if (written && closed) return {};
    const Failure failure = failed(written ? errno : writeError);
    ::unlink(path.c_str());  // a plain file of this user, as it was opened
    return failure;
}

}  // namespace kelvo
