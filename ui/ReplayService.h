#pragma once

#include <QProcess>
#include <QTemporaryDir>
#include <filesystem>
#include <memory>
#include <string>

#include "platform/values/Result.h"

namespace kelvo {

/// A telephony service of the application's own that replays a capture in a loop: what a window shows that was opened
/// for a file. It ends with this object, or with the application however that ends. Needs a QCoreApplication.
class ReplayService {
public:
    /// Starts `program` and waits until it listens, some hundredths of a second; a failure's reason is the service's
    /// own.
    static Result<std::unique_ptr<ReplayService>> start(const std::filesystem::path& program,
                                                        const std::string& capture);
    ~ReplayService();
    ReplayService(const ReplayService&) = delete;
    ReplayService& operator=(const ReplayService&) = delete;

    /// Where its message ports are, away from those of a service that runs already.
    std::filesystem::path portDirectory() const;

private:
    ReplayService() = default;

    QTemporaryDir _runtime;
    QProcess _service;
};

}  // namespace kelvo
