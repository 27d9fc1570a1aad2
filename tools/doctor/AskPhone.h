#pragma once

#include <sys/types.h>

#include <QDBusConnection>
#include <functional>

#include "tools/doctor/PhoneFindings.h"

namespace kelvo {

/// Opens the bus as a connection of that name.
using OpenBus = std::function<QDBusConnection(const QString& name)>;

/// Asks ModemManager what it knows of every modem, for a few seconds at most, and changes nothing. Needs a
/// QCoreApplication. `trustedOwner` is the user id that the daemon must have.
PhoneFindings askPhone(const OpenBus& open, uid_t trustedOwner);
/// The same of root's daemon on the system bus.
PhoneFindings askPhone();

}  // namespace kelvo
