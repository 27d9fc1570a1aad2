#include "tools/doctor/SystemInputs.h"

#include <pwd.h>
#include <unistd.h>

#include <QDBusConnection>
#include <QDBusConnectionInterface>

#include "telephony/wire/CandidateFinder.h"
#include "tools/doctor/AskPhone.h"
#include "tools/doctor/ProbePlace.h"

namespace kelvo {
namespace {

bool modemManagerRuns() {
    const QDBusConnectionInterface* const bus = QDBusConnection::systemBus().interface();
    return bus != nullptr && bus->isServiceRegistered("org.freedesktop.ModemManager1");
}

std::string userName() {
    const passwd* const entry = ::getpwuid(::getuid());
    return entry != nullptr ? entry->pw_name : "$USER";
}

}  // namespace

DoctorInputs systemInputs() {
    return {.candidates = wire::findCandidates,
            .access = [](const std::string& path) { return accessTo(path); },
            .holders = [](const std::string& path) { return holdersOf(path, "/proc"); },
            .modemManagerRuns = modemManagerRuns,
            .phone = [] { return askPhone(); },
            .probe = probePlace,
            .user = userName()};
}

}  // namespace kelvo
