#pragma once

#include <cstdio>
#include <memory>
#include <span>
#include <string>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// A file that somebody recorded, read from its beginning to its end; what was packed with gzip comes unpacked.
/// Moves, never copies. Any thread, one at a time. A failure's reason names the file.
class RecordingFile {
public:
    static Result<RecordingFile> open(const std::string& path);

    const std::string& path() const { return _path; }
    /// Fills `bytes` from where the last read ended; fewer than asked for are the file's last. A file that ends amidst
    /// its packed data gives what came before as its last, and `isCut` tells.
    Result<std::size_t> read(std::span<std::uint8_t> bytes);
    bool isCut() const { return _cut; }

    /// The same as a stream for a library that wants one, which takes the file over. Where packed data are cut, reading
    /// it fails.
    static std::FILE* stream(RecordingFile file);

private:
    struct Closer {
        void operator()(void* handle) const;
    };
    RecordingFile(std::string path, std::unique_ptr<void, Closer> handle)
        : _path(std::move(path)), _handle(std::move(handle)) {}

    std::string _path;
    std::unique_ptr<void, Closer> _handle;  // zlib's
    bool _cut = false;
};

}  // namespace kelvo
