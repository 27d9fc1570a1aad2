#pragma once

#include <optional>

#include "telephony/modemmanager/BusValues.h"
#include "telephony/phone/PhoneState.h"

namespace kelvo::modemmanager {

inline constexpr const char* kModem = "org.freedesktop.ModemManager1.Modem";
inline constexpr const char* kModem3gpp = "org.freedesktop.ModemManager1.Modem.Modem3gpp";
inline constexpr const char* kSignal = "org.freedesktop.ModemManager1.Modem.Signal";
inline constexpr const char* kLocation = "org.freedesktop.ModemManager1.Modem.Location";
inline constexpr const char* kSim = "org.freedesktop.ModemManager1.Sim";
inline constexpr const char* kBearer = "org.freedesktop.ModemManager1.Bearer";

/// What ModemManager has told, as it came: every modem, and the SIM and bearers of the one that is followed.
struct ModemObjects {
    QMap<QString, Interfaces> objects = {};                ///< by path
    std::optional<QList<QVariantMap>> cells = {};          ///< what GetCellInfo said; none: nothing
    std::optional<QMap<quint32, QVariant>> location = {};  ///< what GetLocation said, likewise

    QVariant get(const QString& path, const char* interface, const char* name) const;
};

/// The modems' paths, in the order of their indices.
QStringList modemsOf(const ModemObjects& known);
/// "3" of ".../Modem/3".
QString indexOf(const QString& modem);
/// The paths of the SIM and of the bearers of a modem.
QString simOf(const ModemObjects& known, const QString& modem);
QStringList bearersOf(const ModemObjects& known, const QString& modem);

/// What all this says of the phone whose modem is at `modem`; empty: there is none.
phone::PhoneState phoneOf(const ModemObjects& known, const QString& modem);

}  // namespace kelvo::modemmanager
