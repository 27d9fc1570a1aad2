#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace kelvo::overview {

/// A channel number in one of the bands that have it.
struct BandChannel {
    std::string band;               ///< in the words of its standard: "3", "VIII", "DCS 1800", "BC 1"
    std::optional<double> downMHz;  ///< the carrier's centre; none: the number names an uplink alone
    std::optional<double> upMHz;    ///< none: a band without uplink
};

/// Every band in which a channel has this number: none for one that the tables do not know, several where a number is
/// given twice. Channel numbers are those of the downlink; a time-division band has one carrier for both directions.
///
/// EARFCN, 3GPP TS 36.101 table 5.7.3-1: 0 to 65,535, so bands 1 to 52.
std::vector<BandChannel> lteBands(std::int64_t earfcn);
/// UARFCN of a frequency-division band, 3GPP TS 25.101 tables 5.1 and 5.2.
std::vector<BandChannel> utraFddBands(std::int64_t uarfcn);
/// UARFCN of a time-division band with 1.28 Mcps, 3GPP TS 25.102 clause 5.
std::vector<BandChannel> utraTddBands(std::int64_t uarfcn);
/// ARFCN, 3GPP TS 45.005 clause 2: 512 to 810 are given twice.
std::vector<BandChannel> gsmBands(std::int64_t arfcn);
/// CDMA channel of a band class, 3GPP2 C.S0057 clause 2.1.
std::vector<BandChannel> cdmaBands(std::int64_t bandClass, std::int64_t channel);

/// The uplink carrier of an EARFCN of its own, as records name it beside that of the downlink.
std::optional<double> lteUplinkMHz(std::int64_t earfcn);

}  // namespace kelvo::overview
