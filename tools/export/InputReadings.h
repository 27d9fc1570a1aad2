#pragma once

#include <functional>

#include "tools/export/ChosenReadings.h"
#include "tools/export/ReadingRows.h"
#include "tools/export/ValueGlobs.h"
#include "tools/inputs/Input.h"

namespace kelvo {

/// Decodes the whole of an input, the `number`th, and hands its readings to `rows`. `goesOn` is asked at every record:
/// false ends the input there. What ends it early, a record that ends the program elsewhere among it, is told in
/// `breakOff`; what was read before stands.
ReadInput readReadings(Input& input, std::size_t number, const Choice& choice, ValueGlobs& globs, ReadingRows& rows,
                       const std::function<bool()>& goesOn);

}  // namespace kelvo
