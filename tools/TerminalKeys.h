#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kelvo {

/// What a reader can press while looking at the screens.
enum class TerminalKey { Up, Down, Left, Right, PageUp, PageDown, Home, End, Provenance, Overview, Quit };

/// Finds keys in the bytes a terminal sends (ECMA-48 sequences, in normal and application cursor mode). A sequence may
/// come in pieces; what is no key is dropped.
class TerminalKeys {
public:
    std::vector<TerminalKey> feed(std::string_view bytes);

private:
    std::string _pending;  // the beginning of a sequence
};

}  // namespace kelvo
