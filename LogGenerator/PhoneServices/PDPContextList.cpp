#include "LogGenerator/PhoneServices/PDPContextList.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"

namespace kelvo {

void PDPContextList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "PDPContextList");
    if (logCode != code::kPDPContexts) return reportUnknown(logCode);
    Value contexts;
    showDelivered(contexts, payloadPropertyList(data));
    if (contexts.array()) replaceArray(list(), {contexts.array()->begin(), contexts.array()->end()});
}

}  // namespace kelvo
