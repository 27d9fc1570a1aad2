#include "tests/telephony/simulation/TestSim.h"

#include <fmt/format.h>
#include <gtest/gtest.h>

#include <map>

namespace kelvo::test {

void expectTestSim(Played& played, const std::string& path, const std::optional<RegisteredArea>& area) {
    const std::string location = area ? fmt::format("{:04X}", area->location) : "FFFE";
    const std::string routing = area ? fmt::format("{:02X}", area->routing) : "FF";
    const std::string status = area ? "00" : "01";  // updated, not updated
    const std::map<std::string, std::string> expected{
        {"EF-ICCID", "8900101000000123456"},
        {"EF-MSISDN", "+0015550123"},
        {"EF-3GPP MAIL BOX DIALING NUMBER", "+0015550100"},
        {"EF-HPPLMN SEARCH PERIOD", "05"},
        {"EF-LOCI", "3A9C41D700F110" + location + "FF" + status},
        {"EF-GPRS/PS-LOCI", "C41B7E02A95D1300F110" + location + routing + status},
        {"EF-ACCESS CONTROL CLASS", "0008"},
        {"EF-ADMINISTRATIVE DATA", "00000102"},
        {"EF-FPLMN", "00F120FFFFFFFFFFFFFFFFFF"},
        {"EF-ACTING HPLMN", "00F110"},
        {"EF-RAT MODE", "00"},
        {"EF-PLMN NETWORK NAME", "Test Network"},
        {"EF-OPERATOR PLMN LIST", "00F1100000FFFE01"},
        {"EF-OPLMNAcT", "00F110C080"},
    };
    const Value* files = played.at(path);
    ASSERT_TRUE(files != nullptr && files->dictionary());
    std::map<std::string, std::string> shown;
    for (const auto& [name, text] : *files->dictionary()) shown[name] = text.string() ? *text.string() : "(no text)";
    EXPECT_EQ(shown, expected);
}

}  // namespace kelvo::test
