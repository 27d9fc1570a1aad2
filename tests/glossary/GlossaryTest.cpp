#include "glossary/Glossary.h"

#include <gtest/gtest.h>

#include <set>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordLedger.h"
#include "model/KelvoModelNode.h"
#include "platform/encodings/PropertyList.h"
#include "platform/host/Capture.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"
#include "tests/support/CellArray.h"

namespace kelvo {
namespace {

using test::cell;
using test::Record;

/// Every value that the screens of a family have shown, by its path.
class Screens {
public:
    explicit Screens(Technology technology)
        : _technology(technology), _generator(generatorFromTechnology(namesOf(technology).identifier)) {}

    void feed(const Bytes& message) {
        if (_records.isFull()) _records.forgetAllBut(_state["Display"]);
        const RecordLedger::Counted counted(
            _records, _generator->takesPackets() ? RecordLedger::packetOf(message) : ByteView(), {});
        _generator->updateState(_state, message);
    }
    void look() {
        NodesByPath nodes;
        collect(*KelvoModelNode::makeTreeFromObject(_state["Display"], nodes), "/");
    }
    void show(const Bytes& message) {
        feed(message);
        look();
    }

    /// A record of every code, filled with one byte: lists have entries then.
    void showEveryCode() {
        const DictionaryRef command = _generator->getStartCommand();
        for (const int fill : {0x01, 0x02, 0x41}) {
            const ArrayRef codes = (*command)[kPLSetOskraLogCodes].array();
            for (const Value& code : *codes) {
                Bytes bytes = Record(static_cast<LogCode>(code.number()->integer()), 2000).bytes();
                std::fill(bytes.begin() + 13, bytes.end(), static_cast<std::uint8_t>(fill));
                show(bytes);
            }
        }
    }

    /// A capture, looked at as the application does, every few records; and every value that a record wrote bears it.
    void showCapture() {
        auto capture =
            CaptureReader::open(std::string(KELVO_CAPTURES) + "/" + std::string(namesOf(_technology).word) + ".pcap");
        ASSERT_TRUE(capture) << capture.error().reason;
        for (int count = 1;; ++count) {
            const auto packet = capture->next();
            ASSERT_TRUE(packet);
            if (!*packet) break;
            feed(Bytes((*packet)->bytes.begin(), (*packet)->bytes.end()));
            if (count % 50 == 0) look();
        }
        look();
    }

    const std::set<std::string>& paths() const { return _paths; }
    /// Paths whose value is no longer the template's and that yet bear no record.
    const std::set<std::string>& unmarked() const { return _unmarked; }

private:
    void collect(const KelvoModelNode& node, const std::string& path) {
        if (node.value() != nullptr) {
            _paths.insert(path);
            const bool isTemplates = node.value()->empty() || *node.value() == "–";
            if (!isTemplates && _records.find(node.record()) == nullptr) _unmarked.insert(path);
        }
        if (node.childNodes() == nullptr) return;
        for (const NodeRef& child : *node.childNodes()) collect(*child, pathByAppending(path, child->displayName()));
    }

    const Technology _technology;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    RecordLedger _records;
    std::set<std::string> _paths;
    std::set<std::string> _unmarked;
};

/// A candidate for reselection of each technology, in a record of one.
void showCandidates(Screens& screens) {
    for (const std::uint32_t technology : {0, 1, 2, 3}) {
        screens.show(Record(0xB186, 33).u8(19, 1).u16(23, technology).bytes());
    }
}

void showPhoneServices(Screens& screens) {
    const auto gsm = [](const char* type) {
        return cell("GSM", type,
                    {{"kPLCellMonitorMCC", 1},
                     {"kPLCellMonitorMNC", 1},
                     {"kPLCellMonitorLAC", 1},
                     {"kPLCellMonitorCellId", 1},
                     {"kPLCellMonitorARFCN", 1},
                     {"kPLCellMonitorRSSI", 1}});
    };
    const auto other = [](const char* technology, const char* type) {
        return cell(technology, type,
                    {{"kPLCellMonitorLAC", 1},
                     {"kPLCellMonitorTAC", 1},
                     {"kPLCellMonitorCellId", 1},
                     {"kPLCellMonitorPID", 1},
                     {"kPLCellMonitorBandInfo", 1},
                     {"kPLCellMonitorUARFCN", 1},
                     {"kPLCellMonitorSCN", 1},
                     {"kPLCellMonitorRSCP", 1},
                     {"kPLCellMonitorECN0", 1}});
    };
    screens.show(test::cellArray({gsm("Serving"), gsm("Neighbor"), other("UMTS", "Serving"), other("UMTS", "Neighbor"),
                                  other("LTE", "Serving"), other("UTRAN2", "Serving")})
                     .bytes());
    const Value context = Dictionary::make({{"Context ID", "5"},
                                            {"APN", "internet"},
                                            {"PDP Type", "IPv4"},
                                            {"State", "Active"},
                                            {"PDP Address", "10.0.0.1"},
                                            {"Quality of Service", "Interactive"}});
    screens.show(test::payload(0xFF0002, Array::make({context})).bytes());
}

/// Trees as the simulated cell monitor sends them, in the states that its capture need not reach. Arrays lose their
/// first element, dictionaries of one entry give way to it.
void showCellMonitor(Screens& screens) {
    const auto tree = [](std::string_view part, Value content) {
        return Dictionary::make({{part, std::move(content)}, {"Neighbours", Dictionary::make()}});
    };
    const auto alone = [](std::string_view key, Value value) { return Dictionary::make({{key, std::move(value)}}); };
    screens.show(*writeXmlPropertyList(
        tree("Serving", alone("Cell", Dictionary::make({{"Technology", "GSM"}, {"ARFCN", "1"}, {"C1", "20"}})))));
    screens.show(*writeXmlPropertyList(
        Dictionary::make({{"Neighbours", Dictionary::make({{"GSM", Array::make({"dropped", alone("ARFCN", "7")})},
                                                           {"UMTS", Array::make({"dropped"})}})},
                          {"Registration", alone("State", "Searching")},
                          {"Connection", alone("State", "Idle")}})));
    screens.show(*writeXmlPropertyList(
        tree("Connection", Dictionary::make({{"State", "Packet transfer"}, {"Throughput", "100 kbit/s"}}))));
}

class Glossary : public testing::TestWithParam<Technology> {
protected:
    void SetUp() override {
        if (GetParam() == Technology::IFX) {
            showCellMonitor(screens);
        } else {
            if (GetParam() != Technology::CDMA) showPhoneServices(screens);
            if (GetParam() == Technology::LTE) showCandidates(screens);
            screens.showEveryCode();
        }
        screens.showCapture();
    }

