#include "platform/host/HostColorScheme.h"

#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <utility>

#include "platform/host/SessionBus.h"

namespace kelvo {
namespace {

constexpr const char* kPortal = "org.freedesktop.portal.Desktop";
constexpr const char* kPath = "/org/freedesktop/portal/desktop";
constexpr const char* kSettings = "org.freedesktop.portal.Settings";
constexpr const char* kGroup = "org.freedesktop.appearance";
constexpr const char* kKey = "color-scheme";
constexpr const char* kConnection = "kelvo-color-scheme";

// The portal's "Read" wraps its answer in one variant more than "SettingChanged" does.
QVariant unwrapped(QVariant value) {
    while (value.canConvert<QDBusVariant>()) value = value.value<QDBusVariant>().variant();
    return value;
}

}  // namespace

HostColorScheme::HostColorScheme(std::function<void(Scheme)> told) : _told(std::move(told)) {
    const QString address = sessionBusAddress();
    if (address.isEmpty()) return;
    _bus = QDBusConnection::connectToBus(address, kConnection);
    if (!_bus->isConnected()) return;
    qRegisterMetaType<QDBusVariant>();  // else the slot's signature would not be known yet, and never be called
    // Changes first, so that none is missed between the answer and the subscription.
    _bus->connect(kPortal, kPath, kSettings, "SettingChanged", {kGroup, kKey}, QString(), this,
                  SLOT(settingChanged(QString, QString, QDBusVariant)));
    ask();
}

HostColorScheme::~HostColorScheme() {
    if (_bus) QDBusConnection::disconnectFromBus(kConnection);
}

void HostColorScheme::ask() {
    QDBusMessage question = QDBusMessage::createMethodCall(kPortal, kPath, kSettings, "Read");
    question << kGroup << kKey;
    auto* answer = new QDBusPendingCallWatcher(_bus->asyncCall(question), this);
    connect(answer, &QDBusPendingCallWatcher::finished, this, [this, answer] {
        const QDBusPendingReply<QDBusVariant> reply = *answer;
        if (!reply.isError() && !_scheme) tell(reply.value().variant());  // a change that came first is newer
        answer->deleteLater();
    });
}

void HostColorScheme::settingChanged(const QString& group, const QString& key, const QDBusVariant& value) {
    if (group == kGroup && key == kKey) tell(value.variant());
}

void HostColorScheme::tell(const QVariant& value) {
    const uint number = unwrapped(value).toUInt();
    const Scheme scheme = number == 1 ? Scheme::Dark : number == 2 ? Scheme::Light : Scheme::NoPreference;
    if (_scheme == scheme) return;
    _scheme = scheme;
    _told(scheme);
}

}  // namespace kelvo
