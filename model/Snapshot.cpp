#include "model/Snapshot.h"

#include <fmt/printf.h>

#include "platform/encodings/PropertyList.h"
#include "platform/system/DateText.h"

namespace kelvo {

DictionaryRef Snapshot::dictionary() const {
    DictionaryRef dictionary = Dictionary::make({{snapshot::kTimestamp, utcDateDescription(timestamp)}});
    if (!data) return dictionary;
    dictionary->set(snapshot::kData, data);
    if (description) dictionary->set(snapshot::kDescription, *description);
    return dictionary;
}

Result<Bytes> Snapshot::propertyList() const { return writeXmlPropertyList(dictionary()); }

std::string Snapshot::pathInDirectory(std::string_view directory, Clock::TimePoint now) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(now.time_since_epoch()).count();
    return fmt::sprintf("%s/KelvoSnapshot-%d.kelvo", directory, seconds);
}

}  // namespace kelvo
