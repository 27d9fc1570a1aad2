#include "tools/CommandFailure.h"

#include <cxxabi.h>

#include <cstdlib>
#include <memory>
#include <string_view>
#include <typeinfo>

namespace kelvo {

namespace {

std::string currentExceptionTypeName() {
    const std::type_info* type = abi::__cxa_current_exception_type();
    if (type == nullptr) return "unknown exception";
    int status = 0;
    const std::unique_ptr<char, void (*)(void*)> name(abi::__cxa_demangle(type->name(), nullptr, nullptr, &status),
                                                      std::free);
    return status == 0 ? name.get() : type->name();
}

}  // namespace

std::string currentExceptionText() {
    try {
        throw;
    } catch (const std::exception& exception) {
        const std::string_view text = exception.what();
        if (!text.empty() && text != "std::exception") return std::string(text);
        return currentExceptionTypeName();
    } catch (...) {
        return currentExceptionTypeName();
    }
}

}  // namespace kelvo
