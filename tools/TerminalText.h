#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace kelvo {

/// How many columns of a terminal `text` takes up, UTF-8 without control characters. East Asian characters count two in
/// a locale that knows them.
std::size_t columnsOf(std::string_view text);

/// What a window of `columns` columns, from column `from` on, shows of `text`. Where the text goes on beyond an edge,
/// the column at that edge holds "…": nothing that was cut off can be taken for the whole.
std::string clipped(std::string_view text, std::size_t from, std::size_t columns);

}  // namespace kelvo
