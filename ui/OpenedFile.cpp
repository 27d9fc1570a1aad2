#include "ui/OpenedFile.h"

#include <fmt/format.h>
#include <sys/stat.h>

#include <QUrl>
#include <cerrno>
#include <fstream>
#include <functional>
#include <system_error>

#include "platform/encodings/PropertyList.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {
namespace {

constexpr std::size_t kBeginning = 1024;  // bytes that tell what a file is

Failure cannotOpen(const std::string& path, int error) {
    return {path + " cannot be opened: " + std::generic_category().message(error)};
}

/// The first `most` bytes of a file.
Result<Bytes> beginningOf(const std::string& path, std::size_t most) {
    std::ifstream file(path, std::ios::binary);
    if (!file) return cannotOpen(path, errno);
    Bytes bytes(most);
    file.read(reinterpret_cast<char*>(bytes.data()), static_cast<std::streamsize>(most));
    if (file.bad()) return Failure{path + " cannot be read"};
    bytes.resize(static_cast<std::size_t>(file.gcount()));
    return bytes;
}

/// The same file has the same name as long as nobody writes to it.
std::string windowOf(const struct stat& file) {
    const std::string identity = fmt::format("{}/{}/{}/{}.{}", file.st_dev, file.st_ino, file.st_size,
                                             file.st_mtim.tv_sec, file.st_mtim.tv_nsec);
    return fmt::format("org.kelvo.Kelvo.Snapshot.{:016x}", std::hash<std::string>()(identity));
}

Result<OpenedFile> openSnapshot(const std::string& path, const struct stat& file) {
    const auto size = static_cast<std::size_t>(file.st_size);
    if (size > kMaxPropertyListSize)
        return Failure{fmt::format("{} is not a snapshot: larger than {} bytes", path, kMaxPropertyListSize)};
    const auto bytes = beginningOf(path, size);
    if (!bytes) return bytes.error();
    const auto snapshot = SnapshotFile::read(path, *bytes);
    if (!snapshot) return snapshot.error();
    return OpenedFile{nullptr, std::make_shared<const SavedScreens>(*snapshot), windowOf(file)};
}

Result<OpenedFile> openCapture(const std::string& path, const std::filesystem::path& service) {
    auto replay = ReplayService::start(service, path);
    if (replay) return OpenedFile{std::move(replay).value(), nullptr, {}};
    if (path.ends_with(".kelvo")) return Failure{path + " is neither a snapshot nor a capture"};
    return replay.error();
}

Result<OpenedFile> openAt(const std::string& path, const std::filesystem::path& service) {
    struct stat file {};
    if (::stat(path.c_str(), &file) != 0) return cannotOpen(path, errno);
    if (S_ISDIR(file.st_mode)) return Failure{path + " is a directory"};
    if (!S_ISREG(file.st_mode)) return openCapture(path, service);  // a pipe gives its bytes once
    const auto beginning = beginningOf(path, kBeginning);
    if (!beginning) return beginning.error();
    if (beginning->empty()) return Failure{path + " is empty"};
    return beginsPropertyList(*beginning) ? openSnapshot(path, file) : openCapture(path, service);
}

}  // namespace

Result<OpenedFile> OpenedFile::open(const std::string& path, const std::filesystem::path& service) {
    auto opened = openAt(path, service);
    if (!opened) return Failure{printable(opened.error().reason)};
    return opened;
}

std::string pathFromArgument(const std::string& argument) {
    if (!argument.starts_with("file://")) return argument;
    const QString path = QUrl::fromEncoded(QByteArray::fromStdString(argument)).toLocalFile();
    return path.isEmpty() ? argument : path.toStdString();
}

}  // namespace kelvo
