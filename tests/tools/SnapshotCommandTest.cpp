#include "platform/encodings/PropertyList.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::KelvoctlTest;
using test::servingCell;

struct SnapshotCommand : KelvoctlTest {
    /// Writes a snapshot file with this tree in it.
    std::string snapshot(const Value& tree) { return directory.write("in.kelvo", *writeXmlPropertyList(tree)); }
    std::string snapshotOf(ArrayRef data) {
        return snapshot(Dictionary::make({{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", std::move(data)}}));
    }
    /// The snapshot of a capture, saved by the program itself.
    std::string saved(const std::vector<Bytes>& messages) {
        kelvoctl({"decode", "--refresh-every", "2", "--save", path("saved.kelvo"), "--force",
                  capture(Technology::LTE, messages)});
        return path("saved.kelvo");
    }
};

TEST_F(SnapshotCommand, ListsTimeDescriptionAndEntries) {
    const std::string file = snapshot(Dictionary::make(
        {{"Timestamp", "2011-03-04 09:15:02 +0000"},
         {"Data",
          Array::make({Dictionary::make({{"DisplayState", Bytes{1, 2, 3}},
                                         {"Date", "2011-03-04 10:15:00 +0100"},
                                         {"Description", "Snapshot (2011-03-04 10:15:00 +0100)"}}),
                       Dictionary::make({{"Description", "DLF binary (4 bytes)"}, {"DLF", Bytes{4, 5, 6, 7}}})})},
         {"Description", "at the window"}}));
    const Finished done = kelvoctl({"snapshot", file});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output,
              "Timestamp    2011-03-04 09:15:02 +0000\n"
              "Description  at the window\n"
              "Entries      2\n"
              "  1  2011-03-04 10:15:00 +0100       3 bytes  Snapshot (2011-03-04 10:15:00 +0100)\n"
              "  2  -                               4 bytes  DLF binary (4 bytes)\n");
}

TEST_F(SnapshotCommand, ShowsAnEntryAsTreeAndAsJson) {
    const std::string file = saved({servingCell(1), servingCell(2), servingCell(3)});
    EXPECT_EQ(json({"snapshot", file, "--entry", "1", "--json"})["Serving Cell Info"]["Physical Cell ID"], "2");
    EXPECT_EQ(json({"snapshot", file, "--entry", "2", "--json"})["Serving Cell Info"]["Physical Cell ID"], "3");
    EXPECT_EQ(kelvoctl({"snapshot", file, "--entry", "2"}).output, kelvoctl({"decode", path("in.pcap")}).output);
}

TEST_F(SnapshotCommand, RefusesAnEntryThatIsNotThere) {
    const std::string file = saved({servingCell(1)});
    expectFailure(kelvoctl({"snapshot", file, "--entry", "3"}), file + " has 2 entries, and no entry 3");
    expectFailure(kelvoctl({"snapshot", file, "--entry", "2"}), "entry 2 of " + file + " holds no display");
    for (const char* entry : {"0", "-1", "two"}) {
        expectFailure(
            kelvoctl({"snapshot", file, "--entry", entry}),
            std::string("--entry: ") + entry + " is not a whole number from 1 (kelvoctl --help tells what there is)");
    }
}

TEST_F(SnapshotCommand, ExtractsTheDlf) {
    const Finished done = kelvoctl({"snapshot", saved({servingCell(1)}), "--dlf", path("out.dlf")});
    EXPECT_EQ(done.status, 0) << done.errors;
    const std::string dlf = contentsOf(path("out.dlf"));
    ASSERT_EQ(dlf.size(), 161U + 37);
    EXPECT_EQ(dlf.substr(0, 4), std::string("\xa1\x00\xfd\x1f", 4));    // 161 bytes, 0x1ffd
    EXPECT_EQ(dlf.substr(161, 4), std::string("\x25\x00\xc2\xb0", 4));  // 37 bytes, 0xB0C2
}

TEST_F(SnapshotCommand, ReplacesNoFileUnlessForcedAndNeverTheSnapshot) {
    const std::string file = saved({servingCell(1)});
    const std::string before = contentsOf(file);
    for (const std::vector<std::string>& output :
         {std::vector<std::string>{"--dlf"}, {"--technology", "lte", "--capture"}}) {
        const auto write = [&](const std::string& to, bool force) {
            std::vector<std::string> arguments{"snapshot", file};
            if (force) arguments.push_back("--force");
            arguments.insert(arguments.end(), output.begin(), output.end());
            arguments.push_back(to);
            return kelvoctl(arguments);
        };
        const std::string earlier = directory.write("earlier", bytesOf("earlier"));
        expectFailure(write(earlier, false), earlier + " exists already; --force replaces it");
        EXPECT_EQ(contentsOf(earlier), "earlier");
        EXPECT_EQ(write(earlier, true).status, 0);
        EXPECT_NE(contentsOf(earlier), "earlier");
        expectFailure(write(file, true), file + " is the file being read");
        EXPECT_EQ(contentsOf(file), before);
    }
}

TEST_F(SnapshotCommand, SaysWhenThereIsNoDlf) {
    const std::string file = snapshotOf(Array::make());
    expectFailure(kelvoctl({"snapshot", file, "--dlf", path("out.dlf")}), file + " holds no DLF");
    EXPECT_FALSE(std::filesystem::exists(path("out.dlf")));
}

TEST_F(SnapshotCommand, WhatWasOnTheScreenIsThereAgainWhenItsCaptureIsDecoded) {
    Bytes prefixed{0x81, 0x00};
    const Bytes antennas = test::Record(0xB0C1, 22).u8(20, 2).bytes();
    prefixed.insert(prefixed.end(), antennas.begin(), antennas.end());
    const std::string file = saved({prefixed, servingCell(2), test::Record(0x1234, 20).bytes(), servingCell(4)});
    const Finished done = kelvoctl({"snapshot", file, "--capture", path("again.pcap"), "--technology", "lte"});
    EXPECT_EQ(done.status, 0) << done.errors;
    EXPECT_EQ(done.output, "4 messages written to " + path("again.pcap") + "\n");

    const auto before = json({"decode", "--json", path("in.pcap")});
    EXPECT_EQ(before["display"]["Serving Cell Info"]["Num Tx Antennas"], "2");
    EXPECT_EQ(json({"decode", "--json", path("again.pcap")}), before);
}

TEST_F(SnapshotCommand, SpreadsMessagesOverTheRefreshBeforeTheirDate) {
    Bytes two = servingCell(1);
    const Bytes second = servingCell(2);
    two.insert(two.end(), second.begin(), second.end());
    const std::string file =
        snapshotOf(Array::make({Dictionary::make({{"DisplayState", two}, {"Date", "2011-03-04 10:15:02 +0100"}})}));
    kelvoctl({"snapshot", file, "--capture", path("again.pcap"), "--technology", "lte"});
    auto reader = CaptureReader::open(path("again.pcap"));
    ASSERT_TRUE(reader);
    EXPECT_EQ(reader->technology(), Technology::LTE);
    EXPECT_EQ(reader->next().value()->time.time_since_epoch(), std::chrono::seconds(1299230100));
    EXPECT_EQ(reader->next().value()->time.time_since_epoch(), std::chrono::seconds(1299230101));
}

TEST_F(SnapshotCommand, ACellMonitorsTreeBecomesAMessage) {
    const Value tree = Dictionary::make({{"Serving", Dictionary::make({{"Cell", "A"}})}});
    const std::string file = snapshotOf(Array::make({Dictionary::make({{"DisplayState", tree}})}));
    const Finished done = kelvoctl({"snapshot", file, "--capture", path("again.pcap"), "--technology", "ifx"});
    EXPECT_EQ(done.status, 0) << done.errors;
    auto reader = CaptureReader::open(path("again.pcap"));
    ASSERT_TRUE(reader);
    const auto packet = reader->next();
    ASSERT_TRUE(packet && packet.value());
    EXPECT_EQ(*readPropertyList(packet.value()->bytes), tree);
}

TEST_F(SnapshotCommand, KeepsWholeRecordsBeforeOneThatLies) {
    Bytes records = servingCell(1);
    for (const std::uint8_t byte : Bytes{1, 0xff, 0xff, 9}) records.push_back(byte);
    const std::string file = snapshotOf(Array::make({Dictionary::make({{"DisplayState", records}})}));
    const Finished done = kelvoctl({"snapshot", file, "--capture", path("again.pcap"), "--technology", "lte"});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.output, "1 messages written to " + path("again.pcap") + "\n");
    EXPECT_EQ(done.errors, "kelvoctl: " + file + ": entry 1 ends in 4 bytes that form no whole record\n");
}

TEST_F(SnapshotCommand, SaysWhenThereAreNoRecordsToWrite) {
    const std::string file = snapshotOf(Array::make());
    expectFailure(kelvoctl({"snapshot", file, "--capture", path("again.pcap"), "--technology", "lte"}),
                  "the snapshot holds no raw records");
    EXPECT_FALSE(std::filesystem::exists(path("again.pcap")));
}

TEST_F(SnapshotCommand, SaysInOneLineWhyAFileIsNoSnapshot) {
    expectFailure(kelvoctl({"snapshot", path("none")}), path("none") + " cannot be read: No such file or directory");
    expectFailure(kelvoctl({"snapshot", directory.path()}),
                  directory.path().string() + " cannot be read: Is a directory");
    const std::string file = directory.write("in.kelvo", {});
    expectFailure(kelvoctl({"snapshot", file}), file + " is empty");
    snapshot("a string");
    expectFailure(kelvoctl({"snapshot", file}), file + " is not a snapshot: it holds a string");
    snapshot(Dictionary::make({{"Other", "x"}}));
    expectFailure(kelvoctl({"snapshot", file}), file + " is not a snapshot: it has neither \"Timestamp\" nor \"Data\"");
}

TEST_F(SnapshotCommand, ACutFileGivesOneLineWhereverItIsCut) {
    const std::string whole = contentsOf(saved({servingCell(1)}));
    for (std::size_t length = 1; length < whole.size() - 20; length += whole.size() / 7) {
        const std::string file = directory.write("cut.kelvo", bytesOf(whole).first(length));
        const Finished done = kelvoctl({"snapshot", file});
        EXPECT_EQ(done.status, 1) << length;
        EXPECT_EQ(done.errors.find("kelvoctl: " + file + " is not a snapshot: "), 0U) << done.errors;
        EXPECT_EQ(std::count(done.errors.begin(), done.errors.end(), '\n'), 1) << done.errors;
    }
}

TEST_F(SnapshotCommand, ListsWhatIsThereAndSaysOnceWhatIsOdd) {
    const std::string file =
        snapshotOf(Array::make({Value(5), Dictionary::make({{"Date", 7}, {"Description", "one"}, {"DLF", "text"}})}));
    const Finished done = kelvoctl({"snapshot", file});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.output,
              "Timestamp    2011-03-04 09:15:02 +0000\n"
              "Description  -\n"
              "Entries      2\n"
              "  1  -                               nothing  -\n"
              "  2  -                               nothing  one\n");
    EXPECT_EQ(done.errors,
              "kelvoctl: " + file + ": entry 1 is a number, not a dictionary, and 2 more things are odd\n");
}

TEST_F(SnapshotCommand, AnEntryCannotTakeTheTerminalOver) {
    const std::string file = directory.write(
        "in.kelvo", bytesOf(R"({Timestamp=t;Data=({Description="a\033[2Jb";Display={"k\033"="v\r";};});})"));
    EXPECT_EQ(json({"snapshot", file, "--entry", "1", "--json"})["k\x1b"], "v\r");
    EXPECT_EQ(kelvoctl({"snapshot", file}).output.find('\x1b'), std::string::npos);
    const std::string shown = kelvoctl({"snapshot", file, "--entry", "1"}).output;
    EXPECT_EQ(shown.find_first_of("\x1b\r"), std::string::npos) << shown;
}

TEST_F(SnapshotCommand, RefusesOptionsThatNeedAnother) {
    const std::string file = snapshotOf(Array::make());
    expectFailure(kelvoctl({"snapshot", file, "--json"}),
                  "--json requires --entry (kelvoctl --help tells what there is)");
    expectFailure(kelvoctl({"snapshot", file, "--capture", path("out")}),
                  "--capture requires --technology (kelvoctl --help tells what there is)");
}

}  // namespace
}  // namespace kelvo
