#include "LogGenerator/PhoneServices/SimInfo.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "LogGenerator/PhoneServices/SimFiles.h"
#include "LogGenerator/UnknownDataException.h"
#include "platform/system/Environment.h"

namespace kelvo {

void SimInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "SimInfo");
    if (logCode != code::kSimFiles) return;
    const Value files = payloadPropertyList(data);
    if (!files) {
        logLine(Level::Error, "SIM File dictionary data could not be constructed");
        throw LogCode_0xFF0000::UnknownDataException();
    }
    if (!files.dictionary() || !values()) return;
    for (const SimFile& file : kElementaryFiles) {
        if (const Value* value = files.dictionary()->find(file.key)) showDelivered(values()->slot(file.label), *value);
    }
}

}  // namespace kelvo
