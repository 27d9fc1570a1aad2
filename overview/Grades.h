#pragma once

#include <string_view>

namespace kelvo::overview {

/// What is graded. No standard grades a level; these are the steps that network planners and phone makers agree on, for
/// a phone outdoors. They are not the bars of a phone.
enum class Graded {
    Rsrp,     ///< LTE, dBm
    Rsrq,     ///< LTE, dB
    Rscp,     ///< UMTS, dBm
    EcIo,     ///< UMTS and CDMA2000, dB
    RxLevel,  ///< GSM, dBm
};

/// "excellent", "good", "fair", "weak" or "very weak".
std::string_view gradeOf(Graded what, double number);

}  // namespace kelvo::overview
