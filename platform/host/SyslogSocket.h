#pragma once

#include <ctime>
#include <filesystem>
#include <string>
#include <string_view>

#include "platform/host/UniqueFd.h"

namespace kelvo {

/// Where the system's log daemon takes lines: a datagram socket, by syslog(3) always /dev/log. Writes what syslog(3)
/// writes, "<priority>Mar  7 22:35:20 program[process]: text". One thread only; sending waits for a daemon that is
/// busy.
class SyslogSocket {
public:
    SyslogSocket(std::filesystem::path path, std::string program);

    /// `severity` is LOG_ERR, LOG_WARNING and so on, `time` local. A line for a daemon that cannot be reached is lost;
    /// one that has started anew is found again.
    void send(int severity, const std::tm& time, std::string_view text);

private:
    bool connect();

    const std::filesystem::path _path;
    const std::string _program;
    UniqueFd _socket;
};

}  // namespace kelvo
