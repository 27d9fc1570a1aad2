#include "telephony/wire/modem/FramesRecords.h"

#include <algorithm>
#include <utility>

#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordFrame.h"
#include "telephony/wire/Wrapper.h"

namespace kelvo::modem {
namespace {

using namespace std::chrono_literals;

constexpr std::size_t kChunk = 65'536;
constexpr std::chrono::nanoseconds kLongestPause = 5s;

}  // namespace

Result<std::unique_ptr<FramesRecords>> FramesRecords::open(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file) return Failure{path.string() + " cannot be read"};
    std::unique_ptr<FramesRecords> records(new FramesRecords(std::move(file)));
    records->_first = records->read();
    if (!records->_first) return Failure{path.string() + ": holds no record as a diagnostic port frames it"};
    return records;
}

std::optional<ModemRecord> FramesRecords::next() { return _first ? std::exchange(_first, std::nullopt) : read(); }

std::optional<ModemRecord> FramesRecords::read() {
    while (!_unread.empty() || fill()) {
        auto body = _reader.next(_unread);
        if (!body) continue;
        if ((*body)[0] == static_cast<std::uint8_t>(wire::Command::MultiRadio)) {
            const auto wrapped = wire::unwrap(*body);
            if (!wrapped) continue;
            body = wrapped->body;
        }
        if ((*body)[0] != static_cast<std::uint8_t>(wire::Command::Record)) continue;
        const auto record = wire::parseRecord(*body);
        if (!record) continue;
        if (const auto time = wire::timeOf(record->timestamp)) {
            if (_last) _at += std::clamp<std::chrono::nanoseconds>(*time - *_last, 0s, kLongestPause);
            _last = std::max(_last.value_or(*time), *time);
        }
        return ModemRecord{_at, record->record};
    }
    return std::nullopt;
}

bool FramesRecords::fill() {
    _buffer.resize(kChunk);
    _file.read(reinterpret_cast<char*>(_buffer.data()), static_cast<std::streamsize>(_buffer.size()));
    _unread = wire::MutableBytes(_buffer).first(static_cast<std::size_t>(_file.gcount()));
    return !_unread.empty();
}

}  // namespace kelvo::modem
