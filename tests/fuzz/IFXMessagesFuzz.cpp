// A tree that cannot be shown is an assertion failure; nothing else may come of any bytes.

#include "LogGenerator/AssertionFailure.h"
#include "LogGenerator/IFX/GSMLogGenerator.h"
#include "tests/fuzz/Messages.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    try {
        kelvo::fuzz::decode<kelvo::GSMLogGenerator>({data, size});
    } catch (const kelvo::AssertionFailure&) {
        // the program would end here
    }
    return 0;
}
