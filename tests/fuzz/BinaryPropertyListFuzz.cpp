// Any bytes between the signature and the end as a binary property list; none may crash, hang or lead outside the
// document.

#include "platform/encodings/BinaryPropertyListReader.h"

#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    kelvo::fuzz::checkRoundTrip(kelvo::readBinaryPropertyList({data, size}));
    return 0;
}
