#include "platform/host/Capture.h"

#include <fmt/format.h>
#include <pcap/pcap.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <system_error>

#include "platform/system/MessagePorts.h"

namespace kelvo {

namespace {

constexpr std::size_t kBuffer = std::size_t{1} << 20;

std::string errorText(int error) { return std::generic_category().message(error); }

/// Why a freshly opened file is no classic pcap file, as far as its first byte tells; none when it may be one.
std::optional<std::string> refusal(std::FILE* file) {
    const int first = std::fgetc(file);
    if (first == EOF) return std::ferror(file) != 0 ? "cannot be read: " + errorText(errno) : "is empty";
    if (first == 0x0a) return "is a pcapng file; captures are classic pcap files (editcap -F pcap converts it)";
    std::ungetc(first, file);
    return std::nullopt;
}

}  // namespace

void detail::PcapCloser::operator()(pcap* handle) const { pcap_close(handle); }

Result<CaptureReader> CaptureReader::open(const std::filesystem::path& path) {
    std::string name = path.string();
    std::FILE* file = std::fopen(name.c_str(), "rb");
    if (file == nullptr) return Failure{fmt::format("{} cannot be opened: {}", name, errorText(errno))};
    return open(std::move(name), file);
}

Result<CaptureReader> CaptureReader::open(std::string name, std::FILE* file) {
    if (const auto reason = refusal(file)) {
        std::fclose(file);
        return Failure{name + " " + *reason};
    }
    std::array<char, PCAP_ERRBUF_SIZE> error{};
    detail::PcapHandle handle(pcap_fopen_offline_with_tstamp_precision(file, PCAP_TSTAMP_PRECISION_NANO, error.data()));
    if (!handle) {
        std::fclose(file);
        return Failure{fmt::format("{} is not a pcap file: {}", name, error.data())};
    }
    return CaptureReader(std::move(name), std::move(handle));
}

std::optional<Technology> CaptureReader::technology() const {
    return technologyBy(&TechnologyNames::linkType, pcap_datalink(_handle.get()));
}

Result<std::optional<CapturePacket>> CaptureReader::next() {
    ++_count;
    pcap_pkthdr* header = nullptr;
    const unsigned char* bytes = nullptr;
    const int status = pcap_next_ex(_handle.get(), &header, &bytes);
    if (status == PCAP_ERROR_BREAK) return std::optional<CapturePacket>();
    if (status != 1) {
        return Failure{fmt::format("{} cannot be read at packet {}: {}", _name, _count, pcap_geterr(_handle.get()))};
    }
    if (header->caplen != header->len) {
        return Failure{fmt::format("{} holds {} of the {} bytes of packet {}; captures hold whole messages", _name,
                                   header->caplen, header->len, _count)};
    }
    if (header->caplen > kMaxMessageSize) {
        return Failure{fmt::format("{} holds {} bytes in packet {}; a message has at most {}", _name, header->caplen,
                                   _count, kMaxMessageSize)};
    }
    // Read with nanosecond precision, the field named for microseconds holds nanoseconds.
    const CaptureTime time{std::chrono::seconds(header->ts.tv_sec) + std::chrono::nanoseconds(header->ts.tv_usec)};
    return std::optional(CapturePacket{time, ByteView(bytes, header->caplen)});
}

void CaptureWriter::DumperCloser::operator()(pcap_dumper* dumper) const { pcap_dump_close(dumper); }

Result<CaptureWriter> CaptureWriter::create(OutputFile file, Technology technology, Flush flush) {
    const auto stream = file.stream();
    if (!stream) return stream.error();
    const bool each = flush == Flush::EachPacket;
    std::setvbuf(*stream, nullptr, each ? _IONBF : _IOFBF, each ? 0 : kBuffer);
    detail::PcapHandle handle(pcap_open_dead(namesOf(technology).linkType, static_cast<int>(kMaxMessageSize)));
    std::unique_ptr<pcap_dumper, DumperCloser> dumper(pcap_dump_fopen(handle.get(), *stream));
    if (!dumper) {  // the header did not fit; libpcap has closed the stream
        return Failure{fmt::format("{} cannot be written: {}", file.path(), pcap_geterr(handle.get()))};
    }
    CaptureWriter writer(std::move(file), flush, std::move(handle), std::move(dumper));
    if (const auto flushed = writer.flush(); !flushed) return flushed.error();
    return writer;
}

Result<void> CaptureWriter::append(CaptureTime time, ByteView bytes) {
    if (bytes.size() > kMaxMessageSize) {
        return Failure{
            fmt::format("{} takes messages of at most {} bytes, not {}", _file.path(), kMaxMessageSize, bytes.size())};
    }
    const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
    pcap_pkthdr header{};
    header.ts.tv_sec = seconds.time_since_epoch().count();
    header.ts.tv_usec = std::chrono::duration_cast<std::chrono::microseconds>(time - seconds).count();
    header.caplen = header.len = static_cast<bpf_u_int32>(bytes.size());
    pcap_dump(reinterpret_cast<unsigned char*>(_dumper.get()), &header, bytes.data());
    return _flush == Flush::EachPacket ? flush() : Result<void>();
}

Result<void> CaptureWriter::appear() {
    pcap_dump_flush(_dumper.get());
    if (const auto flushed = flush(); !flushed) return flushed;
    return _file.appear();
}

Result<void> CaptureWriter::flush() {
    std::FILE* file = pcap_dump_file(_dumper.get());
    if (std::ferror(file) == 0) {
        _length = std::ftell(file);
        return {};
    }
    Failure failure{fmt::format("{} cannot be written: {}", _file.path(), errorText(errno))};
    // A packet that only half fits would make the whole file end in an error, so its beginning goes again. What cannot
    // be cut, a pipe or a device, stays as it is.
    std::clearerr(file);
    if (ftruncate(fileno(file), _length) == 0) std::fseek(file, _length, SEEK_SET);
    return failure;
}

}  // namespace kelvo
