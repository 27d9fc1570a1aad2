#include "telephony/recordings/RecordingFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <zlib.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <limits>

namespace kelvo {

namespace {

constexpr unsigned kBuffer = 256 * 1024;  // of zlib, for packed bytes

Failure failed(const std::string& path, int error) { return {path + " cannot be read: " + std::strerror(error)}; }

gzFile handleOf(void* handle) { return static_cast<gzFile>(handle); }

ssize_t readStream(void* cookie, char* bytes, std::size_t size) {
    auto& file = *static_cast<RecordingFile*>(cookie);
    const auto got = file.read({reinterpret_cast<std::uint8_t*>(bytes), size});
    if (got && *got == 0 && size != 0 && file.isCut()) {  // a reader must not take this for the file's end
        errno = EIO;
        return -1;
    }
    return got ? static_cast<ssize_t>(*got) : -1;
}

int closeStream(void* cookie) {
    delete static_cast<RecordingFile*>(cookie);
    return 0;
}

}  // namespace

void RecordingFile::Closer::operator()(void* handle) const { gzclose(handleOf(handle)); }

Result<RecordingFile> RecordingFile::open(const std::string& path) {
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return failed(path, errno);
    struct stat status {};
    if (::fstat(fd, &status) == 0 && S_ISDIR(status.st_mode)) {
        ::close(fd);
        return failed(path, EISDIR);
    }
    const gzFile handle = gzdopen(fd, "rb");
    if (handle == nullptr) {
        ::close(fd);
        return failed(path, ENOMEM);
    }
    gzbuffer(handle, kBuffer);
    return RecordingFile(path, std::unique_ptr<void, Closer>(handle));
}

Result<std::size_t> RecordingFile::read(std::span<std::uint8_t> bytes) {
    std::size_t total = 0;
    while (total < bytes.size() && !_cut) {
        const auto wanted =
            static_cast<unsigned>(std::min<std::size_t>(bytes.size() - total, std::numeric_limits<int>::max()));
        errno = 0;
        const int got = gzread(handleOf(_handle.get()), bytes.data() + total, wanted);
        int error = Z_OK;
        gzerror(handleOf(_handle.get()), &error);
        if (got > 0) total += static_cast<std::size_t>(got);
        // A packed file that ends too early, or goes on as something else, is as good as it was until there.
        if (error == Z_BUF_ERROR || error == Z_DATA_ERROR) _cut = true;
        if (error == Z_ERRNO) return failed(_path, errno);
        if (got <= 0) break;
    }
    return total;
}

std::FILE* RecordingFile::stream(RecordingFile file) {
    auto cookie = std::make_unique<RecordingFile>(std::move(file));
    std::FILE* stream =
        fopencookie(cookie.get(), "rb", {.read = readStream, .write = nullptr, .seek = nullptr, .close = closeStream});
    if (stream != nullptr) static_cast<void>(cookie.release());  // the stream has it now
    return stream;
}

}  // namespace kelvo
