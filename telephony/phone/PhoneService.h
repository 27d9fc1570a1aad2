#pragma once

#include <functional>
#include <string>
#include <vector>

#include "telephony/phone/PhoneState.h"

namespace kelvo::phone {

/// A service of the phone's system that knows the phone. Main queue only; nothing here waits.
class PhoneService {
public:
    virtual ~PhoneService() = default;

    /// Follows the phone from now on. `changed` is called whenever phone(), trouble() or lacks() tell something new.
    /// Called once.
    virtual void follow(std::function<void()> changed) = 0;
    /// Somebody wants the cells and levels, once a second; or nobody does any more.
    virtual void measure(bool wanted) = 0;
    /// The program ends: what was asked for is given back, and `done` called, in a second at most.
    virtual void release(std::function<void()> done) = 0;

    virtual const PhoneState& phone() const = 0;
    /// What it is, for people, without identities: "ModemManager's first modem".
    virtual std::string description() const = 0;
    /// Why there is nothing, or less than there may be: "ModemManager does not run"; empty when nothing is wrong.
    virtual std::string trouble() const = 0;
    /// What cannot be had of a phone that is there, a line each: "cell information: …".
    virtual std::vector<std::string> lacks() const = 0;
};

}  // namespace kelvo::phone
