#include "tools/doctor/AskPhone.h"

#include <QEventLoop>
#include <QTimer>

#include "platform/host/HostMainQueue.h"
#include "telephony/modemmanager/ModemManager.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

constexpr auto kPatience = 3s;
constexpr uid_t kRoot = 0;

}  // namespace

PhoneFindings askPhone() {
    HostMainQueue queue;
    modemmanager::ModemManager manager(
        [] { return QDBusConnection::connectToBus(QDBusConnection::SystemBus, "kelvo-modemmanager"); }, kRoot, "",
        queue);
    QEventLoop loop;
    QTimer::singleShot(kPatience, &loop, &QEventLoop::quit);
    bool looked = false;
    manager.follow([&] {
        if (!manager.isSettled() || looked) return;
        if (manager.phone().modem.empty()) return manager.trouble().empty() ? void() : loop.quit();
        looked = true;
        manager.look([&] { queue.post([&] { loop.quit(); }); });
    });
    loop.exec();
    return {.trouble = manager.trouble(), .modems = manager.modems(), .lacks = manager.lacks()};
}

}  // namespace kelvo
