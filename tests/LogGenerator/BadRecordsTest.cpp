#include <gtest/gtest.h>

#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"

namespace kelvo {
namespace {

struct Code {
    LogCode code;
    std::size_t minimum;  ///< shorter records change nothing
};

/// Binds every subscriber to a part of its own, feeds it `bytes` and tells which changed their part.
std::vector<bool> changes(ClassIndex& sections, LogCode code, const Bytes& bytes, const Value& part) {
    std::vector<bool> changed;
    for (Base* section : *sections.getSubscribers(code)) {
        const Value own = part.copy();
        section->updateSectionRef(own);
        section->updateWithData(ByteView(bytes), code);
        changed.push_back(!(own == part));
    }
    return changed;
}

/// Every length up to two bytes past the minimum, in bytes of 0, whose counts are none, and of 0xFF, whose counts lie.
void feedEveryLength(ClassIndex& sections, Code code) {
    const std::size_t subscribers = sections.getSubscribers(code.code)->size();
    for (std::size_t size = 0; size <= code.minimum + 2; ++size) {
        for (const std::uint8_t fill : Bytes{0x00, 0xFF}) {
            const Bytes bytes(size, fill);
            const auto dictionaries = changes(sections, code.code, bytes, Dictionary::make());
            const auto lists = changes(sections, code.code, bytes, Array::make({"row"}));
            for (std::size_t i = 0; i < subscribers; ++i) {  // a section fills the one or the other
                EXPECT_EQ(dictionaries[i] || lists[i], size >= code.minimum) << std::hex << code.code << ' ' << size;
            }
        }
    }
}

TEST(BadRecords, OfLteChangeNothingWhenTheyAreShort) {
    LTEClassIndex sections;
    for (const Code code :
         {Code{0xB0C2, 38}, Code{0xB0C1, 22}, Code{0xB179, 29}, Code{0xB17F, 33}, Code{0xB180, 21}, Code{0xB186, 21}}) {
        feedEveryLength(sections, code);
    }
}

TEST(BadRecords, OfUtranChangeNothingWhenTheyAreShort) {
    UTRANClassIndex sections;
    for (const Code code : {Code{0xD0E2, 26}, Code{0xD00A, 21}, Code{0xD00E, 17}, Code{0xD00C, 17}}) {
        feedEveryLength(sections, code);
    }
    feedEveryLength(sections, {0xD0E0, 0});  // decoded however short
}

TEST(BadRecords, OfCellArraysChangeNothing) {
    LTEClassIndex lte;
    UTRANClassIndex utran;
    for (std::size_t size = 0; size < 40; ++size) {
        for (const std::uint8_t fill : Bytes{0x00, 0x28, 0x7B, 0xFF}) {  // among them runs of the old text's brackets
            const Bytes bytes(size, fill);
            EXPECT_EQ(changes(lte, 0xFF0001, bytes, Dictionary::make()), std::vector<bool>{false});
            EXPECT_EQ(changes(utran, 0xFF0001, bytes, Dictionary::make()), std::vector<bool>{false});
        }
    }
}

}  // namespace
}  // namespace kelvo
