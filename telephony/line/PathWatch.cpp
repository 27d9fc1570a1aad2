#include "telephony/line/PathWatch.h"

#include <QFileSystemWatcher>
#include <filesystem>

#include "platform/host/HostEventLoop.h"

namespace kelvo {

PathWatch::PathWatch(const std::string& path, std::function<void()> changed) : _watcher(new QFileSystemWatcher) {
    std::error_code error;
    std::filesystem::path directory = std::filesystem::absolute(path, error).parent_path();
    while (!std::filesystem::is_directory(directory, error) && directory.has_relative_path())
        directory = directory.parent_path();
    QObject::connect(_watcher, &QFileSystemWatcher::directoryChanged, _watcher,
                     [call = std::move(changed)] { HostEventLoop::call(call); });
    _watcher->addPath(QString::fromStdString(directory));
}

PathWatch::~PathWatch() {
    _watcher->disconnect();
    _watcher->deleteLater();
}

}  // namespace kelvo
