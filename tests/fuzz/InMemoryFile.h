#pragma once

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <string>

#include "platform/values/Bytes.h"

namespace kelvo::fuzz {

/// A file that never reaches a disk, for readers that take a path.
class InMemoryFile {
public:
    explicit InMemoryFile(ByteView content) : _fd(::memfd_create("fuzz", MFD_CLOEXEC)) {
        for (std::size_t at = 0; at < content.size();) {
            const ssize_t count = ::write(_fd, content.data() + at, content.size() - at);
            if (count <= 0) break;
            at += static_cast<std::size_t>(count);
        }
    }
    ~InMemoryFile() { ::close(_fd); }
    InMemoryFile(const InMemoryFile&) = delete;
    InMemoryFile& operator=(const InMemoryFile&) = delete;

    std::string path() const { return "/proc/self/fd/" + std::to_string(_fd); }

private:
    const int _fd;
};

}  // namespace kelvo::fuzz
