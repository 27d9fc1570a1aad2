// Any text without NUL in the old text form; none may crash, hang or lead outside the document.

#include "platform/encodings/TextPropertyListReader.h"

#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text = kelvo::textOf({data, size});
    if (text.find('\0') == std::string_view::npos) kelvo::fuzz::checkRoundTrip(kelvo::readTextPropertyList(text));
    return 0;
}
