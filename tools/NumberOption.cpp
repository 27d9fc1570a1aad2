#include "tools/NumberOption.h"

#include "platform/encodings/WholeNumber.h"

namespace kelvo {

CLI::Option* addNumberOption(CLI::App& command, const std::string& name, std::optional<std::uint64_t>& number,
                             std::uint64_t least, const std::string& help) {
    const auto read = [&number, name, least](const std::string& text) {
        const auto parsed = wholeNumber(text, least);
        if (!parsed) throw CLI::ValidationError(name, parsed.error().reason);
        number = *parsed;
    };
    return command.add_option_function<std::string>(name, read, help)->type_name("N");
}

}  // namespace kelvo
