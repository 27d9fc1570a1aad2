#pragma once

#include "platform/telephony/RecordTime.h"

/// The timestamps of frames are those of the records in them.
namespace kelvo::wire {

using kelvo::SystemTime;
using kelvo::timeOf;
using kelvo::timestampOf;

}  // namespace kelvo::wire
