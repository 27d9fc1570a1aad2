#include "telephony/modemmanager/Permission.h"

#include <fmt/format.h>

namespace kelvo::modemmanager {

std::optional<std::string> missingRight(std::string_view method, std::string_view error) {
    if (error == "org.freedesktop.ModemManager1.Error.Core.Unauthorized") {
        return fmt::format("this user lacks the polkit right org.freedesktop.ModemManager1.{}",
                           method == "GetLocation" ? "Location" : "Device.Control");
    }
    if (error == "org.freedesktop.DBus.Error.AccessDenied")
        return fmt::format("the bus's policy (org.freedesktop.ModemManager1.conf) lets root alone call {}", method);
    return std::nullopt;
}

}  // namespace kelvo::modemmanager
