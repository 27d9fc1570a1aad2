// Any text without NUL as XML; none may crash, hang or lead outside the document.

#include "platform/encodings/XmlPropertyListReader.h"

#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text = kelvo::textOf({data, size});
    if (text.find('\0') == std::string_view::npos) kelvo::fuzz::checkRoundTrip(kelvo::readXmlPropertyList(text));
    return 0;
}
