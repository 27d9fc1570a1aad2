#include "tools/doctor/AskPhone.h"

#include <QEventLoop>
#include <QTimer>
#include <algorithm>
#include <memory>

#include "platform/host/HostMainQueue.h"
#include "telephony/modemmanager/ModemManager.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

constexpr auto kPatience = 3s;
constexpr uid_t kRoot = 0;

/// ModemManager's modems, each asked by a follower of its own; the first tells which others there are.
class Questions {
public:
    Questions(const OpenBus& open, uid_t trustedOwner) : _open(open), _trustedOwner(trustedOwner) {}

    PhoneFindings ask() {
        QTimer::singleShot(kPatience, &_loop, &QEventLoop::quit);
        follow("");
        _loop.exec();
        const modemmanager::ModemManager& first = _asked.front()->manager;
        PhoneFindings findings{.trouble = first.trouble()};
        for (phone::PhoneState& modem : first.modems()) findings.modems.push_back({.phone = std::move(modem)});
        for (const auto& asked : _asked) {
            const phone::PhoneState& phone = asked->manager.phone();
            const auto modem = std::ranges::find_if(
                findings.modems, [&](const ModemFindings& found) { return found.phone.modem == phone.modem; });
            if (modem != findings.modems.end()) *modem = {.phone = phone, .lacks = asked->manager.lacks()};
        }
        return findings;
    }

private:
    struct Asked {
        modemmanager::ModemManager manager;
        bool hasLooked = false;
        bool isDone = false;
    };

    void follow(const std::string& wanted) {
        const QString name = QString("kelvo-modemmanager-%1").arg(_asked.size());
        _asked.push_back(
            std::unique_ptr<Asked>(new Asked{{[this, name] { return _open(name); }, _trustedOwner, wanted, _queue}}));
        Asked& asked = *_asked.back();
        asked.manager.follow([this, &asked] { look(asked); });
    }

    void look(Asked& asked) {
        if (asked.hasLooked || !asked.manager.isSettled()) return;
        if (asked.manager.phone().modem.empty()) {
            if (!asked.manager.trouble().empty()) finish(asked);
            return;
        }
        asked.hasLooked = true;
        if (_asked.size() == 1) {
            for (const phone::PhoneState& modem : asked.manager.modems()) {
                if (modem.modem != asked.manager.phone().modem) follow(modem.modem);
            }
        }
        asked.manager.look([this, &asked] { _queue.post([this, &asked] { finish(asked); }); });
    }

    void finish(Asked& asked) {
        asked.isDone = true;
        if (std::ranges::all_of(_asked, &Asked::isDone, [](const auto& one) -> Asked& { return *one; })) _loop.quit();
    }

    const OpenBus& _open;
    const uid_t _trustedOwner;
    HostMainQueue _queue;
    QEventLoop _loop;
    std::vector<std::unique_ptr<Asked>> _asked;
};

}  // namespace

PhoneFindings askPhone(const OpenBus& open, uid_t trustedOwner) { return Questions(open, trustedOwner).ask(); }

PhoneFindings askPhone() {
    return askPhone([](const QString& name) { return QDBusConnection::connectToBus(QDBusConnection::SystemBus, name); },
                    kRoot);
}

}  // namespace kelvo
