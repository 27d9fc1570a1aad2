#pragma once

#include <QList>
#include <QMap>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <cstdint>
#include <optional>
#include <string>

/// Values as they come by the bus. One of another type than expected, or none at all, reads as nothing.
namespace kelvo::modemmanager {

using Interfaces = QMap<QString, QVariantMap>;  ///< an object's properties, by interface

std::string textOf(const QVariant& value);  ///< at most 256 characters; empty: there is none
std::optional<std::int64_t> numberOf(const QVariant& value);
std::optional<double> realOf(const QVariant& value);  ///< finite
bool isTrue(const QVariant& value);
QVariantMap mapOf(const QVariant& value);                                  ///< a{sv}
QStringList textsOf(const QVariant& value);                                ///< as
QString pathOf(const QVariant& value);                                     ///< o; empty for "/", which stands for none
QStringList pathsOf(const QVariant& value);                                ///< ao
QList<std::pair<QString, quint32>> namedNumbersOf(const QVariant& value);  ///< a(su)
Interfaces interfacesOf(const QVariant& value);                            ///< a{sa{sv}}
QMap<QString, Interfaces> objectsOf(const QVariant& value);                ///< a{oa{sa{sv}}}
QList<QVariantMap> mapsOf(const QVariant& value);                          ///< aa{sv}
QMap<quint32, QVariant> numberedOf(const QVariant& value);                 ///< a{uv}

}  // namespace kelvo::modemmanager
