#pragma once

#include <memory>
#include <string>

#include "platform/system/MessagePorts.h"

namespace kelvo {

/// The user's window of the live screens, or of one file, of which there is one each: a second start brings it to the
/// front.
class FirstWindow {
public:
    static constexpr const char* kLive = "org.kelvo.Kelvo.FirstWindow";

    /// Takes the place of the first window, or asks the program that has it to come to the front. `ports` outlives it.
    FirstWindow(MessagePorts& ports, const std::string& name);

    /// True when another program has it, and has answered: there is nothing left to do.
    bool isElsewhere() const { return _isElsewhere; }

private:
    std::unique_ptr<LocalPort> _port;
    bool _isElsewhere = false;
};

}  // namespace kelvo
