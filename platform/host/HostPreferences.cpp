#include "platform/host/HostPreferences.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSaveFile>

#include <algorithm>
#include <cctype>
#include <string>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostPaths.h"
#include "platform/host/SessionBus.h"
#include "platform/system/Environment.h"

namespace kelvo {
namespace {

constexpr int kBusLimitMs = 500;
constexpr qint64 kLongestFile = 16 * 1024 * 1024;

// A domain becomes a file name.
bool isDomain(std::string_view domain) {
    const auto isAllowed = [](unsigned char c) {
        return c < 0x80 && (std::isalnum(c) != 0 || c == '.' || c == '-' || c == '_');
    };
    return !domain.empty() && domain.size() <= 128 && domain.front() != '.' &&
           std::all_of(domain.begin(), domain.end(), isAllowed);
}

Failure failed(const char* what, const QFileDevice& file) {
    return {std::string("cannot ") + what + " " + file.fileName().toStdString() + ": " +
            file.errorString().toStdString()};
}

// The preferences that are there; none yet is an empty dictionary.
Result<DictionaryRef> load(const QString& path) {
    QFile file(path);
    if (QFileInfo(path).isSymLink()) return Failure{path.toStdString() + " is a symbolic link"};
    if (!file.exists()) return Dictionary::make();
    if (!file.open(QIODevice::ReadOnly)) return failed("open", file);
    const QByteArray bytes = file.read(kLongestFile);
    const auto read = readPropertyList(bytesOf({bytes.data(), static_cast<std::size_t>(bytes.size())}));
    if (!read) return Failure{"cannot read " + path.toStdString() + ": " + read.error().reason};
    if (!read->dictionary()) return Failure{path.toStdString() + " is no dictionary"};
    return read->dictionary();
}

Result<void> save(const QString& path, const DictionaryRef& preferences) {
    const auto encoded = writeXmlPropertyList(preferences);
    if (!encoded) return Failure{"cannot write " + path.toStdString() + ": " + encoded.error().reason};
    QSaveFile file(path);
    const auto size = static_cast<qint64>(encoded->size());
    if (!file.open(QIODevice::WriteOnly) || !file.setPermissions(QFile::ReadOwner | QFile::WriteOwner) ||
        file.write(reinterpret_cast<const char*>(encoded->data()), size) != size || !file.commit())
        return failed("write", file);
    return {};
}

Result<void> change(const std::filesystem::path& directory, std::string_view domain, std::string_view key,
                    const Value& value) {
    if (!isDomain(domain)) return Failure{"the domain is no file name"};
    const QString folder = QString::fromStdString(directory);
    if (!QDir().mkpath(folder)) return Failure{"cannot make directory " + directory.string()};
    const QString path =
        folder + '/' + QString::fromUtf8(domain.data(), static_cast<qsizetype>(domain.size())) + ".plist";
    const auto preferences = load(path);
    if (!preferences) return preferences.error();
    (*preferences)->set(key, value);
    return save(path, *preferences);
}

bool sendOn(QDBusConnection bus, const QDBusMessage& signal) {
    if (!bus.isConnected() || !bus.send(signal)) return false;
    // Sending only queues. What the bus answers comes after everything that was queued before.
    const QDBusMessage question = QDBusMessage::createMethodCall("org.freedesktop.DBus", "/org/freedesktop/DBus",
                                                                 "org.freedesktop.DBus", "GetId");
    return bus.call(question, QDBus::Block, kBusLimitMs).type() == QDBusMessage::ReplyMessage;
}

bool sendChanged(const QString& domain, const QString& key) {
    const QString address = sessionBusAddress();
    if (address.isEmpty()) return false;
    QDBusMessage signal = QDBusMessage::createSignal("/com/zorvik/Preferences", "com.zorvik.Preferences", "Changed");
    signal << domain << key;
    const QString connection = "kelvo-preferences";
    const bool sent = sendOn(QDBusConnection::connectToBus(address, connection), signal);
    QDBusConnection::disconnectFromBus(connection);
    return sent;
}

}  // namespace

HostPreferences::HostPreferences(const std::filesystem::path& configDirectory)
    : _directory(configDirectory / "preferences") {}
HostPreferences::HostPreferences() : HostPreferences(HostPaths::configDirectory()) {}

bool HostPreferences::set(std::string_view domain, std::string_view key, const Value& value) {
    const auto changed = change(_directory, domain, key, value);
    if (!changed) logLine(Level::Error, "Could not write preference %s: %s", key, changed.error().reason);
    return static_cast<bool>(changed);
}

void HostPreferences::broadcastChange(std::string_view domain, std::string_view key) {
    const auto text = [](std::string_view from) {
        return QString::fromUtf8(from.data(), static_cast<qsizetype>(from.size()));
    };
    if (!sendChanged(text(domain), text(key)))
        logLine(Level::Error, "Could not tell that preference %s of %s changed: no session bus", key, domain);
}

}  // namespace kelvo
