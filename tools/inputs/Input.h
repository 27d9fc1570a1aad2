#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/host/Capture.h"
#include "platform/telephony/Technology.h"
#include "platform/values/Result.h"
#include "telephony/recordings/RecordingKind.h"

namespace kelvo {

/// Where an input's records come from, one after another.
class InputRecords {
public:
    virtual ~InputRecords() = default;
    /// The next record, none after the last; a failure where and why nothing more can be read.
    virtual Result<std::optional<CapturePacket>> next() = 0;
    /// How much of the input has been read, from 0 to 1; none when nobody knows how long it is.
    virtual std::optional<double> portion() const { return std::nullopt; }
    /// What was not given: damaged stretches, refused records. One sentence each.
    virtual std::vector<std::string> leftOut() const { return {}; }
};

/// What a user hands a command to read, told by its content: a capture, packed with gzip or not, a saved snapshot, or a
/// recording of another tool (a stream of frames, a DLF file), or "-", a capture from standard input. It gives the
/// records of one technology, each as the service would deliver it, with their times. What was recorded by others comes
/// in the layouts that Kelvo shows.
///
/// Streaming: a capture of any length takes the same memory, and a pipe's records come as they are written. Recordings
/// of others are read twice, to tell their technology first. Moves, never copies. Any thread, one at a time.
class Input {
public:
    /// Opens what lies at `path`; `chosen` is what the user says about its technology. A failure's reason names the
    /// file, which may hold no records, or none of that technology.
    static Result<Input> open(const std::string& path, std::optional<Technology> chosen = {});
    /// The same for commands that read captures alone: whatever else the file is, the failure tells.
    static Result<Input> openCapture(const std::string& path, std::optional<Technology> chosen = {});

    /// The path, or "standard input".
    const std::string& name() const { return _name; }
    RecordingKind kind() const { return _kind; }
    /// Whose records it gives: the technology that was chosen, or else the one that the input tells.
    Technology technology() const { return _technology; }
    /// What a capture's link type tells; none for one that names no technology, and for what is no capture.
    std::optional<Technology> technologyTold() const { return _told; }

    /// The next record; its bytes hold until the one after it. None at the end, and where the input breaks off.
    std::optional<CapturePacket> next();
    /// How many records were given: the number of the last one, from 1.
    std::uint64_t count() const { return _count; }
    /// Where and why the input can be read no further; none before that, and for one that ends as it should.
    const std::optional<Failure>& breakOff() const { return _breakOff; }
    /// How much of it has been read, from 0 to 1; none when nobody knows how long it is.
    std::optional<double> portion() const { return _records->portion(); }
    /// What is not among the records though the input has it, a sentence each that names the file; known at the end.
    std::vector<std::string> leftOut() const { return _records->leftOut(); }

private:
    Input(std::string name, RecordingKind kind, Technology technology, std::optional<Technology> told,
          std::unique_ptr<InputRecords> records)
        : _name(std::move(name)), _kind(kind), _technology(technology), _told(told), _records(std::move(records)) {}
    static Result<Input> of(std::string name, Result<CaptureReader> capture, std::optional<Technology> chosen,
                            std::optional<std::uint64_t> size = {});
    static Result<Input> ofSnapshot(const std::string& path, std::optional<Technology> chosen);
    static Result<Input> ofRecording(const std::string& path, RecordingKind kind, std::optional<Technology> chosen);

    std::string _name;
    RecordingKind _kind;
    Technology _technology;
    std::optional<Technology> _told;
    std::unique_ptr<InputRecords> _records;
    std::uint64_t _count = 0;
    std::optional<Failure> _breakOff;
};

/// Whether what lies at `path` can be read once alone: standard input, a pipe.
bool isReadOnce(const std::string& path);

/// The files behind inputs' names, for outputs that must not replace them.
std::vector<std::string> filesOf(std::vector<std::string> paths);

}  // namespace kelvo
