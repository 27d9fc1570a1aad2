#pragma once

#include <signal.h>
#include <sys/resource.h>

namespace kelvo::test {

/// Lets no file of this process grow beyond `bytes` while it lives, as a full disk would.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes) {
        ::signal(SIGXFSZ, SIG_IGN);  // a write fails instead
        ::getrlimit(RLIMIT_FSIZE, &_before);
        const rlimit small{bytes, _before.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &small);
    }
    ~FileSizeLimit() { ::setrlimit(RLIMIT_FSIZE, &_before); }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;

private:
    rlimit _before{};
};

}  // namespace kelvo::test
