#pragma once

#include <memory>
#include <string>

#include "platform/values/Result.h"
#include "ui/ReplayService.h"
#include "ui/SavedScreens.h"

namespace kelvo {

/// What the application was started with: a capture that is replayed, or a snapshot's screens. What a file is, its
/// content tells. Needs a QCoreApplication.
struct OpenedFile {
    std::unique_ptr<ReplayService> replay;        ///< of a capture; else null
    std::shared_ptr<const SavedScreens> screens;  ///< of a snapshot; else null
    std::string window;  ///< of a snapshot, the name of its window among the user's: another for every other file

    /// Opens the file at `path`, or at the file URL that desktops hand over instead. `service` is the program that
    /// replays captures. A failure's reason is one line, fit to be shown, that names the file.
    static Result<OpenedFile> open(const std::string& path, const std::filesystem::path& service);
};

/// The path that a desktop means by `argument`: itself, or that of a file URL.
std::string pathFromArgument(const std::string& argument);

}  // namespace kelvo
