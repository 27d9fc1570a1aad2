#include "platform/host/HostPaths.h"

#include <sys/stat.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QStandardPaths>
#include <cstdlib>
#include <string>

namespace kelvo {
namespace {

bool isOwnDirectory(const char* path) {
    struct stat status {};
    return ::stat(path, &status) == 0 && S_ISDIR(status.st_mode) && status.st_uid == ::geteuid() &&
           (status.st_mode & (S_IRWXG | S_IRWXO)) == 0;
}

}  // namespace

std::filesystem::path HostPaths::resourcesDirectory() {
    const std::filesystem::path programs = QCoreApplication::applicationDirPath().toStdString();
    return (programs / "../share/kelvo").lexically_normal();
}

std::filesystem::path HostPaths::configDirectory() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation).toStdString();
}

std::filesystem::path HostPaths::portDirectory() {
    const char* runtime = std::getenv("XDG_RUNTIME_DIR");
    if (runtime != nullptr && runtime[0] == '/' && isOwnDirectory(runtime))
        return std::filesystem::path(runtime) / "kelvo/ports";
    return std::filesystem::path("/tmp") / ("kelvo-" + std::to_string(::geteuid())) / "ports";
}

}  // namespace kelvo
