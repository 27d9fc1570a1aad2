// Any bytes may be refused; none may crash, hang or read outside the document. What is read can be written, and what
// was written reads back as the same document.

#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "platform/PropertyList.h"

namespace {

using namespace kelvo;

void require(bool condition, const char* what) {
    if (condition) return;
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

Value mustRead(const Bytes& document) {
    Result<Value> value = readPropertyList(document);
    require(static_cast<bool>(value), "what was written does not read back");
    return std::move(value).value();
}

Bytes mustWrite(const Value& value) {
    Result<Bytes> document = writeXmlPropertyList(value);
    require(static_cast<bool>(document), "what was read cannot be written");
    return std::move(document).value();
}

/// Characters that XML cannot carry may make two keys one, which only then changes the document once more.
bool hasReplacements(const Bytes& document) { return textOf(document).find("\xEF\xBF\xBD") != std::string_view::npos; }

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Result<Value> value = readPropertyList({data, size});
    if (!value) {
        require(value.error().reason.find('\n') == std::string::npos, "a reason of more than one line");
        return 0;
    }
    require(static_cast<bool>(*value), "a none value was read");
    const Bytes document = mustWrite(*value);
    const Bytes again = mustWrite(mustRead(document));
    require(document == again || hasReplacements(document), "what was written reads back as something else");
    return 0;
}
