#include "tools/share/SharedRecords.h"

#include <algorithm>

namespace kelvo {

const SharedRecord* sharedRecord(LogCode code) {
    for (const auto family : {shared::cdma(), shared::gsmUmts(), shared::lte(), shared::utran()}) {
        const auto found = std::ranges::lower_bound(family, code, {}, &SharedRecord::code);
        if (found != family.end() && found->code == code) return &*found;
    }
    return nullptr;
}

}  // namespace kelvo
