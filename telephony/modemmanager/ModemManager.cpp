#include "telephony/modemmanager/ModemManager.h"

#include <fmt/format.h>

#include <algorithm>
#include <memory>
#include <utility>

#include "platform/encodings/Utf8.h"
#include "platform/system/Environment.h"
#include "telephony/modemmanager/Permission.h"

namespace kelvo::modemmanager {
namespace {

using namespace std::chrono_literals;

constexpr const char* kRoot = "/org/freedesktop/ModemManager1";
constexpr const char* kObjects = "org.freedesktop.DBus.ObjectManager";
constexpr const char* kProperties = "org.freedesktop.DBus.Properties";
constexpr const char* kUnsupported = "org.freedesktop.ModemManager1.Error.Core.Unsupported";
constexpr quint32 kEverySecond = 1;
constexpr quint32 kAreaAndCell = 1;  // MMModemLocationSource
constexpr int kRegistered = 8;       // MMModemState
constexpr auto kPollPause = 5s;
constexpr auto kReleaseLimit = 1s;

bool isError(const QDBusMessage& message) { return message.type() == QDBusMessage::ErrorMessage; }

// The daemon's words, on one line and no longer than that.
std::string reasonOf(const QDBusMessage& error) {
    constexpr qsizetype kLongest = 120;
    return printable(error.errorMessage().left(kLongest).toStdString());
}

}  // namespace

ModemManager::ModemManager(BusCalls::Open open, uid_t trustedOwner, std::string wanted, MainQueue& queue)
    : _bus(std::move(open), trustedOwner, queue, *this), _queue(queue), _wanted(std::move(wanted)) {}

void ModemManager::follow(std::function<void()> changed) {
    _changed = std::move(changed);
    _bus.begin();
}

std::string ModemManager::description() const {
    if (_wanted.empty()) return "ModemManager's first modem";
    constexpr std::size_t kLongestIndex = 5;
    if (_wanted.starts_with('/') || _wanted.size() <= kLongestIndex)
        return "ModemManager's modem " + printable(_wanted);
    return "ModemManager's modem of the identity that was named";
}

std::string ModemManager::trouble() const {
    if (!_bus.hasManager()) return _bus.trouble();
    if (_bus.isSilent()) return "ModemManager does not answer";
    if (_modem.isEmpty()) {
        if (_loading > 0) return {};
        return modemsOf(_known).isEmpty() ? "ModemManager has no modem" : "ModemManager has no such modem";
    }
    const auto state = numberOf(_known.get(_modem, kModem, "State"));
    return state && *state < kRegistered ? "the modem is " + _phone.condition : std::string();
}

std::vector<std::string> ModemManager::lacks() const {
    std::vector<std::string> lines;
    for (const auto& [what, reason] : _lacks) lines.push_back(what + ": " + reason);
    return lines;
}

std::vector<phone::PhoneState> ModemManager::modems() const {
    std::vector<phone::PhoneState> all;
    for (const QString& modem : modemsOf(_known)) all.push_back(modem == _modem ? _phone : phoneOf(_known, modem));
    return all;
}

void ModemManager::managerCame() {
    load();
    note();
}

void ModemManager::managerWent() {
    _known = {};
    _modem.clear();
    _loading = 0;
    _asking = _settingRate = false;
    _notToBeHad.clear();
    _rateBefore.reset();
    _lacks.clear();
    finish();
    note();
}

void ModemManager::load() {
    ++_loading;
    _bus.ask(kRoot, kObjects, "GetManagedObjects", {}, [this](const QDBusMessage& answer) {
        --_loading;
        if (isError(answer)) {
            _lacks["modems"] = reasonOf(answer);
            return note();
        }
        _known.objects = objectsOf(answer.arguments().value(0));
        choose();
    });
}

void ModemManager::managerSignalled(const QDBusMessage& signal) {
    const QVariantList arguments = signal.arguments();
    if (signal.member() == "PropertiesChanged" && signal.signature() == "sa{sv}as") {
        const auto object = _known.objects.find(signal.path());
        if (object == _known.objects.end()) return;
        QVariantMap& properties = (*object)[arguments[0].toString()];
        properties.insert(mapOf(arguments[1]));
        for (const QString& name : textsOf(arguments[2])) properties.remove(name);
        if (signal.path() == _modem) {
            loadParts();
            settleSignal();
        }
    } else if (signal.member() == "InterfacesAdded" && signal.signature() == "oa{sa{sv}}") {
        const QString path = pathOf(arguments[0]);
        if (!path.isEmpty()) _known.objects[path].insert(interfacesOf(arguments[1]));
        choose();
    } else if (signal.member() == "InterfacesRemoved" && signal.signature() == "oas") {
        const QString path = pathOf(arguments[0]);
        for (const QString& interface : textsOf(arguments[1])) _known.objects[path].remove(interface);
        if (_known.objects[path].isEmpty()) _known.objects.remove(path);
        choose();
    }
    note();
}

bool ModemManager::isWanted(const QString& modem) const {
    return _wanted.empty() || _wanted == modem.toStdString() || _wanted == indexOf(modem).toStdString() ||
           _wanted == textOf(_known.get(modem, kModem, "EquipmentIdentifier"));
}

// Follows the first modem that is wanted.
void ModemManager::choose() {
    const QStringList modems = modemsOf(_known);
    const auto found = std::ranges::find_if(modems, [this](const QString& modem) { return isWanted(modem); });
    const QString chosen = found != modems.end() ? *found : QString();
    if (chosen != _modem) {
        _modem = chosen;
        _known.cells.reset();
        _known.location.reset();
        _lacks.clear();
        _rateBefore.reset();
        _settingRate = _asking = false;
        _notToBeHad.clear();
        poll();
    }
    loadParts();
    settleSignal();
    note();
}

// SIM and bearers are told one by one.
void ModemManager::loadParts() {
    const QString sim = simOf(_known, _modem);
    const QStringList bearers = bearersOf(_known, _modem);
    for (const QString& path : _known.objects.keys()) {
        const Interfaces& object = _known.objects[path];
        if (!object.contains(kModem) && path != sim && !bearers.contains(path)) _known.objects.remove(path);
    }
    if (!sim.isEmpty()) loadPart(sim, kSim);
    for (const QString& bearer : bearers) loadPart(bearer, kBearer);
}

void ModemManager::loadPart(const QString& path, const char* interface) {
    if (_known.objects.contains(path)) return;
    _known.objects[path];  // asked for; what it signals from now on is kept
    ++_loading;
    _bus.ask(path, kProperties, "GetAll", {QString(interface)}, [this, path, interface](const QDBusMessage& answer) {
        --_loading;
        const auto object = _known.objects.find(path);
        if (!isError(answer) && object != _known.objects.end())
            (*object)[interface] = mapOf(answer.arguments().value(0));
        note();
    });
}

// Many signals come at once: they are told together.
void ModemManager::note() {
    if (std::exchange(_noted, true)) return;
    _queue.post(_lifetime.whileAlive([this] { tell(); }));
}

void ModemManager::tell() {
    _noted = false;
    phone::PhoneState phone = phoneOf(_known, _modem);
    if (phone.modem != _phone.modem) {
        if (phone.modem.empty()) {
            logLine(Level::Notice, "ModemManager's modem %s has gone", _phone.modem);
        } else {
            logLine(Level::Notice, "ModemManager has modem %s: %s", phone.modem, printable(phone.model));
        }
    }
    _phone = std::move(phone);
    if (_changed) _changed();
}

void ModemManager::measure(bool wanted) {
    if (std::exchange(_measuring, wanted) == wanted) return;
    _notToBeHad.clear();
    settleSignal();
    poll();
}

void ModemManager::look(std::function<void()> done) {
    if (_modem.isEmpty()) return done();
    askCells([this, done = std::move(done)] {
        askLocation([this, done] {
            note();
            done();
        });
    });
}

void ModemManager::poll() {
    if (!_measuring || _modem.isEmpty()) return;
    if (!std::exchange(_asking, true)) {
        look([this] { _asking = false; });
    }
    if (std::exchange(_polling, true)) return;
    _queue.postAfter(kPollPause, _lifetime.whileAlive([this] {
        _polling = false;
        poll();
    }));
}

void ModemManager::askCells(std::function<void()> done) {
    if (_notToBeHad.contains("GetCellInfo")) return done();
    const QString modem = _modem;
    _bus.ask(modem, kModem, "GetCellInfo", {}, [this, modem, done = std::move(done)](const QDBusMessage& answer) {
        if (modem != _modem) return done();
        if (isError(answer)) {
            _known.cells.reset();
            tellRefusal("cell information", "GetCellInfo", answer);
        } else {
            _known.cells = mapsOf(answer.arguments().value(0));
            _lacks.erase("cell information");
        }
        done();
    });
}

// The area and the cell of the registration, where no cell says that it serves and the daemon gathers them anyway.
void ModemManager::askLocation(std::function<void()> done) {
    const auto gathered = numberOf(_known.get(_modem, kLocation, "Enabled")).value_or(0);
    const auto cells = _known.cells.value_or(QList<QVariantMap>());
    const bool isNeeded = std::ranges::none_of(cells, [](const QVariantMap& c) { return isTrue(c.value("serving")); });
    if (_modem.isEmpty() || !isNeeded || (gathered & kAreaAndCell) == 0 || _notToBeHad.contains("GetLocation")) {
        _known.location.reset();
        return done();
    }
    const QString modem = _modem;
    _bus.ask(modem, kLocation, "GetLocation", {}, [this, modem, done = std::move(done)](const QDBusMessage& answer) {
        if (modem != _modem) return done();
        if (isError(answer)) {
            _known.location.reset();
            tellRefusal("the registration's cell", "GetLocation", answer);
        } else {
            _known.location = numberedOf(answer.arguments().value(0));
            _lacks.erase("the registration's cell");
        }
        done();
    });
}

// Asks for fresh signal values while somebody measures, and leaves the rate as it was afterwards.
void ModemManager::settleSignal() {
    if (_modem.isEmpty() || _settingRate || _measuring == _rateBefore.has_value()) return;
    if (_measuring && (_notToBeHad.contains("Setup") || !_known.objects.value(_modem).contains(kSignal))) return;
    const auto before = static_cast<quint32>(numberOf(_known.get(_modem, kSignal, "Rate")).value_or(0));
    const quint32 rate = _measuring ? kEverySecond : *_rateBefore;
    const bool measuring = _measuring;
    _settingRate = true;
    const QString modem = _modem;
    _bus.ask(_modem, kSignal, "Setup", {rate}, [this, modem, measuring, before](const QDBusMessage& answer) {
        if (modem != _modem) return;
        _settingRate = false;
        if (isError(answer)) {
            tellRefusal("signal values", "Setup", answer);
            _notToBeHad.insert("Setup");
        } else {
            _lacks.erase("signal values");
        }
        _rateBefore = measuring && !isError(answer) ? std::optional(before) : std::nullopt;
        settleSignal();
        note();
        if (!_measuring && !_rateBefore) finish();
    });
}

// One line names a right that is missing, whatever needs it.
void ModemManager::tellRefusal(const std::string& what, const QString& method, const QDBusMessage& error) {
    const auto right = missingRight(method.toStdString(), error.errorName().toStdString());
    if (right || error.errorName() == kUnsupported) _notToBeHad.insert(method);
    _lacks[what] = right ? *right : reasonOf(error);
    if (right && _toldRights.insert(*right).second)
        logLine(Level::Warning, "ModemManager gives no %s: %s", what, *right);
    note();
}

void ModemManager::release(std::function<void()> done) {
    _done = std::move(done);
    measure(false);
    if (!_settingRate) return finish();
    _queue.postAfter(kReleaseLimit, _lifetime.whileAlive([this] { finish(); }));
}

void ModemManager::finish() {
    if (const auto done = std::exchange(_done, nullptr)) done();
}

}  // namespace kelvo::modemmanager
