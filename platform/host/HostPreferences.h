#pragma once

#include <filesystem>

#include "platform/system/Preferences.h"

namespace kelvo {

/// Preferences as one property-list file per application, "<configuration>/preferences/<domain>.plist". A file is
/// replaced as a whole (mode 0600) or not at all; one that is no dictionary, or a symbolic link, is left alone.
/// Changes are told on the session bus as the signal Changed(domain, key) of com.zorvik.Preferences.
class HostPreferences final : public Preferences {
public:
    explicit HostPreferences(const std::filesystem::path& configDirectory);
    HostPreferences();  ///< in the user's configuration

    bool set(std::string_view domain, std::string_view key, const Value& value) override;
    /// Blocks for half a second at most, so that a program about to end knows that its signal is out.
    void broadcastChange(std::string_view domain, std::string_view key) override;

private:
    const std::filesystem::path _directory;
};

}  // namespace kelvo
