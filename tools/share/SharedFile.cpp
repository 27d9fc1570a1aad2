#include "tools/share/SharedFile.h"

#include <array>
#include <memory>

#include "LogGenerator/Framing.h"
#include "platform/encodings/PropertyList.h"
#include "telephony/recordings/DlfRecording.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/recordings/RecordingFile.h"
#include "telephony/wire/FrameReader.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordFrame.h"
#include "telephony/wire/Wrapper.h"
#include "tools/CommandFailure.h"
#include "tools/share/SharedSnapshot.h"

namespace kelvo {

namespace {

constexpr std::size_t kPiece = 256 * 1024;

/// Collects small writes.
class Pieces {
public:
    explicit Pieces(OutputFile file) : _file(std::move(file)) {}

    void write(ByteView bytes) {
        _bytes.insert(_bytes.end(), bytes.begin(), bytes.end());
        if (_bytes.size() >= kPiece) flush();
    }
    void appear() {
        flush();
        orFail(_file.appear());
    }

private:
    void flush() {
        orFail(_file.write(_bytes));
        _bytes.clear();
    }

    OutputFile _file;
    Bytes _bytes;
};

/// Nothing appears of a file in which there is nothing to share.
void refuseEmpty(const std::string& in, const SharedFile& shared) {
    if (shared.records == 0 && (shared.read > 0 || shared.ends)) {
        throw CommandFailure(shared.ends.value_or(in + " holds nothing that can be shared"));
    }
}

SharedFile shareCapture(const std::string& in, RecordingFile input, OutputFile output,
                        std::optional<Technology> technology, RecordSharer& sharer) {
    std::FILE* const stream = RecordingFile::stream(std::move(input));
    if (stream == nullptr) throw CommandFailure(in + " cannot be opened: no memory");
    CaptureReader reader = orFail(CaptureReader::open(in, stream));
    technology = technology ? technology : reader.technology();
    if (!technology) throw CommandFailure(in + " names no technology that Kelvo knows; --technology says which it is");
    CaptureWriter writer =
        orFail(CaptureWriter::create(std::move(output), *technology, CaptureWriter::Flush::WhenWhole));
    SharedFile shared{.kind = RecordingKind::Capture};
    for (;;) {
        const auto packet = reader.next();
        if (!packet) shared.ends = packet.error().reason;
        if (!packet || !*packet) break;
        ++shared.read;
        const CaptureTime time = sharer.times().host((*packet)->time);
        const auto record = sharer.share((*packet)->bytes, *technology);
        if (!record) continue;
        orFail(writer.append(time, *record));
        ++shared.records;
    }
    refuseEmpty(in, shared);
    orFail(writer.appear());
    return shared;
}

/// What a frame is that carries no sound record.
std::string_view nameOf(ByteView body) {
    if (body.empty()) return "answer of the modem";
    switch (static_cast<wire::Command>(body.front())) {
        case wire::Command::Record: return "record whose lengths lie";
        case wire::Command::Event: return "event of the modem";
        case wire::Command::Text:
        case wire::Command::CompressedText:
        case wire::Command::CompressedText99:
        case wire::Command::Trace9C:
        case wire::Command::Trace9D: return "text of the modem";
        case wire::Command::EncryptedRecord: return "record that the modem has encrypted";
        default: return "answer of the modem";
    }
}

SharedFile shareFrames(const std::string& in, RecordingFile input, OutputFile output, RecordSharer& sharer) {
    SharedFile shared{.kind = RecordingKind::Frames};
    Pieces made(std::move(output));
    const auto piece = std::make_unique<std::array<std::uint8_t, kPiece>>();
    wire::FrameReader frames;
    while (const std::size_t got = orFail(input.read(*piece))) {
        wire::MutableBytes bytes(piece->data(), got);
        while (const auto body = frames.next(bytes)) {
            const auto record = framedRecord(*body);
            if (!record) {
                const auto wrapped = wire::unwrap(*body);
                sharer.replacer().tally().removed(nameOf(wrapped ? wrapped->body : *body));
                continue;
            }
            ++shared.read;
            const auto packet = sharer.shareRecord(record->packet);
            if (!packet) continue;
            const Bytes frame = wire::recordBody(0, packet->subspan(1));
            made.write(wire::frameOf(record->subscription ? wire::wrap(*record->subscription, frame) : frame));
            ++shared.records;
        }
    }
    frames.reset();
    sharer.replacer().tally().removed("damaged frame", frames.counts().damaged());
    if (input.isCut()) shared.ends = in + " breaks off; what comes before is shared";
    refuseEmpty(in, shared);
    made.appear();
    return shared;
}

SharedFile shareDlf(const std::string& in, RecordingFile input, OutputFile output, RecordSharer& sharer) {
    SharedFile shared{.kind = RecordingKind::Dlf};
    Pieces made(std::move(output));
    DlfRecording recording(std::move(input));
    while (const auto message = orFail(recording.next())) {
        ++shared.read;
        const auto record = sharer.shareRecord(message->message);
        if (!record) continue;
        made.write(record->subspan(1));  // without its log type, as the file has them
        ++shared.records;
    }
    sharer.replacer().tally().removed("byte between records", recording.damage().skippedBytes);
    if (recording.damage().isCut) shared.ends = in + " breaks off; what comes before is shared";
    refuseEmpty(in, shared);
    made.appear();
    return shared;
}

/// `isKnown`: the file begins as such a one does. The old text form of property lists has no beginning of its own.
SharedFile shareSnapshot(const std::string& in, RecordingFile input, OutputFile output, bool isKnown,
                         RecordSharer& sharer) {
    Bytes bytes;
    for (std::size_t got = kPiece; got == kPiece;) {
        const std::size_t size = bytes.size();
        bytes.resize(size + kPiece);
        got = orFail(input.read(std::span(bytes).subspan(size)));
        bytes.resize(size + got);
    }
    const Result<Value> snapshot = readPropertyList(bytes);
    if (!snapshot && isKnown) throw CommandFailure(in + " is not a snapshot: " + snapshot.error().reason);
    const SharedSnapshot made = snapshot ? sharedSnapshot(sharer, *snapshot) : SharedSnapshot();
    if (!made.content) throw CommandFailure(in + (isKnown ? " is not a snapshot" : " holds no diagnostic records"));
    orFail(output.write(orFail(writeXmlPropertyList(made.content))));
    orFail(output.appear());
    return {.kind = RecordingKind::Snapshot, .records = made.records, .read = made.read};
}

}  // namespace

SharedFile shareFile(const std::string& in, const std::string& out, const OutputTerms& terms,
                     std::optional<Technology> technology, RecordSharer& sharer) {
    const bool isStandardInput = in == "-";
    const std::string path = isStandardInput ? "/dev/stdin" : in;
    const RecordingKind kind = isStandardInput ? RecordingKind::Capture : orFail(recognizeRecording(path));
    RecordingFile input = orFail(RecordingFile::open(path));
    OutputFile output = orFail(OutputFile::create(out, terms));
    switch (kind) {
        case RecordingKind::Frames: return shareFrames(in, std::move(input), std::move(output), sharer);
        case RecordingKind::Dlf: return shareDlf(in, std::move(input), std::move(output), sharer);
        case RecordingKind::Snapshot:
        case RecordingKind::Unknown:
            return shareSnapshot(in, std::move(input), std::move(output), kind == RecordingKind::Snapshot, sharer);
        default:
            return shareCapture(isStandardInput ? "standard input" : in, std::move(input), std::move(output),
                                technology, sharer);
    }
}

}  // namespace kelvo
