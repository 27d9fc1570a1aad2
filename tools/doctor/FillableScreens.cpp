#include "tools/doctor/FillableScreens.h"

#include <algorithm>
#include <span>

#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"
#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"

namespace kelvo {
namespace {

using Has = std::function<bool(LogCode)>;

// CDMA has no sections: what each of its records shows.
struct CdmaRecord {
    LogCode code;
    const char* shows;
};
// clang-format off
constexpr CdmaRecord kCdmaRecords[] = {
    { 0x119c, "1x"                    },
    { 0x119d, "1x Traffic FER"        },
    { 0x108a, "EV-DO Fingers"         },
    { 0x1183, "EV-DO Session"         },
    { 0x12b6, "EV-DO Active Set"      },
    { 0x1192, "EV-DO Forward Rate"    },
    { 0x127e, "EV-DO Reverse Rate"    },
    { 0x134f, "System Identification" },
};
// clang-format on

enum class Counting { Modem, Everything };

void sortIn(std::string screen, std::span<const LogCode> codes, const Has& has, Counting counting,
            FillableScreens& screens) {
    if (codes.empty()) return;  // a screen that no record fills
    std::size_t modems = 0;
    std::size_t had = 0;
    for (const LogCode code : codes) {
        if (counting == Counting::Modem && code >= kExtendedLogCodes) continue;
        ++modems;
        if (has(code)) ++had;
    }
    auto& list = modems == 0     ? screens.phone
                 : had == 0      ? screens.empty
                 : had == modems ? screens.filled
                                 : screens.partly;
    list.push_back(std::move(screen));
}

FillableScreens of(Technology technology, const ClassIndex& index, const Has& has, Counting counting) {
    FillableScreens screens{technology, {}, {}, {}, {}};
    for (const std::string_view name : index.getAllNames())
        sortIn(std::string(name), index.getClass(name)->getLogCodeArray(), has, counting, screens);
    return screens;
}

FillableScreens ofCdma(const Has& has) {
    FillableScreens screens{Technology::CDMA, {}, {}, {}, {}};
    for (const CdmaRecord& record : kCdmaRecords)
        sortIn(record.shows, {&record.code, 1}, has, Counting::Modem, screens);
    return screens;
}

std::vector<FillableScreens> ofAll(const Has& has, Counting counting) {
    return {of(Technology::GSM, OSK_GSMClassIndex(), has, counting), ofCdma(has),
            of(Technology::LTE, LTEClassIndex(), has, counting),
            of(Technology::UTRAN, UTRANClassIndex(), has, counting)};
}

}  // namespace

std::vector<FillableScreens> fillableScreens(const Has& has) { return ofAll(has, Counting::Modem); }

std::vector<FillableScreens> screensWithServices(const Has& has) { return ofAll(has, Counting::Everything); }

std::vector<FillableScreens> fillableScreens(const wire::Ranges& ranges) {
    return fillableScreens([&](LogCode code) { return (code & 0xFFF) < ranges[code >> 12]; });
}

}  // namespace kelvo
