#pragma once

#include <unistd.h>

#include <utility>

namespace kelvo {

/// An open file descriptor; closed with its owner. -1 is none.
class UniqueFd {
public:
    UniqueFd() = default;
    explicit UniqueFd(int fd) : _fd(fd) {}
    UniqueFd(UniqueFd&& other) noexcept : _fd(std::exchange(other._fd, -1)) {}
    UniqueFd& operator=(UniqueFd&& other) noexcept {
        if (this != &other) reset(std::exchange(other._fd, -1));
        return *this;
    }
    ~UniqueFd() { reset(); }

    explicit operator bool() const { return _fd >= 0; }
    int get() const { return _fd; }
    void reset(int fd = -1) {
        if (_fd >= 0) ::close(_fd);
        _fd = fd;
    }

private:
    int _fd = -1;
};

}  // namespace kelvo
