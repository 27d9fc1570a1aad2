#pragma once

#include <span>
#include <string>

#include "platform/values/Bytes.h"

namespace kelvo {

/// Why a line cannot be opened whose far end is not there: no news of a modem that has gone.
inline constexpr const char* kNobodyIsThere = "nobody is there";

/// A way to a modem's diagnostic port. Opened once; whoever wants to open it again makes another. Main queue only.
class ModemLine {
public:
    /// Whoever uses the line. It may mute the line during these calls, but must not destroy it.
    class Listener {
    public:
        virtual ~Listener() = default;
        virtual void lineOpened() = 0;
        /// What the modem sent; the bytes may be written to.
        virtual void lineGave(std::span<std::uint8_t> bytes) = 0;
        /// The line could not be opened, or its modem has gone; nothing more comes.
        virtual void lineClosed(const std::string& reason) = 0;
    };

    virtual ~ModemLine() = default;

    /// Where it leads to, for people: "/dev/ttyUSB2".
    virtual std::string name() const = 0;
    /// Begins to open it; the listener hears how that went, during the call or later.
    virtual void open() = 0;
    /// Sends one frame; it goes at the modem's pace.
    virtual void send(ByteView frame) = 0;
    /// Whether what comes may gather for some milliseconds before it is given, since nobody waits for an answer; not at
    /// first.
    virtual void mayGather(bool) {}
    /// The listener hears nothing of it any more. The port itself is closed with the line.
    virtual void mute() = 0;
};

}  // namespace kelvo
