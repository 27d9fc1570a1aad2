#pragma once

#include <functional>
#include <memory>
#include <string>

class QFileSystemWatcher;

namespace kelvo {

/// Tells when something changes in the directory of a path, or in the nearest one that there is: the node may have
/// come. Main queue only.
class PathWatch {
public:
    PathWatch(const std::string& path, std::function<void()> changed);
    ~PathWatch();

private:
    QFileSystemWatcher* _watcher;  // outlives this object by the rest of its own signal
};

}  // namespace kelvo
