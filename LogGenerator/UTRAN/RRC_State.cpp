#include "LogGenerator/UTRAN/RRC_State.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::int64_t kUnknownMode = 255;

// clang-format off
constexpr ValueTable kMode({
    { 0, "Disconnected"  },
    { 1, "Connecting"    },
    { 2, "Cell Fach"     },
    { 3, "Cell DCH"      },
    { 4, "Cell PCH"      },
    { 5, "Cell URA PCH"  },
}, "Unknown RRC Mode");
constexpr Shown kShownMode = label(kMode);
// clang-format on

/// "{State = Cell DCH; Other = 1}"; a value that is no text is named by its kind.
std::string describe(const Dictionary& values) {
    std::string text = "{";
    for (const auto& [key, value] : values) {
        if (text.size() > 1) text += "; ";
        text += key + " = ";
        text += value.string() != nullptr ? std::string_view(*value.string()) : kindName(value.kind());
    }
    return text + "}";
}

}  // namespace

void RRC_State::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "RRC Info");
    if (logCode != code::kUTRANRRCState) return;
    if (data.size() < 15) {  // intended: said, and decoded all the same
        logLine(Level::Warning, "LogCode_0xD0E0 is length is %ld expected size %ld", data.size(), 15L);
    }
    const RecordView record(data);
    const bool tellsMode = record.read(13, u8) == 1 && record.size() > 14;
    const std::int64_t mode = tellsMode ? record.read(14, u8) : kUnknownMode;
    if (values()) showValue(values()->slot("State"), mode, kShownMode, tellsMode ? u8.placeAt(14) : Place());
    if (!logWants(Level::Warning)) return;
    std::string name;
    kShownMode.print(name, mode);
    const std::string shown = values() ? describe(*values()) : "(none)";
    logLine(Level::Warning, "Display Dict = %s, rrc mode = %d %s", shown, mode, name);
}

}  // namespace kelvo
