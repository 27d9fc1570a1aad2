#include "platform/system/OutputFile.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <system_error>
#include <utility>

namespace kelvo {
namespace {

constexpr std::size_t kStem = 200;  // bytes of the name that its temporary one begins with; a name has 255 at most

std::string errorText(int error) { return std::generic_category().message(error); }

/// The state of what `path` leads to; none when nothing is there.
std::optional<struct stat> statusOf(const std::string& path) {
    struct stat status {};
    return ::stat(path.c_str(), &status) == 0 ? std::optional(status) : std::nullopt;
}

bool isThere(const std::string& path) {
    struct stat status {};
    return ::lstat(path.c_str(), &status) == 0;
}

bool isDeviceOrPipe(const std::string& path) {
    const auto status = statusOf(path);
    return status && !S_ISREG(status->st_mode) && !S_ISDIR(status->st_mode);
}

/// Where a file must lie to be found at `path`: a link stays, and what it leads to is replaced.
std::filesystem::path placeOf(const std::string& path) {
    std::error_code error;
    const auto place = std::filesystem::canonical(path, error);
    return error ? std::filesystem::path(path) : place;
}

std::filesystem::path directoryOf(const std::filesystem::path& place) {
    return place.has_parent_path() ? place.parent_path() : ".";
}

/// Renames a file unless the name is taken; errno says why not. Not every network file system can, but those have hard
/// links.
bool nameUnlessTaken(const std::string& from, const std::string& to) {
    if (::renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0) return true;
    return (errno == EINVAL || errno == ENOSYS) && ::link(from.c_str(), to.c_str()) == 0 && ::unlink(from.c_str()) == 0;
}

}  // namespace

void OutputFile::Remover::operator()(const std::string* path) const {
    ::unlink(path->c_str());
    delete path;
}

Result<OutputFile> OutputFile::create(std::string path, OutputTerms terms) {
    OutputFile file(std::move(path), std::move(terms));
    if (auto allowed = file.check(); !allowed) return allowed.error();
    if (isDeviceOrPipe(file._path)) {
        if (auto opened = file.open(); !opened) return opened.error();
    } else if (::access(directoryOf(placeOf(file._path)).c_str(), W_OK | X_OK) != 0) {
        return file.failed(errno);
    }
    return file;
}

Result<void> OutputFile::write(ByteView bytes) {
    if (auto opened = open(); !opened) return opened;
    if (std::fwrite(bytes.data(), 1, bytes.size(), _file.get()) == bytes.size()) return {};
    return failed(errno);
}

Result<void> OutputFile::appear() {
    if (auto opened = open(); !opened) return opened;
    if (!_temporary) return {};
    if (::fsync(::fileno(_file.get())) != 0 && errno != EINVAL) return failed(errno);  // not every file system can
    if (auto allowed = check(); !allowed) return allowed;
    const bool named = _terms.replace ? ::rename(_temporary->c_str(), placeOf(_path).c_str()) == 0
                                      : nameUnlessTaken(*_temporary, _path);
    if (!named) return failed(errno);
    delete _temporary.release();
    return {};
}

Result<std::string> OutputFile::place() {
    if (auto opened = open(); !opened) return opened.error();
    if (!_temporary) return Failure{_path + " is no file, and cannot be written piece by piece"};
    return *_temporary;
}

Result<std::FILE*> OutputFile::stream() {
    if (auto opened = open(); !opened) return opened.error();
    const int fd = ::fcntl(::fileno(_file.get()), F_DUPFD_CLOEXEC, 0);
    std::FILE* made = fd < 0 ? nullptr : ::fdopen(fd, "wb");
    if (made == nullptr) return failed(errno);
    return made;
}

Result<void> OutputFile::check() const {
    const auto there = statusOf(_path);
    if (!there && !isThere(_path)) return {};
    if (there && S_ISDIR(there->st_mode)) return failed(EISDIR);
    if (there && !S_ISREG(there->st_mode)) return {};
    const bool isRead = there && std::ranges::any_of(_terms.beingRead, [&there](const std::string& path) {
                            const auto read = statusOf(path);
                            return read && read->st_dev == there->st_dev && read->st_ino == there->st_ino;
                        });
    if (isRead) return Failure{_path + " is the file being read"};
    if (!_terms.replace) return Failure{_path + " exists already; --force replaces it"};
    return {};
}

Result<void> OutputFile::open() {
    if (_file) return {};
    int fd = -1;
    if (isDeviceOrPipe(_path)) {
        fd = ::open(_path.c_str(), O_WRONLY | O_CLOEXEC);
    } else {
        const auto place = placeOf(_path);
        const std::string wanted = place.filename();
        std::string name = directoryOf(place) / fmt::format(".{}.XXXXXX", std::string_view(wanted).substr(0, kStem));
        fd = ::mkostemp(name.data(), O_CLOEXEC);  // new, so that it follows no link, and for this user alone
        if (fd >= 0) _temporary.reset(new std::string(std::move(name)));
    }
    _file.reset(fd < 0 ? nullptr : ::fdopen(fd, "wb"));
    if (!_file) return failed(errno);
    std::setvbuf(_file.get(), nullptr, _IONBF, 0);  // a full disk shows at the bytes that no longer fit
    return {};
}

Failure OutputFile::failed(int error) const { return {_path + " cannot be written: " + errorText(error)}; }

Result<void> writeFile(const std::string& path, ByteView bytes, OutputTerms terms) {
    auto file = OutputFile::create(path, std::move(terms));
    if (!file) return file.error();
    if (auto written = file->write(bytes); !written) return written;
    return file->appear();
}

}  // namespace kelvo
