// Any messages may be dropped; none may crash, hang or lead outside its record.

#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "tests/fuzz/Messages.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    kelvo::fuzz::decode<kelvo::UTRANLogGenerator>({data, size});
    return 0;
}