    static std::string placeOf(const Meaning& meaning) {
        return std::string(meaning.section) + "/" + std::string(meaning.key);
    }

    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.resources = &resources}};
    Screens screens{GetParam()};
};

INSTANTIATE_TEST_SUITE_P(Families, Glossary,
                         testing::Values(Technology::IFX, Technology::GSM, Technology::CDMA, Technology::LTE,
                                         Technology::UTRAN),
                         [](const auto& info) { return std::string(namesOf(info.param).name); });

TEST_P(Glossary, TellsWhatEveryShownValueMeansAndNothingElse) {
    std::set<std::string> used;
    for (const std::string& path : screens.paths()) {
        const Meaning* meaning = meaningAt(GetParam(), path);
        EXPECT_NE(meaning, nullptr) << path << " is missing";
        if (meaning != nullptr) used.insert(placeOf(*meaning));
    }
    for (const Meaning& meaning : meaningsOf(GetParam())) {
        EXPECT_TRUE(used.contains(placeOf(meaning))) << placeOf(meaning) << " is shown on no screen";
    }
}

TEST_P(Glossary, EveryValueThatARecordHasWrittenBearsItsNumber) {
    EXPECT_EQ(screens.unmarked(), std::set<std::string>());
}

TEST_P(Glossary, IsWrittenInWholeSentences) {
    for (const Meaning& meaning : meaningsOf(GetParam())) {
        EXPECT_TRUE(meaning.sentence.ends_with('.')) << meaning.key;
        EXPECT_EQ(meaning.sentence.find('|'), std::string_view::npos) << meaning.key;
        EXPECT_FALSE(meaning.key.empty());
        const bool namesABody = meaning.standard.starts_with("3GPP TS ") || meaning.standard.starts_with("3GPP2 C.") ||
                                meaning.standard.starts_with("ETSI TS ");
        EXPECT_TRUE(meaning.standard.empty() || namesABody) << meaning.key << ": " << meaning.standard;
    }
}

TEST(GlossaryLookup, TakesTheMeaningOfTheSectionThatAPathLeadsThrough) {
    const auto standard = [](Technology technology, std::string_view path) {
        const Meaning* meaning = meaningAt(technology, path);
        return meaning != nullptr ? std::string(meaning->standard) : "(none)";
    };
    EXPECT_EQ(standard(Technology::LTE, "/Serving Cell Measurements/Srxlev"), "3GPP TS 36.304, 5.2.3.2");
    EXPECT_EQ(standard(Technology::LTE, "/Neighbor Cells List/3/Srxlev"), "3GPP TS 36.304, 5.2.3.2");
    EXPECT_EQ(standard(Technology::GSM, "/UMTS Radio/UMTS RR Info/Cell ID"), "3GPP TS 25.331");
    EXPECT_EQ(standard(Technology::GSM, "/GSM Cell and Neighbours/GSM Serving Cell/Cell ID"), "3GPP TS 23.003, 4.3.1");
    EXPECT_EQ(standard(Technology::GSM, "/GSM Cell and Neighbours/Mobile Allocation/ARFCNs/2"),
              "3GPP TS 44.018, 10.5.2.21");
    EXPECT_EQ(standard(Technology::CDMA, "/EV-DO/Active Set/12"), "3GPP2 C.S0024");
    EXPECT_EQ(standard(Technology::CDMA, "/1x/Active Set/12"), "3GPP2 C.S0005");
    EXPECT_EQ(standard(Technology::LTE, "/SIM Info/EF-GPRS/PS-LOCI"), "3GPP TS 31.102, 4.2.23");
    EXPECT_EQ(standard(Technology::LTE, "/Serving Cell Info/Nothing"), "(none)");
    EXPECT_EQ(standard(Technology::LTE, ""), "(none)");
    EXPECT_EQ(standard(Technology::CDMA, "/1x/Srxlev"), "(none)");
}

}  // namespace
}  // namespace kelvo
