#include "model/Snapshot.h"

#include <fcntl.h>
#include <fmt/printf.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <ctime>
#include <memory>
#include <utility>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

std::string utcText(Clock::TimePoint time) {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
    std::tm broken{};
    gmtime_r(&seconds, &broken);
    std::array<char, 64> text{};
    const std::size_t length = std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S +0000", &broken);
    return {text.data(), length};
}

struct FileCloser {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, FileCloser>;

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

File openAnyFile(const std::string& path) {
    const int fd = ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, S_IRUSR | S_IWUSR);
    return File(fd < 0 ? nullptr : ::fdopen(fd, "wb"));
}

/// A device or a pipe stays, and so does a link and what it leads to.
void removePlainFile(const std::string& path) {
    struct stat status {};
    if (::lstat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode)) ::unlink(path.c_str());
}

}  // namespace

DictionaryRef Snapshot::dictionary() const {
    DictionaryRef dictionary = Dictionary::make({{"Timestamp", utcText(timestamp)}});
    if (!data) return dictionary;
    dictionary->set("Data", data);
    if (description) dictionary->set("Description", *description);
    return dictionary;
}

Result<Bytes> Snapshot::propertyList() const { return writeXmlPropertyList(dictionary()); }

std::string Snapshot::pathInDirectory(std::string_view directory, Clock::TimePoint now) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(now.time_since_epoch()).count();
    return fmt::sprintf("%s/KelvoSnapshot-%d.kelvo", directory, seconds);
}

std::optional<Failure> writeFileInPlace(const std::string& path, ByteView bytes, WriteOver over) {
    File file = over == WriteOver::OwnFile ? openOwnFile(path) : openAnyFile(path);
    if (!file) return Failure{std::strerror(errno)};
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), file.get()) == bytes.size();
    const int writeError = errno;
    const bool closed = std::fclose(file.release()) == 0;  // a full disk may show only here
    if (written && closed) return std::nullopt;
    Failure failure{std::strerror(written ? errno : writeError)};
    removePlainFile(path);
    return failure;
}

}  // namespace kelvo
