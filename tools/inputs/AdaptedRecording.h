#pragma once

#include <memory>

#include "telephony/adaptation/RecordAdapter.h"
#include "tools/FamilyCodes.h"
#include "tools/import/ImportedFile.h"
#include "tools/import/RecordSurvey.h"
#include "tools/import/RecordingClock.h"
#include "tools/inputs/Input.h"

namespace kelvo {

/// The records of one technology in a file that another tool has recorded, in the layouts that Kelvo shows. Of a phone
/// with several SIMs those of the one that sends first.
class AdaptedRecording final : public InputRecords {
public:
    /// `survey` is that of the whole file.
    AdaptedRecording(std::string path, ImportedFile file, Technology technology, const RecordSurvey& survey);

    Result<std::optional<CapturePacket>> next() override;
    std::vector<std::string> leftOut() const override;

private:
    std::optional<ByteView> taken(const RecordedMessage& message);

    std::string _path;
    ImportedFile _file;
    FamilyCodes _codes;
    std::optional<std::int32_t> _subscription;
    RecordingClock _clock;
    std::unique_ptr<adaptation::RecordAdapter> _adapter = std::make_unique<adaptation::RecordAdapter>();
    std::uint64_t _given = 0;
    std::uint64_t _refused = 0;
};

}  // namespace kelvo
