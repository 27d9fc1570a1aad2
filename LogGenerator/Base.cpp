#include "LogGenerator/Base.h"

#include <algorithm>
#include <iterator>

#include "LogGenerator/ArrayLock.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

struct EnergyBand {
    std::uint32_t from;  ///< the smallest raw value of the band
    std::int16_t decibel;
};

// The first band whose start is reached decides. Two bands of -31 and the 0 at both ends are intended.
constexpr EnergyBand kEnergyBands[] = {
    {524288, 0},  {417648, -1}, {331809, -2}, {263625, -3}, {209464, -4}, {166442, -5}, {132269, -6},
    {105124, -7}, {83563, -8},  {66436, -9},  {52831, -10}, {42024, -11}, {33441, -12}, {26622, -13},
    {21206, -14}, {16904, -15}, {13487, -16}, {10772, -17}, {8616, -18},  {6903, -19},  {5543, -20},
    {4462, -21},  {3604, -22},  {2922, -23},  {2241, -24},  {1950, -25},  {1608, -26},  {1337, -27},
    {1121, -28},  {950, -29},   {814, -30},   {757, -31},   {706, -31},   {0, 0},
};

}  // namespace

void Base::updateSectionRef(Value displayPart) {
    sectionRef = std::move(displayPart);
    logLine(Level::Warning, getSectionName());
}

void Base::updateLogCodeDict(CodeDictionary& codeDict) {
    const std::span<const LogCode> codes = getLogCodeArray();
    logLine(Level::Warning, "Array Count: %d", codes.size());
    for (LogCode code : codes) codeDict.subscribe(code, *this);
}

void Base::clearElementsInArray(const ArrayRef& array) {
    if (!array) return;
    const ArrayLock::Held held;
    array->clear();
}

void Base::replaceArray(const ArrayRef& array, std::vector<Value> with) {
    if (!array) return;
    const ArrayLock::Held held;
    array->clear();
    for (Value& element : with) array->append(std::move(element));
}

std::int16_t Base::lookUpECNO(std::uint32_t raw) {
    return std::find_if(std::begin(kEnergyBands), std::end(kEnergyBands),
                        [raw](const EnergyBand& band) { return raw >= band.from; })
        ->decibel;
}

void Base::reportUnknown(LogCode logCode) {
    logLine(Level::Error, "Received an unknown log message: %d", static_cast<std::int32_t>(logCode));
}

bool Base::showLayout(ByteView data, std::size_t minimum, std::span<const Field> fields) const {
    if (data.size() < minimum) return false;
    if (values()) showFields(*values(), RecordView(data), 0, fields);
    return true;
}

}  // namespace kelvo
