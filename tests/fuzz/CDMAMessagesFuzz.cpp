// Any messages may be dropped; none may crash, hang or lead outside its record.

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "tests/fuzz/Messages.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    kelvo::fuzz::decode<kelvo::C2KLogGenerator>({data, size});
    return 0;
}
