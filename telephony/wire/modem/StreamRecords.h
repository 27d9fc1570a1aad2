#pragma once

#include <memory>

#include "telephony/RecordStream.h"
#include "telephony/wire/modem/ModemRecords.h"

namespace kelvo::modem {

/// The modem's records of a capture or a simulation, without the frame that the service gives them. What the phone's
/// own services add (codes of 0xff0000 and above) is not the modem's, and left out, and so is what is no record. A
/// length that is not the record's own is put right: no modem sends it.
class StreamRecords final : public ModemRecords {
public:
    explicit StreamRecords(std::unique_ptr<RecordStream> stream) : _stream(std::move(stream)) {}
    std::optional<ModemRecord> next() override;

private:
    const std::unique_ptr<RecordStream> _stream;
    std::optional<CaptureTime> _first;
    Bytes _record;
};

}  // namespace kelvo::modem
