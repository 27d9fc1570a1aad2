#pragma once

#include <optional>
#include <string>

#include "model/KelvoModel.h"
#include "tools/export/DisplayReadings.h"

namespace kelvo {

/// Hands on the readings of the running service, over lost connections and restarts. A record's time is the modem's own
/// where its clock is set, else that of its arrival. Main queue only.
class LiveReadings {
public:
    /// What the model of these readings stands on, and where they go; all of it outlives the object.
    struct Services {
        MainQueue& queue;
        MessagePorts& ports;
        TelephonyClient& telephony;
        std::function<void(const std::string& why)> tell;  ///< why no records come, once each time
    };
    LiveReadings(const Services& services, const Choice& choice, ValueGlobs& globs, ReadingRows& rows);

    /// Hands on what waits; what was read until now.
    ReadInput end();

private:
    void take(ByteView message);
    void tellConnection();

    const Choice _choice;
    ValueGlobs& _globs;
    ReadingRows& _rows;
    std::function<void(const std::string&)> _tell;
    ReadInput _read{.name = "live"};
    std::optional<DisplayReadings> _readings;  // from the first record on
    std::string _told;
    bool _isSilent = false;
    KelvoModel _model;
};

/// Reads the service of this machine until Ctrl-C; standard error tells why no records come.
void readLive(const Choice& choice, ValueGlobs& globs, ReadingRows& rows);

}  // namespace kelvo
