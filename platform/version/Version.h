#pragma once

#include <string>
#include <string_view>

namespace kelvo {

/// The version of all programs: "1.0.0".
std::string_view version();

/// What `--version` of `program` says, without a line's end: "kelvoctl 1.0.0 (commit 584c5be01234, Release, GNU 12.2,
/// x86_64)". A commit that was built with changes ends with "+changes"; of sources that come neither from git nor from
/// an archive that git made it is "unknown".
std::string versionLine(std::string_view program);

}  // namespace kelvo
