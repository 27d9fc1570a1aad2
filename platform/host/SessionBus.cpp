#include "platform/host/SessionBus.h"

#include <QFileInfo>

namespace kelvo {

QString sessionBusAddress() {
    const QString address = qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS");
    if (!address.isEmpty()) return address;
    const QString socket = qEnvironmentVariable("XDG_RUNTIME_DIR") + "/bus";
    return QFileInfo::exists(socket) ? "unix:path=" + socket : QString();
}

}  // namespace kelvo
