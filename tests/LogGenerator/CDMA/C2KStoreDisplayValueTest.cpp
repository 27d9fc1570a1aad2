#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

Value binding(const DictionaryRef& display, const char* key) {
    return Dictionary::make({{"key", key}, {"dict", display}});
}

class C2KDisplayStore : public testing::Test {
protected:
    DictionaryRef first = Dictionary::make({{"A", ""}});
    DictionaryRef second = Dictionary::make({{"B", ""}, {"C", ""}});
};

TEST_F(C2KDisplayStore, FillsEveryBoundPlace) {
    const DictionaryRef lookup =
        Dictionary::make({{"kChannel", Array::make({binding(first, "A"), binding(second, "C")})}});
    C2KStoreDisplayValue("kChannel", "812", lookup);
    EXPECT_EQ(*first, *Dictionary::make({{"A", "812"}}));
    EXPECT_EQ(*second, *Dictionary::make({{"B", ""}, {"C", "812"}}));
}

TEST_F(C2KDisplayStore, PutsTheSameObjectInEveryPlace) {
    const DictionaryRef lookup = Dictionary::make({{"k", Array::make({binding(first, "A"), binding(second, "B")})}});
    const DictionaryRef pilots = Dictionary::make({{"0;1", "+0.00 dB"}});
    C2KStoreDisplayValue("k", pilots, lookup);
    EXPECT_EQ((*first)["A"].dictionary(), pilots);
    EXPECT_EQ((*second)["B"].dictionary(), pilots);
    C2KStoreDisplayValue("k", "(none)", lookup);
    EXPECT_EQ((*first)["A"], Value("(none)"));
    EXPECT_EQ(*pilots, *Dictionary::make({{"0;1", "+0.00 dB"}}));
}

TEST_F(C2KDisplayStore, DropsAKeyThatIsNotBound) {
    C2KStoreDisplayValue("kChannel", "812", Dictionary::make({{"other", Array::make({binding(first, "A")})}}));
    C2KStoreDisplayValue("kChannel", "812", Dictionary::make({{"kChannel", binding(first, "A")}}));  // no array
    C2KStoreDisplayValue("kChannel", "812", nullptr);
    EXPECT_EQ(*first, *Dictionary::make({{"A", ""}}));
}

TEST_F(C2KDisplayStore, StopsAtAMalformedBinding) {
    for (const Value& malformed :
         {Value("text"), Value(Dictionary::make()), Value(Dictionary::make({{"key", "A"}})),
          Value(Dictionary::make({{"key", "A"}, {"dict", "text"}})), Value(Dictionary::make({{"dict", first}})),
          Value(Dictionary::make({{"key", 1}, {"dict", first}}))}) {
        first = Dictionary::make({{"A", ""}});
        second = Dictionary::make({{"B", ""}});
        C2KStoreDisplayValue(
            "k", "new", Dictionary::make({{"k", Array::make({binding(first, "A"), malformed, binding(second, "B")})}}));
        EXPECT_EQ(*first, *Dictionary::make({{"A", "new"}}));
        EXPECT_EQ(*second, *Dictionary::make({{"B", ""}}));
    }
}

}  // namespace
}  // namespace kelvo
