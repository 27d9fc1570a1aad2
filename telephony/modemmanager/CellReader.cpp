#include "telephony/modemmanager/CellReader.h"

#include <charconv>
#include <cmath>
#include <limits>

namespace kelvo::modemmanager {
namespace {

using phone::MonitoredCell;
using Cell = MonitoredCell::Technology;

enum CellType { Gsm = 2, Umts = 3, TdScdma = 4, Lte = 5 };  // MMCellType

constexpr int kLowestRxLevel = -110;  // dBm, RXLEV 0 (3GPP TS 45.008, 8.1.4)
constexpr int kHighestRxLevel = 63;
constexpr double kGreatestLevel = 1000;  // dB and dBm: far beyond what is measured

std::optional<int> parsed(std::string_view digits, int base) {
    std::int64_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number, base);
    const bool isWhole = error == std::errc() && end == digits.data() + digits.size() && !digits.empty();
    if (!isWhole || number < 0 || number > std::numeric_limits<std::int32_t>::max()) return std::nullopt;
    return static_cast<int>(number);
}

std::optional<int> hexadecimal(const QVariantMap& told, const char* key) { return parsed(textOf(told.value(key)), 16); }

std::optional<int> number(const QVariantMap& told, const char* key) {
    const auto value = numberOf(told.value(key));
    if (!value || *value < 0 || *value > std::numeric_limits<std::int32_t>::max()) return std::nullopt;
    return static_cast<int>(*value);
}

std::optional<double> level(const QVariantMap& told, const char* key) {
    const auto value = realOf(told.value(key));
    return value && std::abs(*value) < kGreatestLevel ? value : std::nullopt;
}

int rounded(double value) { return static_cast<int>(std::floor(value + 0.5)); }  // ties up

int roundedOrNone(const std::optional<double>& value) { return value ? rounded(*value) : MonitoredCell::kNoValue; }

int inTwos(const std::optional<double>& dBm) { return dBm ? rounded(*dBm / 2) : MonitoredCell::kNoValue; }

// "00101": three digits of country, two or three of network.
void setNetwork(MonitoredCell& cell, std::string_view code) {
    constexpr std::size_t kCountry = 3;
    if (code.size() != kCountry + 2 && code.size() != kCountry + 3) return;
    const auto country = parsed(code.substr(0, kCountry), 10);
    const auto network = parsed(code.substr(kCountry), 10);
    if (!country || !network) return;
    cell.mcc = country;
    cell.mnc = network;
}

void readGsm(MonitoredCell& cell, const QVariantMap& told) {
    cell.technology = Cell::GSM;
    cell.arfcn = number(told, "arfcn");
    const auto rxLevel = number(told, "rx-level");
    const bool isLevel = rxLevel && *rxLevel <= kHighestRxLevel;
    cell.rssi = inTwos(isLevel ? std::optional<double>(kLowestRxLevel + *rxLevel) : std::nullopt);
}

void readUmts(MonitoredCell& cell, const QVariantMap& told) {
    cell.technology = Cell::UMTS;
    cell.uarfcn = number(told, "uarfcn");
    cell.scn = number(told, "psc");
    cell.rscp = roundedOrNone(level(told, "rscp"));
    cell.ecn0 = roundedOrNone(level(told, "ecio"));
}

// A cell parameter is its scrambling code's number (3GPP TS 25.223, 6.4).
void readTdScdma(MonitoredCell& cell, const QVariantMap& told) {
    cell.technology = Cell::UTRAN2;
    cell.uarfcn = number(told, "uarfcn");
    cell.scn = number(told, "cell-parameter-id");
    cell.rscp = roundedOrNone(level(told, "rscp"));
}

void readLte(MonitoredCell& cell, const QVariantMap& told) {
    cell.technology = Cell::LTE;
    cell.tac = hexadecimal(told, "tac");
    cell.pid = hexadecimal(told, "physical-ci");
    cell.uarfcn = number(told, "earfcn");
}

// The n-th of the parts that commas separate; empty when there are fewer.
std::string_view part(std::string_view text, int wanted) {
    for (; wanted > 0; --wanted) {
        const std::size_t comma = text.find(',');
        if (comma == std::string_view::npos) return {};
        text.remove_prefix(comma + 1);
    }
    return text.substr(0, text.find(','));
}

std::optional<int> partOf(std::string_view location, int wanted) {
    const auto number = parsed(part(location, wanted), 16);
    return number != 0 ? number : std::nullopt;  // 0 stands for one that is not known
}

}  // namespace

std::optional<MonitoredCell> cellOf(const QVariantMap& told) {
    MonitoredCell cell{.isServing = isTrue(told.value("serving"))};
    setNetwork(cell, textOf(told.value("operator-id")));
    cell.cellId = hexadecimal(told, "ci");
    switch (numberOf(told.value("cell-type")).value_or(0)) {
        case Gsm: readGsm(cell, told); break;
        case Umts: readUmts(cell, told); break;
        case TdScdma: readTdScdma(cell, told); break;
        case Lte: readLte(cell, told); return cell;
        default: return std::nullopt;
    }
    cell.lac = hexadecimal(told, "lac");
    return cell;
}

phone::LteLevels levelsOfCell(const QVariantMap& told) {
    return {.rsrp = level(told, "rsrp"), .rsrq = level(told, "rsrq"), .rssi = std::nullopt};
}

phone::LteLevels levelsOf(const QVariantMap& signal, const phone::LteLevels& ofCell) {
    phone::LteLevels levels{
        .rsrp = level(signal, "rsrp"), .rsrq = level(signal, "rsrq"), .rssi = level(signal, "rssi")};
    if (!levels.rsrp) levels.rsrp = ofCell.rsrp;
    if (!levels.rsrq) levels.rsrq = ofCell.rsrq;
    return levels;
}

void setLevels(MonitoredCell& serving, const QVariantMap& signal) {
    if (serving.technology == Cell::GSM) {
        if (const auto rssi = level(signal, "rssi")) serving.rssi = inTwos(rssi);
    } else if (serving.technology == Cell::UMTS) {
        if (const auto rscp = level(signal, "rscp")) serving.rscp = rounded(*rscp);
        if (const auto ecio = level(signal, "ecio")) serving.ecn0 = rounded(*ecio);
    }
}

MonitoredCell registeredCell(Cell technology, const std::string& network, const std::string& location) {
    MonitoredCell cell{.technology = technology, .isServing = true};
    setNetwork(cell, network);
    setNetwork(cell, std::string(part(location, 0)) + std::string(part(location, 1)));
    cell.cellId = partOf(location, 3);
    if (technology == Cell::LTE) {
        cell.tac = partOf(location, 4);
    } else {
        cell.lac = partOf(location, 2);
    }
    if (technology == Cell::GSM) cell.rssi = MonitoredCell::kNoValue;
    if (technology == Cell::UMTS) cell.rscp = cell.ecn0 = MonitoredCell::kNoValue;
    return cell;
}

}  // namespace kelvo::modemmanager
