#pragma once

#include <span>

#include "LogGenerator/LogCode.h"
#include "tools/share/RecordCopy.h"

namespace kelvo {

/// How one code's records are shared: what does not lie in a plain list of fields a function takes over first.
struct SharedRecord {
    LogCode code;
    std::span<const SharedField> fields;
    void (*lists)(RecordCopy& copy) = nullptr;
};

/// The families' records in the fixed layouts, field by field: every number that a screen shows, what says where such
/// numbers stand, and what Kelvo knows of identities beside them. Sorted by code.
namespace shared {
std::span<const SharedRecord> cdma();
std::span<const SharedRecord> gsmUmts();
std::span<const SharedRecord> lte();
std::span<const SharedRecord> utran();
}  // namespace shared

/// Null for a code that has no table.
const SharedRecord* sharedRecord(LogCode code);

}  // namespace kelvo
