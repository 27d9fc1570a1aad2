#pragma once

#include <memory>

#include "platform/system/MessagePorts.h"

namespace kelvo {

/// The user's window of the live screens, of which there is one: a second start brings it to the front.
class FirstWindow {
public:
    /// Takes the place of the first window, or asks the program that has it to come to the front. `ports` outlives it.
    explicit FirstWindow(MessagePorts& ports);

    /// True when another program has it, and has answered: there is nothing left to do.
    bool isElsewhere() const { return _isElsewhere; }

private:
    std::unique_ptr<LocalPort> _port;
    bool _isElsewhere = false;
};

}  // namespace kelvo
