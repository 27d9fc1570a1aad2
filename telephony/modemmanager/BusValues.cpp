#include "telephony/modemmanager/BusValues.h"

#include <QDBusArgument>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <cmath>

namespace kelvo::modemmanager {
namespace {

constexpr qsizetype kLongestText = 256;

/// The value itself, or what the bus has not unpacked because it does not know the type.
template <class Wanted>
Wanted unpacked(const QVariant& value, const char* signature) {
    if (value.metaType() == QMetaType::fromType<Wanted>()) return value.value<Wanted>();
    if (value.metaType() != QMetaType::fromType<QDBusArgument>()) return {};
    const auto argument = value.value<QDBusArgument>();
    return argument.currentSignature() == signature ? qdbus_cast<Wanted>(argument) : Wanted();
}

}  // namespace

std::string textOf(const QVariant& value) {
    return value.typeId() == QMetaType::QString ? value.toString().left(kLongestText).toStdString() : std::string();
}

std::optional<std::int64_t> numberOf(const QVariant& value) {
    switch (value.typeId()) {
        case QMetaType::Int:
        case QMetaType::UInt:
        case QMetaType::Short:
        case QMetaType::UShort:
        case QMetaType::UChar:
        case QMetaType::LongLong: return value.toLongLong();
        case QMetaType::ULongLong: {
            const qulonglong number = value.toULongLong();
            return number >> 63 == 0 ? std::optional(static_cast<std::int64_t>(number)) : std::nullopt;
        }
        default: return std::nullopt;
    }
}

std::optional<double> realOf(const QVariant& value) {
    if (value.typeId() != QMetaType::Double || !std::isfinite(value.toDouble())) return std::nullopt;
    return value.toDouble();
}

bool isTrue(const QVariant& value) { return value.typeId() == QMetaType::Bool && value.toBool(); }

QVariantMap mapOf(const QVariant& value) { return unpacked<QVariantMap>(value, "a{sv}"); }

QStringList textsOf(const QVariant& value) { return unpacked<QStringList>(value, "as"); }

QString pathOf(const QVariant& value) {
    if (value.metaType() != QMetaType::fromType<QDBusObjectPath>()) return {};
    const QString path = value.value<QDBusObjectPath>().path();
    return path == "/" ? QString() : path;
}

QStringList pathsOf(const QVariant& value) {
    QStringList paths;
    for (const QDBusObjectPath& path : unpacked<QList<QDBusObjectPath>>(value, "ao")) paths.append(path.path());
    return paths;
}

QList<std::pair<QString, quint32>> namedNumbersOf(const QVariant& value) {
    QList<std::pair<QString, quint32>> pairs;
    if (value.metaType() != QMetaType::fromType<QDBusArgument>()) return pairs;
    const auto argument = value.value<QDBusArgument>();
    if (argument.currentSignature() != "a(su)") return pairs;
    argument.beginArray();
    while (!argument.atEnd()) {
        std::pair<QString, quint32> pair;
        argument.beginStructure();
        argument >> pair.first >> pair.second;
        argument.endStructure();
        pairs.append(pair);
    }
    argument.endArray();
    return pairs;
}

Interfaces interfacesOf(const QVariant& value) { return unpacked<Interfaces>(value, "a{sa{sv}}"); }

QMap<QString, Interfaces> objectsOf(const QVariant& value) {
    QMap<QString, Interfaces> objects;
    const auto byPath = unpacked<QMap<QDBusObjectPath, Interfaces>>(value, "a{oa{sa{sv}}}");
    for (auto object = byPath.begin(); object != byPath.end(); ++object)
        objects.insert(object.key().path(), object.value());
    return objects;
}

QList<QVariantMap> mapsOf(const QVariant& value) { return unpacked<QList<QVariantMap>>(value, "aa{sv}"); }

QMap<quint32, QVariant> numberedOf(const QVariant& value) {
    QMap<quint32, QVariant> numbered;
    const auto byNumber = unpacked<QMap<quint32, QDBusVariant>>(value, "a{uv}");
    for (auto entry = byNumber.begin(); entry != byNumber.end(); ++entry)
        numbered.insert(entry.key(), entry.value().variant());
    return numbered;
}

}  // namespace kelvo::modemmanager
