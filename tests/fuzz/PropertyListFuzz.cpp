// Any bytes, told apart by how they begin; none may crash, hang or lead outside the document.

#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    kelvo::fuzz::checkRoundTrip(kelvo::readPropertyList({data, size}));
    return 0;
}
