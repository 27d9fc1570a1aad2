#pragma once

#include <stdexcept>

namespace kelvo::simulation {

/// A number that a radio standard gives a range, 0 to kMax. It is made by its name alone, so that no other number takes
/// its place, and reads as an int. One out of its range is a mistake of the network's builder and throws.
template <class Name, int Max>
class RadioNumber {
public:
    static constexpr int kMax = Max;

    constexpr RadioNumber() = default;
    constexpr explicit RadioNumber(int value) : _value(value) {
        if (value < 0 || value > kMax) throw std::out_of_range("a radio number out of its range");
    }
    constexpr operator int() const { return _value; }

private:
    int _value = 0;
};

// clang-format off
using Arfcn  = RadioNumber<struct ArfcnName,   1023>;  ///< carrier of GSM: 3GPP TS 45.005, section 2
using Uarfcn = RadioNumber<struct UarfcnName, 16383>;  ///< carrier of UMTS and TD-SCDMA: TS 25.101 and 25.102, section 5.4
using Earfcn = RadioNumber<struct EarfcnName, 65535>;  ///< carrier of LTE: TS 36.101, section 5.7.3
using Bsic   = RadioNumber<struct BsicName,      63>;  ///< network and base station colour codes: TS 23.003, section 4.3.2
using Psc    = RadioNumber<struct PscName,      511>;  ///< primary scrambling code of UMTS: TS 25.213, section 5.2.2
using CellParameterId = RadioNumber<struct CellParameterIdName, 127>;  ///< of TD-SCDMA: TS 25.223, section 7
using Pci    = RadioNumber<struct PciName,      503>;  ///< physical cell identity of LTE: TS 36.211, section 6.11
using PnOffset = RadioNumber<struct PnOffsetName, 511>;  ///< of a CDMA2000 pilot, in units of 64 chips: 3GPP2 C.S0002
using CdmaChannel = RadioNumber<struct CdmaChannelName, 2047>;  ///< carrier of CDMA2000 in its band class: 3GPP2 C.S0057
// clang-format on

}  // namespace kelvo::simulation
