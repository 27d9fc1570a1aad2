#pragma once

#include <memory>

#include "telephony/RecordStream.h"
#include "telephony/adaptation/RecordAdapter.h"

namespace kelvo {

/// The records of another stream, those of newer layouts turned into the fixed ones, as a live modem's are. What cannot
/// be turned is left out.
class AdaptedStream final : public RecordStream {
public:
    explicit AdaptedStream(std::unique_ptr<RecordStream> stream) : _stream(std::move(stream)) {}

    Technology technology() const override { return _stream->technology(); }
    std::string description() const override { return _stream->description(); }
    std::string state() const override { return _stream->state(); }
    std::optional<CapturePacket> next() override;

private:
    const std::unique_ptr<RecordStream> _stream;
    adaptation::RecordAdapter _adapter;
};

}  // namespace kelvo
