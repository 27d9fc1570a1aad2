#pragma once

#include <filesystem>
#include <fstream>
#include <memory>

#include "platform/values/Result.h"
#include "telephony/wire/FrameReader.h"
#include "telephony/wire/Timestamp.h"
#include "telephony/wire/modem/ModemRecords.h"

namespace kelvo::modem {

/// The records in a file of frames as a diagnostic port sent them, with the time between them that they say, but for
/// pauses of more than five seconds, which last five. Frames that are damaged, and those without a record, are left
/// out.
class FramesRecords final : public ModemRecords {
public:
    /// The reason of a failure names the file; a file without a single record is one.
    static Result<std::unique_ptr<FramesRecords>> open(const std::filesystem::path& path);

    std::optional<ModemRecord> next() override;

private:
    explicit FramesRecords(std::ifstream file) : _file(std::move(file)) {}
    std::optional<ModemRecord> read();
    bool fill();

    std::ifstream _file;
    Bytes _buffer;
    wire::MutableBytes _unread;  // of _buffer
    wire::FrameReader _reader;
    std::optional<ModemRecord> _first;      // read when the file was opened
    std::optional<wire::SystemTime> _last;  // the latest time that a record says
    std::chrono::nanoseconds _at{0};        // of the record read last
};

}  // namespace kelvo::modem
