#pragma once

#include <QString>

namespace kelvo {

/// Where the session bus is; empty where there is none. To ask Qt for it by its kind would start one, or wait for one.
QString sessionBusAddress();

}  // namespace kelvo
