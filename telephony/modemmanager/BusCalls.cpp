#include "telephony/modemmanager/BusCalls.h"

#include <fmt/format.h>

#include <QDBusPendingCallWatcher>
#include <memory>
#include <utility>

#include "platform/system/Environment.h"

namespace kelvo::modemmanager {
namespace {

using namespace std::chrono_literals;

constexpr const char* kManager = "org.freedesktop.ModemManager1";
constexpr const char* kBus = "org.freedesktop.DBus";
constexpr const char* kBusPath = "/org/freedesktop/DBus";
constexpr auto kBusPause = 5s;        // between two tries to reach the bus
constexpr auto kPatience = 5s;        // before a question counts as unanswered
constexpr int kNoLimit = 0x7FFFFFFF;  // a late answer is still one; isSilent() tells meanwhile

}  // namespace

BusCalls::BusCalls(Open open, uid_t trustedOwner, MainQueue& queue, Listener& listener)
    : _open(std::move(open)), _trustedOwner(trustedOwner), _queue(queue), _listener(listener) {}

BusCalls::~BusCalls() {
    if (!_name.isEmpty()) QDBusConnection::disconnectFromBus(_name);
}

QDBusConnection BusCalls::bus() const { return QDBusConnection(_name); }

void BusCalls::connectBus() {
    const QDBusConnection opened = _open();
    _name = opened.name();
    if (!opened.isConnected()) {
        QDBusConnection::disconnectFromBus(std::exchange(_name, {}));
        _queue.postAfter(kBusPause, _lifetime.whileAlive([this] { connectBus(); }));
        return lose("there is no system bus");
    }
    bus().connect({}, "/org/freedesktop/DBus/Local", "org.freedesktop.DBus.Local", "Disconnected", this,
                  SLOT(busGone()));
    // Changes first, so that none is missed before the answer.
    bus().connect(kBus, kBusPath, kBus, "NameOwnerChanged", {kManager}, {}, this,
                  SLOT(nameOwnerChanged(QString, QString, QString)));
    findOwner();
}

void BusCalls::busGone() {
    QDBusConnection::disconnectFromBus(std::exchange(_name, {}));
    lose("the system bus has gone");
    _queue.postAfter(kBusPause, _lifetime.whileAlive([this] { connectBus(); }));
}

void BusCalls::findOwner() {
    askBus("GetNameOwner", kManager, [this](const QDBusMessage& answer) {
        if (answer.type() == QDBusMessage::ErrorMessage) return lose("ModemManager does not run");
        checkOwner(answer.arguments().value(0).toString());
    });
}

void BusCalls::nameOwnerChanged(const QString&, const QString&, const QString& now) {
    lose("ModemManager does not run");
    if (!now.isEmpty()) checkOwner(now);
}

// Whoever may own names on the bus could call himself ModemManager; only root's word counts.
void BusCalls::checkOwner(const QString& owner) {
    askBus("GetConnectionUnixUser", owner, [this, owner](const QDBusMessage& answer) {
        if (answer.type() == QDBusMessage::ErrorMessage) return lose("ModemManager does not run");
        const uint user = answer.arguments().value(0).toUInt();
        if (user == _trustedOwner) return trust(owner);
        lose(fmt::format("the name of ModemManager on the bus belongs to user {}, not to user {}: nothing is believed",
                         user, _trustedOwner));
        logLine(Level::Error, "%s", _trouble);
    });
}

void BusCalls::trust(const QString& owner) {
    _owner = owner;
    _trouble.clear();
    // Of every path: bearers and SIMs come and go.
    bus().connect(owner, {}, "org.freedesktop.DBus.Properties", "PropertiesChanged", this,
                  SLOT(signalled(QDBusMessage)));
    for (const char* signal : {"InterfacesAdded", "InterfacesRemoved"})
        bus().connect(owner, {}, "org.freedesktop.DBus.ObjectManager", signal, this, SLOT(signalled(QDBusMessage)));
    _listener.managerCame();
}

void BusCalls::lose(std::string trouble) {
    ++_turn;
    if (!_name.isEmpty() && hasManager()) {
        bus().disconnect(_owner, {}, "org.freedesktop.DBus.Properties", "PropertiesChanged", this,
                         SLOT(signalled(QDBusMessage)));
        for (const char* signal : {"InterfacesAdded", "InterfacesRemoved"})
            bus().disconnect(_owner, {}, "org.freedesktop.DBus.ObjectManager", signal, this,
                             SLOT(signalled(QDBusMessage)));
    }
    _owner.clear();
    _silent = false;
    _trouble = std::move(trouble);
    _listener.managerWent();
}

void BusCalls::signalled(const QDBusMessage& signal) {
    if (signal.service() != _owner) return;
    _listener.managerSignalled(signal);
}

void BusCalls::askBus(const QString& method, const QString& argument, Answer answer) {
    auto question = QDBusMessage::createMethodCall(kBus, kBusPath, kBus, method);
    question << argument;
    send(question, std::move(answer));
}

void BusCalls::ask(const QString& path, const QString& interface, const QString& method, const QVariantList& arguments,
                   Answer answer) {
    if (!hasManager()) return;
    auto question = QDBusMessage::createMethodCall(_owner, path, interface, method);
    question.setArguments(arguments);
    const auto answered = std::make_shared<bool>(false);
    send(question, [this, answered, answer = std::move(answer)](const QDBusMessage& reply) {
        *answered = true;
        setSilent(false);
        answer(reply);
    });
    _queue.postAfter(kPatience, _lifetime.whileAlive([this, answered, turn = _turn] {
        if (turn == _turn && !*answered) setSilent(true);
    }));
}

void BusCalls::send(const QDBusMessage& question, Answer answer) {
    auto* const watcher = new QDBusPendingCallWatcher(bus().asyncCall(question, kNoLimit), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
            [this, watcher, turn = _turn, answer = std::move(answer)] {
                watcher->deleteLater();
                if (turn == _turn) answer(watcher->reply());
            });
}

void BusCalls::setSilent(bool silent) {
    if (std::exchange(_silent, silent) != silent) _listener.answersOrNot();
}

}  // namespace kelvo::modemmanager
