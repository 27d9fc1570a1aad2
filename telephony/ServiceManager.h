#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/host/UniqueFd.h"
#include "platform/system/MainQueue.h"
#include "platform/values/Result.h"

namespace kelvo {

/// What the system's service manager has handed to this process and wants to hear of it. Without one there is nothing,
/// and nobody hears.
class ServiceManager {
public:
    using Tell = std::function<void(const std::string& state)>;

    /// Asks the environment; from then on child processes find nothing of it there.
    static ServiceManager ofEnvironment();
    ServiceManager(Tell tell, std::optional<std::chrono::microseconds> watchdog);

    /// The socket that listens at `path` for the service; empty when none was passed, a failure when another one was.
    static Result<UniqueFd> passedSocket(const std::filesystem::path& path);

    /// The service answers from now on, and says so twice in every interval of the manager's watchdog for as long as
    /// `queue` runs, which outlives this object: a service that hangs falls silent.
    void tellReady(const std::string& what, MainQueue& queue);
    /// It is about to end, which may take a while.
    void tellEnding();

private:
    Tell _tell;
    std::optional<std::chrono::microseconds> _watchdog;
    std::unique_ptr<RepeatingTimer> _alive;
};

}  // namespace kelvo
