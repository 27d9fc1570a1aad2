#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusMetaType>
#include <QDBusObjectPath>
#include <QDBusVirtualObject>
#include <QMap>
#include <QStringList>
#include <QVariantMap>
#include <map>

namespace kelvo::test {

using Interfaces = QMap<QString, QVariantMap>;
using Objects = QMap<QDBusObjectPath, Interfaces>;
using Cells = QList<QVariantMap>;
using Location = QMap<uint, QDBusVariant>;

inline constexpr const char* kManagerName = "org.freedesktop.ModemManager1";
inline constexpr const char* kManagerPath = "/org/freedesktop/ModemManager1";
inline constexpr const char* kModemInterface = "org.freedesktop.ModemManager1.Modem";

/// ModemManager on a bus of the test's own, as far as anybody asks it.
class MockManager : public QDBusVirtualObject {
public:
    explicit MockManager(const QString& address, const QString& name = "manager")
        : _connection(name), _bus(QDBusConnection::connectToBus(address, name)) {
        qDBusRegisterMetaType<Interfaces>();
        qDBusRegisterMetaType<Objects>();
        qDBusRegisterMetaType<Cells>();
        qDBusRegisterMetaType<Location>();
        _bus.registerVirtualObject("/", this, QDBusConnection::SubPath);
        _bus.registerService(kManagerName);
    }
    ~MockManager() override { QDBusConnection::disconnectFromBus(_connection); }

    static QString modemPath(int index) { return QString("%1/Modem/%2").arg(kManagerPath).arg(index); }
    static QString simPath(int index) { return QString("%1/SIM/%2").arg(kManagerPath).arg(index); }
    static QString bearerPath(int index) { return QString("%1/Bearer/%2").arg(kManagerPath).arg(index); }

    /// An LTE phone, registered at home, with a SIM and one active bearer; its numbers follow from `index`.
    void addModem(int index) {
        const auto path = [](const QString& text) { return QVariant::fromValue(QDBusObjectPath(text)); };
        Interfaces& modem = modems[index];
        modem[kModemInterface] = {
            {"Manufacturer", "Maker"},
            {"Model", QString("Model %1").arg(index)},
            {"EquipmentIdentifier", QString("86000000000000%1").arg(index)},
            {"State", 8},
            {"AccessTechnologies", 1U << 14},
            {"OwnNumbers", QStringList{"+15550123"}},
            {"Sim", path(simPath(index))},
            {"Bearers", QVariant::fromValue(QList<QDBusObjectPath>{QDBusObjectPath(bearerPath(index))})}};
        modem["org.freedesktop.ModemManager1.Modem.Modem3gpp"] = {{"RegistrationState", 1U},
                                                                  {"OperatorCode", "00101"},
                                                                  {"OperatorName", "Test Network"},
                                                                  {"InitialEpsBearer", path("/")}};
        modem["org.freedesktop.ModemManager1.Modem.Signal"] = {{"Rate", 0U}, {"Lte", QVariantMap()}};
        modem["org.freedesktop.ModemManager1.Modem.Location"] = {{"Enabled", 1U}};
        parts[simPath(index)] = {{"SimIdentifier", QString("890010100000012345%1").arg(index)},
                                 {"OperatorName", "Provider"}};
        parts[bearerPath(index)] = {
            {"Connected", true},
            {"Suspended", false},
            {"ProfileId", 1},
            {"Ip4Config", QVariantMap{{"address", "10.20.30.40"}}},
            {"Properties", QVariantMap{{"apn", "internet"}, {"ip-type", 1U}, {"user", "ada"}, {"password", "secret"}}},
            {"Stats",
             QVariantMap{{"downlink-speed", qulonglong(150'000'000)}, {"uplink-speed", qulonglong(50'000'000)}}}};
    }

    /// Tells everybody that a modem has come, or has gone.
    void signalModem(int index, bool isThere) {
        auto signal = QDBusMessage::createSignal(kManagerPath, "org.freedesktop.DBus.ObjectManager",
                                                 isThere ? "InterfacesAdded" : "InterfacesRemoved");
        signal << QVariant::fromValue(QDBusObjectPath(modemPath(index)));
        if (isThere) {
            signal << QVariant::fromValue(modems[index]);
        } else {
            signal << QStringList(modems[index].keys());
            modems.erase(index);
        }
        _bus.send(signal);
    }
    /// Changes properties of a modem and tells everybody.
    void change(int index, const QString& interface, const QVariantMap& properties) {
        modems[index][interface].insert(properties);
        signalChange(modemPath(index), interface, properties);
    }
    void changePart(const QString& path, const QString& interface, const QVariantMap& properties) {
        parts[path].insert(properties);
        signalChange(path, interface, properties);
    }
    void signalChange(const QString& path, const QString& interface, const QVariantMap& properties) {
        auto signal = QDBusMessage::createSignal(path, "org.freedesktop.DBus.Properties", "PropertiesChanged");
        signal << interface << properties << QStringList();
        _bus.send(signal);
    }
    /// Answers what it has left unanswered.
    void wakeUp() {
        hangs = false;
        for (const QDBusMessage& question : std::exchange(_unanswered, {})) answer(question);
    }

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& question, const QDBusConnection&) override {
        asked.append(question.member());
        question.setDelayedReply(true);
        if (hangs) {
            _unanswered.append(question);
        } else {
            answer(question);
        }
        return true;
    }

    std::map<int, Interfaces> modems;
    QMap<QString, QVariantMap> parts;  // SIMs and bearers
    Cells cells;
    Location location;
    QMap<QString, QString> errors;  // an error's name, by method
    QList<uint> rates;              // that Signal.Setup was asked for
    QStringList asked;              // methods
    bool hangs = false;

private:
    void answer(const QDBusMessage& question) {
        const QString method = question.member();
        if (errors.contains(method)) {
            _bus.send(question.createErrorReply(errors[method], "it says no"));
        } else if (method == "GetManagedObjects") {
            Objects objects;
            for (const auto& [index, interfaces] : modems) objects[QDBusObjectPath(modemPath(index))] = interfaces;
            _bus.send(question.createReply(QVariant::fromValue(objects)));
        } else if (method == "GetAll") {
            _bus.send(question.createReply(parts[question.path()]));
        } else if (method == "GetCellInfo") {
            _bus.send(question.createReply(QVariant::fromValue(cells)));
        } else if (method == "GetLocation") {
            _bus.send(question.createReply(QVariant::fromValue(location)));
        } else if (method == "Setup") {
            rates.append(question.arguments().value(0).toUInt());
            _bus.send(question.createReply());
            change(question.path().section('/', -1).toInt(), question.interface(), {{"Rate", rates.last()}});
        } else {
            _bus.send(question.createErrorReply(QDBusError::UnknownMethod, method));
        }
    }

    const QString _connection;
    QDBusConnection _bus;
    QList<QDBusMessage> _unanswered;
};

}  // namespace kelvo::test
