#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/telephony/Technology.h"
#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {

/// Bits `low` to `high` of the little-endian word at a payload offset.
struct Bits {
    std::size_t at;
    int low;
    int high;
    bool isSigned = false;
};
inline Bits u8At(std::size_t at) { return {at, 0, 7}; }
inline Bits u16At(std::size_t at) { return {at, 0, 15}; }
inline Bits s16At(std::size_t at) { return {at, 0, 15, true}; }
inline Bits u32At(std::size_t at) { return {at, 0, 31}; }

/// What a raw number says: raw x step + lowest.
struct Scale {
    double step = 1;
    int lowest = 0;
    double value(std::int64_t raw) const { return static_cast<double>(raw) * step + lowest; }
};

/// How a field of a newer layout goes over to the fixed one.
enum class Goes {
    AsItStands,  ///< and makes the record refused where it does not fit
    ToNearest,   ///< the nearest that the fixed field can say, the upper of two
    Cut,         ///< at most the fixed field's greatest
    AsChannel,   ///< at most 65535
    AsSearch,    ///< 63 to 32 and 32 to 33
};

/// One field as the description of the layouts has it: where it lies there and here, and how the screens print it.
struct Field {
    std::string name;
    Goes goes;
    Bits newer;
    Bits fixed;
    Scale newerScale = {};
    Scale fixedScale = {};
    std::string path = {};                    ///< on the screens; empty: not shown
    std::string format = {};                  ///< of the shown value, for printf with a double
    std::optional<std::int64_t> absent = {};  ///< the fixed raw number that shows as "Not Present"
};

struct Layout {
    std::string name;
    Technology technology;
    /// A record that has everything but the fields at their places, with these bytes where nothing is demanded.
    std::function<Sent(std::uint8_t fill)> base;
    std::vector<Field> fields;
};

/// Writes every value of every field (of fields of more than 16 bits: many), adapts the record, and holds the fixed
/// field and what the screens show against the value that was written.
void expectEveryValueToGoOver(const Layout& layout);

}  // namespace kelvo::test
