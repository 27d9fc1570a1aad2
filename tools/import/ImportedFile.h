#pragma once

#include <memory>
#include <string>
#include <vector>

#include "telephony/recordings/RecordingKind.h"
#include "telephony/recordings/RecordingReader.h"

namespace kelvo {

/// A file to import, opened as what its content says it is: a stream of frames, a DLF file, a capture or a snapshot.
struct ImportedFile {
    RecordingKind kind{};
    std::unique_ptr<RecordingReader> reader{};
    bool holdsTrees = false;         ///< a cell monitor's messages, which are no records
    std::vector<std::string> odd{};  ///< what a snapshot lacks

    /// A failure's reason names the file; one that is no recording is one.
    static Result<ImportedFile> open(const std::string& path);
};

/// What stands in a file beside sound records, as far as it has been read: a sentence each, which names the file.
std::vector<std::string> damageOf(const std::string& path, const ImportedFile& file);

}  // namespace kelvo
