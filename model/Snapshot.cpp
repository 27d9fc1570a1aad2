#include "model/Snapshot.h"

#include <fmt/printf.h>

#include <array>
#include <ctime>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

std::string utcText(Clock::TimePoint time) {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
    std::tm broken{};
    gmtime_r(&seconds, &broken);
    std::array<char, 64> text{};
    const std::size_t length = std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S +0000", &broken);
    return {text.data(), length};
}

}  // namespace

DictionaryRef Snapshot::dictionary() const {
    DictionaryRef dictionary = Dictionary::make({{"Timestamp", utcText(timestamp)}});
    if (!data) return dictionary;
    dictionary->set("Data", data);
    if (description) dictionary->set("Description", *description);
    return dictionary;
}

Result<Bytes> Snapshot::propertyList() const { return writeXmlPropertyList(dictionary()); }

std::string Snapshot::pathInDirectory(std::string_view directory, Clock::TimePoint now) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(now.time_since_epoch()).count();
    return fmt::sprintf("%s/KelvoSnapshot-%d.kelvo", directory, seconds);
}

}  // namespace kelvo
