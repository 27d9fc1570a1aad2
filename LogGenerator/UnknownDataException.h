#pragma once

namespace kelvo::LogCode_0xFF0000 {

/// A SIM record whose property list does not parse.
class UnknownDataException {};

}  // namespace kelvo::LogCode_0xFF0000
