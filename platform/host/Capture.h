#pragma once

#include <chrono>
#include <filesystem>
#include <memory>
#include <optional>

#include "platform/system/OutputFile.h"
#include "platform/telephony/Technology.h"
#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

struct pcap;
struct pcap_dumper;

namespace kelvo {

/// When a packet was taken. Captures hold it in microseconds or nanoseconds.
using CaptureTime = std::chrono::sys_time<std::chrono::nanoseconds>;

/// One packet of a capture: one log message exactly as the service delivers it.
struct CapturePacket {
    CaptureTime time;
    ByteView bytes;  ///< valid until the next packet is read or the reader goes
};

namespace detail {
struct PcapCloser {
    void operator()(pcap* handle) const;
};
using PcapHandle = std::unique_ptr<pcap, PcapCloser>;
}  // namespace detail

/// Reads a classic pcap file (either byte order, microseconds or nanoseconds) packet by packet. The link type names the
/// technology: LINKTYPE_USER0 to LINKTYPE_USER4 are IFX, GSM/UMTS, CDMA, LTE and UTRAN.
/// Moves, never copies. Any thread, one at a time. A failure's reason names the file.
class CaptureReader {
public:
    /// Opens the file and reads its header. A pipe will do.
    static Result<CaptureReader> open(const std::filesystem::path& path);
    /// The same of a stream, which the reader owns from now on; failures call it `name`.
    static Result<CaptureReader> open(std::string name, std::FILE* file);

    /// The technology that the link type names; none for another link type.
    std::optional<Technology> technology() const;

    /// The next packet, or none at the end of the file. A packet that the file cuts short (its capture length is below
    /// its length), that is longer than a message can be, or that the file ends within is a failure; after a failure
    /// and after the end nothing more can be read.
    Result<std::optional<CapturePacket>> next();

private:
    CaptureReader(std::string name, detail::PcapHandle handle) : _name(std::move(name)), _handle(std::move(handle)) {}

    std::string _name;
    detail::PcapHandle _handle;
    std::size_t _count = 0;  // packets asked for so far
};

/// Writes a classic pcap file in this machine's byte order, with microseconds.
/// Moves, never copies. Any thread, one at a time. A failure's reason names the file.
class CaptureWriter {
public:
    /// When packets reach the file.
    enum class Flush {
        EachPacket,  ///< at once: a full disk shows at the packet that no longer fits, and what was written is whole
        WhenWhole,   ///< at the latest when the file appears, in large pieces
    };

    /// Begins the capture in `file` with its header.
    static Result<CaptureWriter> create(OutputFile file, Technology technology, Flush flush = Flush::EachPacket);
    CaptureWriter(CaptureWriter&&) noexcept = default;
    CaptureWriter& operator=(CaptureWriter&&) noexcept = default;

    /// Appends one packet; when each is flushed it has reached the file when this succeeds. On a failure (a full disk,
    /// a message longer than any the service delivers) the file keeps the packets before it, whole.
    Result<void> append(CaptureTime time, ByteView bytes);
    /// Gives the file its name, when it is whole or as early as others may read along.
    Result<void> appear();

private:
    struct DumperCloser {
        void operator()(pcap_dumper* dumper) const;
    };
    CaptureWriter(OutputFile file, Flush flush, detail::PcapHandle handle,
                  std::unique_ptr<pcap_dumper, DumperCloser> dumper)
        : _file(std::move(file)), _flush(flush), _handle(std::move(handle)), _dumper(std::move(dumper)) {}
    Result<void> flush();

    OutputFile _file;
    Flush _flush;
    detail::PcapHandle _handle;
    std::unique_ptr<pcap_dumper, DumperCloser> _dumper;
    long _length = 0;  // of the file, up to the end of its last whole packet
};

}  // namespace kelvo
