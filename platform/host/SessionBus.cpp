#include "platform/host/SessionBus.h"

#include <unistd.h>

#include <QFileInfo>

namespace kelvo {

QString sessionBusAddress() {
    const QString address = qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS");
    if (!address.isEmpty()) return address;
    const QString socket = qEnvironmentVariable("XDG_RUNTIME_DIR") + "/bus";
    const QFileInfo bus(socket);  // of this user: after a change of user the directory may be somebody else's
    return bus.exists() && bus.ownerId() == ::geteuid() ? "unix:path=" + socket : QString();
}

}  // namespace kelvo
