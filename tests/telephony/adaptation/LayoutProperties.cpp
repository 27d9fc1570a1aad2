#include "tests/telephony/adaptation/LayoutProperties.h"

#include <fmt/printf.h>
#include <gtest/gtest.h>

#include <memory>
#include <set>

#include "LogGenerator/Factory.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/ShownAt.h"

namespace kelvo::test {
namespace {

constexpr std::size_t kHeader = 13;

/// The screens of a family, fed with records of the fixed layouts.
class Screen {
public:
    explicit Screen(Technology technology) : _generator(generatorFromTechnology(namesOf(technology).identifier)) {}

    std::string text(const Bytes& packet, const std::string& path) {
        _generator->updateState(_state, packet);
        const Value* here = shownAt(_state["Display"], path);
        return here != nullptr && here->string() != nullptr ? *here->string() : "(absent)";
    }

private:
    DirectoryResources _resources{KELVO_RESOURCE_DIR};
    Environment::Scope _environment{{.resources = &_resources}};
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
};

int width(const Bits& bits) { return bits.high - bits.low + 1; }
std::int64_t greatest(const Bits& bits) { return (std::int64_t{1} << width(bits)) - 1; }

std::int64_t readBits(const Bytes& packet, const Bits& bits) {
    std::int64_t value = 0;
    for (int bit = bits.high; bit >= bits.low; --bit) {
        const std::size_t byte = kHeader + bits.at + static_cast<std::size_t>(bit) / 8;
        value = value << 1 | (packet.at(byte) >> (bit % 8) & 1);
    }
    return value;
}

/// All of a narrow field. Of a wide one what levels can reach, both ends and every power of two with its neighbors, and
/// a fraction of the rest.
std::vector<std::uint32_t> valuesOf(const Field& field) {
    std::set<std::uint32_t> values;
    const auto most = static_cast<std::uint64_t>(greatest(field.newer));
    if (width(field.newer) <= 12) {
        for (std::uint64_t raw = 0; raw <= most; ++raw) values.insert(static_cast<std::uint32_t>(raw));
        return {values.begin(), values.end()};
    }
    for (int bit = 0; bit < width(field.newer); ++bit) {
        for (const std::uint64_t raw : {(std::uint64_t{1} << bit) - 1, std::uint64_t{1} << bit}) {
            values.insert(static_cast<std::uint32_t>(raw));
            values.insert(static_cast<std::uint32_t>(most - raw));
        }
    }
    const std::uint64_t stride = most / 599;
    for (std::uint64_t raw = 0; raw <= most; raw += stride) values.insert(static_cast<std::uint32_t>(raw));
    if (field.goes == Goes::ToNearest) {
        for (std::uint32_t raw = 0; raw < 4608; ++raw) values.insert(raw);
        for (std::uint32_t raw = 0; raw < 640; ++raw) values.insert(static_cast<std::uint32_t>(most - raw));
    }
    return {values.begin(), values.end()};
}

/// Whether the fixed field says of `raw` what it should; none of a record that was refused.
testing::AssertionResult goesOver(const Field& field, std::int64_t raw, std::optional<std::int64_t> fixed) {
    const std::int64_t most = greatest(field.fixed);
    const auto is = [&](std::int64_t expected) {
        return fixed == expected ? testing::AssertionSuccess()
                                 : testing::AssertionFailure() << fixed.value_or(-1) << ", not " << expected;
    };
    switch (field.goes) {
        case Goes::AsItStands:
            if (raw <= most) return is(raw);
            return fixed ? testing::AssertionFailure() << "not refused" : testing::AssertionSuccess();
        case Goes::Cut: return is(std::min(raw, most));
        case Goes::AsChannel: return is(std::min<std::int64_t>(raw, 65535));
        case Goes::AsSearch: return is(raw == 63 ? 32 : raw == 32 ? 33 : raw);
        case Goes::ToNearest: break;
    }
    if (!fixed) return testing::AssertionFailure() << "refused";
    const double half = field.fixedScale.step / 2;
    const double missing = field.newerScale.value(raw) - field.fixedScale.value(*fixed);
    const bool isNearest = (missing >= -half || *fixed == 0) && (missing < half || *fixed == most);
    return isNearest
               ? testing::AssertionSuccess()
               : testing::AssertionFailure() << field.fixedScale.value(*fixed) << " of " << field.newerScale.value(raw);
}

std::string printed(const Field& field, std::int64_t fixed) {
    return fixed == field.absent ? "Not Present" : fmt::sprintf(field.format, field.fixedScale.value(fixed));
}

void expectEveryValue(const Layout& layout, const Field& field, std::uint8_t fill, Screen* screen) {
    adaptation::RecordAdapter adapter;
    const Sent base = layout.base(fill);
    Bytes shown;  // what stands on the screen
    for (std::size_t i = 0; const std::uint32_t bits : valuesOf(field)) {
        if (fill != 0 && i++ % 7 != 0) continue;  // what leaks in from around a field does so often
        const bool isNegative = field.newer.isSigned && bits > greatest(field.newer) / 2;
        const std::int64_t raw = std::int64_t{bits} - (isNegative ? greatest(field.newer) + 1 : 0);
        const Sent sent = Sent(base).bits(field.newer.at, field.newer.low, field.newer.high, bits);
        const adaptation::Adapted adapted = adapter.adapt(sent.bytes());
        std::optional<std::int64_t> fixed;
        if (adapted.outcome != adaptation::Adapted::Outcome::Refused) {
            ASSERT_EQ(adapted.outcome, adaptation::Adapted::Outcome::Turned);
            const Bytes packet(adapted.packet.begin(), adapted.packet.end());
            fixed = readBits(packet, field.fixed);
            if (screen != nullptr && !field.path.empty() && packet != shown) {
                ASSERT_EQ(screen->text(packet, field.path), printed(field, *fixed)) << raw;
                shown = packet;
            }
        }
        ASSERT_TRUE(goesOver(field, raw, fixed)) << raw;
    }
}

}  // namespace

void expectEveryValueToGoOver(const Layout& layout) {
    SCOPED_TRACE(layout.name);
    Screen screen(layout.technology);
    for (const Field& field : layout.fields) {
        for (const std::uint8_t fill :
             {std::uint8_t{0x00}, std::uint8_t{0xFF}}) {  // the bits around it are all 0, or all 1
            SCOPED_TRACE(field.name + (fill == 0 ? ", amid 0" : ", amid 1"));
            expectEveryValue(layout, field, fill, fill == 0 ? &screen : nullptr);
        }
    }
}

}  // namespace kelvo::test
