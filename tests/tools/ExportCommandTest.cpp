#include <sys/ioctl.h>
#include <sys/wait.h>

#include <csignal>

#include "platform/encodings/PropertyList.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::KelvoctlTest;
using test::servingCell;

const std::string kHeading = "time,technology,path,text,number,unit,code,record\r\n";

/// 0xB179: EARFCN 5780, RSRP -140 + raw / 4 dBm, RSRQ -20 + 80 / 8 dB.
Bytes connected(std::uint16_t physicalCellId, std::uint16_t rsrp) {
    return test::Record(0xB179, 29).u16(17, 5780).u16(19, physicalCellId).u16(23, rsrp).u16(25, 80).bytes();
}

struct ExportCommand : KelvoctlTest {
    /// The rows of RSRP alone, after the heading.
    std::string levels(std::vector<std::string> arguments, const std::string& input = "/dev/null") {
        for (const char* argument : {"*RSRP", "--values", "export"}) arguments.insert(arguments.begin(), argument);
        const Finished done = kelvoctl(std::move(arguments), input);
        EXPECT_EQ(done.status, 0) << done.errors;
        EXPECT_EQ(done.errors, "");
        EXPECT_EQ(done.output.rfind(kHeading, 0), 0U) << done.output;
        return done.output.substr(std::min(kHeading.size(), done.output.size()));
    }
    static std::string level(const char* time, const char* text, const char* number, int record) {
        return std::string("1970-01-01T00:00:") + time +
               ",LTE,\"/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP\",\"" + text + "\"," +
               number + ",dBm,0xb179," + std::to_string(record) + "\r\n";
    }
    /// Three levels, a second apart: -109.5, -109.5 and -115 dBm.
    std::string drive() {
        return capture(Technology::LTE, {connected(185, 122), connected(185, 122), connected(84, 100)});
    }
    const std::string kFirst = level("00.000000Z", "-109.50 dBm", "-109.5", 1);
    const std::string kSecond = level("01.000000Z", "-109.50 dBm", "-109.5", 2);
    const std::string kThird = level("02.000000Z", "-115.00 dBm", "-115", 3);
};

TEST_F(ExportCommand, WritesEveryReadingAsARow) {
    const Finished done = kelvoctl({"export", capture(Technology::LTE, {connected(185, 122), servingCell(84)})});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "");
    const std::string connectedMode = "LTE,\"/Connected mode LTE Intra-frequency Measurement/";
    const std::string first = "1970-01-01T00:00:00.000000Z," + connectedMode;
    const std::string second = "1970-01-01T00:00:01.000000Z,LTE,\"/Serving Cell Info/";
    EXPECT_EQ(
        done.output,
        kHeading + first + "E-ARFCN\",\"5780\",5780,,0xb179,1\r\n" +  //
            first + "Serving Physical Cell ID\",\"185\",185,,0xb179,1\r\n" + first +
            "Serving Filtered RSRP\",\"-109.50 dBm\",-109.5,dBm,0xb179,1\r\n" + first +
            "Serving Filtered RSRQ\",\"-10.00 dB\",-10,dB,0xb179,1\r\n" + first +
            "Subframe Number\",\"0\",0,,0xb179,1\r\n" + second + "Physical Cell ID\",\"84\",84,,0xb0c2,2\r\n" + second +
            "Cell Identity\",\"77\",77,,0xb0c2,2\r\n" + second + "Tracking Area Code\",\"4566\",4566,,0xb0c2,2\r\n" +
            second + "Freq Band Indicator\",\"17\",17,,0xb0c2,2\r\n" + second +
            "Download Frequency\",\"5780\",5780,,0xb0c2,2\r\n" + second +
            "Upload Frequency\",\"23780\",23780,,0xb0c2,2\r\n" + second +
            "Download Bandwidth\",\"10 MHz\",,,0xb0c2,2\r\n" + second + "Upload Bandwidth\",\"5 MHz\",,,0xb0c2,2\r\n");
}

TEST_F(ExportCommand, AReadingNeedsNoChange) {
    EXPECT_EQ(levels({drive()}), kFirst + kSecond + kThird);
    EXPECT_EQ(levels({"--changes", drive()}), kFirst + kThird);
    EXPECT_EQ(levels({"--every", "2", drive()}), kSecond + kThird);
    EXPECT_EQ(levels({"--every", "0.5", drive()}), kFirst + kSecond + kThird);
}

TEST_F(ExportCommand, TakesTheTimesAskedFor) {
    EXPECT_EQ(levels({"--from", "1970-01-01T00:00:01Z", drive()}), kSecond + kThird);
    EXPECT_EQ(levels({"--to", "1970-01-01T00:00:01Z", drive()}), kFirst);
    EXPECT_EQ(levels({"--from", "1970-01-01T00:00:00.5Z", "--to", "1970-01-01T00:00:02Z", drive()}), kSecond);
}

TEST_F(ExportCommand, ReadsStandardInputAndSnapshots) {
    const std::string file = drive();
    EXPECT_EQ(levels({"-"}, file), kFirst + kSecond + kThird);
    kelvoctl({"decode", file, "--save", path("saved.kelvo")});
    const std::string rows = levels({path("saved.kelvo")});
    EXPECT_EQ(std::ranges::count(rows, '\n'), 3) << rows;
    EXPECT_NE(rows.find("\"-115.00 dBm\",-115,dBm,0xb179,3"), std::string::npos) << rows;
}

TEST_F(ExportCommand, TellsTheFileOfEachReadingWhereThereAreSeveral) {
    const std::string one = drive();
    std::filesystem::copy(one, path("two.pcap"));
    const Finished done =
        kelvoctl({"export", "--values", "*RSRP", "--to", "1970-01-01T00:00:01Z", one, path("two.pcap")});
    const std::string row = kFirst.substr(0, kFirst.size() - 2);
    EXPECT_EQ(done.output, "time,technology,path,text,number,unit,code,record,file\r\n" +  //
                               row + ",\"" + one + "\"\r\n" + row + ",\"" + path("two.pcap") + "\"\r\n");
}

TEST_F(ExportCommand, AWideTableHasALineAMomentAndAColumnAPath) {
    const std::string file = capture(Technology::LTE, {connected(185, 122), servingCell(84), connected(84, 100)});
    const std::vector<std::string> wide = {
        "export", "--wide", "--values", "*RSRP", "--values", "*/Physical Cell ID", "--values", "*Download Bandwidth"};
    auto arguments = wide;
    arguments.push_back(file);
    const std::string table =
        "time,technology,\"/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP\","
        "\"/Serving Cell Info/Physical Cell ID\",\"/Serving Cell Info/Download Bandwidth\"\r\n"
        "1970-01-01T00:00:00.000000Z,LTE,-109.5,,\r\n"
        "1970-01-01T00:00:01.000000Z,LTE,,84,\"10 MHz\"\r\n"
        "1970-01-01T00:00:02.000000Z,LTE,-115,,\r\n";
    EXPECT_EQ(kelvoctl(arguments).output, table);
    EXPECT_EQ(
        kelvoctl({"export", "--wide", "--every", "10", "--values", "*RSRP", "--values", "*/Physical Cell ID", file})
            .output,
        "time,technology,\"/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP\","
        "\"/Serving Cell Info/Physical Cell ID\"\r\n"
        "1970-01-01T00:00:02.000000Z,LTE,-115,84\r\n");
    arguments.insert(arguments.begin() + 1, {"--format", "jsonl"});
    EXPECT_EQ(kelvoctl(arguments).output,
              R"({"time":"1970-01-01T00:00:00.000000Z","technology":"LTE",)"
              R"("/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP":-109.5})"
              "\n"
              R"({"time":"1970-01-01T00:00:01.000000Z","technology":"LTE","/Serving Cell Info/Physical Cell ID":84,)"
              R"("/Serving Cell Info/Download Bandwidth":"10 MHz"})"
              "\n"
              R"({"time":"1970-01-01T00:00:02.000000Z","technology":"LTE",)"
              R"("/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP":-115})"
              "\n");
}

TEST_F(ExportCommand, AWideTableOfStandardInputNeedsItsColumns) {
    const std::string file = drive();
    expectFailure(kelvoctl({"export", "--wide", "--values", "signal", "-"}, file),
                  "--wide reads its input twice, and standard input can be read once; --values with whole paths names "
                  "the columns beforehand");
    expectFailure(kelvoctl({"export", "--wide", "--live"}),
                  "--wide of --live needs the columns' names beforehand: --values with whole paths");
    EXPECT_EQ(kelvoctl({"export", "--wide", "--values", "/Connected mode LTE Intra-frequency Measurement/E-ARFCN", "-"},
                       capture(Technology::LTE, {connected(185, 122)}))
                  .output,
              "time,technology,\"/Connected mode LTE Intra-frequency Measurement/E-ARFCN\"\r\n"
              "1970-01-01T00:00:00.000000Z,LTE,5780\r\n");
}

TEST_F(ExportCommand, OutputsAppearWholeAndReplaceNothingUnlessForced) {
    const std::string file = drive();
    for (const char* format : {"csv", "jsonl", "influx", "sqlite"}) {
        const std::string out = path(std::string("out.") + format);
        const std::vector<std::string> arguments = {"export", "--format", format, file, "-o", out};
        const Finished done = kelvoctl(arguments);
        EXPECT_EQ(done.status, 0) << done.errors;
        EXPECT_EQ(done.output, "");
        const std::string before = contentsOf(out);
        EXPECT_FALSE(before.empty());
        expectFailure(kelvoctl(arguments), out + " exists already; --force replaces it");
        EXPECT_EQ(contentsOf(out), before);
        auto forced = arguments;
        forced.push_back("--force");
        EXPECT_EQ(kelvoctl(forced).status, 0);
        expectFailure(kelvoctl({"export", "--format", format, file, "-o", file, "--force"}),
                      file + " is the file being read");
        expectFailure(kelvoctl({"export", "--format", format, "-", "-o", file, "--force"}, file),
                      file + " is the file being read");
    }
    std::size_t files = 0;
    for (const auto& entry : std::filesystem::directory_iterator(directory.path())) files += entry.exists() ? 1 : 0;
    EXPECT_EQ(files, 5U);  // the capture and four outputs: no journal, nothing half made
}

TEST_F(ExportCommand, OfWhatBreaksOffTheGoodPartIsWritten) {
    const std::string whole = contentsOf(drive());
    std::ofstream(path("cut.pcap"), std::ios::binary) << whole.substr(0, whole.size() - 2);
    const std::string reason = "kelvoctl: " + path("cut.pcap") +
                               " cannot be read at packet 3: truncated dump file; tried to read 29 captured bytes, "
                               "only got 27\n";
    const Finished done = kelvoctl({"export", "--values", "*RSRP", path("cut.pcap"), "-o", path("out.csv")});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.errors, reason);
    EXPECT_EQ(contentsOf(path("out.csv")), kHeading + kFirst + kSecond);
    const Finished database = kelvoctl({"export", "--format", "sqlite", path("cut.pcap"), "-o", path("out.db")});
    EXPECT_EQ(database.status, 1);
    EXPECT_EQ(database.errors, reason);
    EXPECT_EQ(contentsOf(path("out.db")).substr(0, 15), "SQLite format 3");

    std::ofstream(path("nothing.pcap"), std::ios::binary) << whole.substr(0, 30);
    expectFailure(kelvoctl({"export", path("nothing.pcap"), "-o", path("none.csv")}),
                  path("nothing.pcap") +
                      " cannot be read at packet 1: truncated dump file; tried to read 16 header bytes, only got 6");
    EXPECT_FALSE(std::filesystem::exists(path("none.csv")));
}

TEST_F(ExportCommand, ARecordThatEndsTheProgramElsewhereEndsItsFileHere) {
    const auto tree =
        writeXmlPropertyList(Dictionary::make({{"Serving", Dictionary::make({{"MCC", "001"}, {"A", "b"}})}}));
    const Finished done = kelvoctl({"export", capture(Technology::IFX, {*tree, Bytes{1, 2, 3}})});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.output, kHeading +
                               "1970-01-01T00:00:00.000000Z,IFX,\"/Serving/MCC\",\"001\",,,,1\r\n"
                               "1970-01-01T00:00:00.000000Z,IFX,\"/Serving/A\",\"b\",,,,1\r\n");
    EXPECT_EQ(done.errors.rfind("kelvoctl: packet 2 of " + path("in.pcap") + " ends the program: ", 0), 0U)
        << done.errors;
}

TEST_F(ExportCommand, HostileTextsComeWhole) {
    const std::string text = "a,\"b\"\r\n=1+1\tü";
    const auto tree = writeXmlPropertyList(Dictionary::make({{"x", "y"}, {"q\"uo,te\n", text}}));
    const std::string file = capture(Technology::IFX, {*tree});
    EXPECT_EQ(kelvoctl({"export", file, "--values", "/q*"}).output,
              kHeading + "1970-01-01T00:00:00.000000Z,IFX,\"/q\"\"uo,te\n\",\"a,\"\"b\"\"\r\n=1+1\tü\",,,,1\r\n");
    const auto line = nlohmann::json::parse(kelvoctl({"export", "--format", "jsonl", file, "--values", "/q*"}).output);
    EXPECT_EQ(line["path"], "/q\"uo,te\n");
    EXPECT_EQ(line["text"], text);
    EXPECT_EQ(kelvoctl({"export", "--format", "influx", file, "--values", "/q*"}).output,
              "reading,path=/q\"uo\\,te\xEF\xBF\xBD,technology=IFX "
              "text=\"a,\\\"b\\\"\xEF\xBF\xBD\xEF\xBF\xBD=1+1\xEF\xBF\xBDü\",record=1i 0\n");
}

TEST_F(ExportCommand, RefusesWhatMakesNoSense) {
    const std::string file = drive();
    expectFailure(kelvoctl({"export"}), "export takes files, or --live");
    expectFailure(kelvoctl({"export", "--format", "xml", file}),
                  "unknown format xml: there are csv, jsonl, sqlite and influx");
    expectFailure(kelvoctl({"export", "--format", "sqlite", file}),
                  "a database needs a place: --format sqlite -o OUT.db");
    expectFailure(kelvoctl({"export", "--format", "sqlite", file, "-o", "/dev/null"}),
                  "/dev/null is no file, and cannot be written piece by piece");
    expectFailure(kelvoctl({"export", "--format", "influx", "--wide", file}), "--wide is for csv and jsonl");
    for (const char* seconds : {"0", "-1", "two", "1s", "nan", "inf"}) {
        expectFailure(kelvoctl({"export", "--every", seconds, file}),
                      std::string("--every: ") + seconds +
                          " is not a number of seconds, 0.001 at least (kelvoctl --help tells what there is)");
    }
    EXPECT_EQ(kelvoctl({"export", "--every", "1", "--changes", file}).status, 1);
    EXPECT_EQ(kelvoctl({"export", "--live", file}).status, 1);
    expectFailure(kelvoctl({"export", path("missing")}),
                  path("missing") + " cannot be read: No such file or directory");
    const Finished unknown = kelvoctl({"export", "--values", "/Nowhere", file});
    EXPECT_EQ(unknown.status, 0);
    EXPECT_EQ(unknown.output, kHeading);
    EXPECT_EQ(unknown.errors, "kelvoctl: no reading is called /Nowhere\n");
}

/// A program whose input and output are pipes.
struct Piped {
    explicit Piped(std::vector<std::string> arguments, const std::string& errors) {
        int in[2];
        int out[2];
        if (::pipe2(in, O_CLOEXEC) != 0 || ::pipe2(out, O_CLOEXEC) != 0) throw std::runtime_error("no pipe");
        std::vector<char*> argv{const_cast<char*>(KELVOCTL)};
        for (std::string& argument : arguments) argv.push_back(argument.data());
        argv.push_back(nullptr);
        child = fork();
        if (child == 0) {
            dup2(in[0], STDIN_FILENO);
            dup2(out[1], STDOUT_FILENO);
            dup2(open(errors.c_str(), O_WRONLY | O_CREAT, 0600), STDERR_FILENO);
            execv(KELVOCTL, argv.data());
            _exit(127);
        }
        ::close(in[0]);
        ::close(out[1]);
        input = in[1];
        output = out[0];
    }
    ~Piped() {
        ::close(input);
        ::close(output);
    }
    void write(const std::string& bytes) {
        EXPECT_EQ(::write(input, bytes.data(), bytes.size()), ssize_t(bytes.size()));
    }
    /// Reads until `end` has come, or to the end.
    std::string readTo(const std::string& end) {
        std::string text;
        char byte = 0;
        while (!text.ends_with(end) && ::read(output, &byte, 1) == 1) text += byte;
        return text;
    }
    int wait() {
        int status = 0;
        waitpid(child, &status, 0);
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }
    pid_t child;
    int input;
    int output;
};

TEST_F(ExportCommand, RowsOfAPipeFlowAndCtrlCLeavesThemWhole) {
    const std::string file = contentsOf(drive());
    Piped program({"export", "--values", "*RSRP", "-"}, path("errors"));
    const std::size_t twoPackets = 24 + 2 * (16 + 29);
    program.write(file.substr(0, twoPackets + 5));                    // and the beginning of a third
    EXPECT_EQ(program.readTo(kSecond), kHeading + kFirst + kSecond);  // while the input goes on
    ::kill(program.child, SIGINT);
    EXPECT_EQ(program.readTo(kThird), "");
    EXPECT_EQ(program.wait(), 1);
    EXPECT_EQ(contentsOf(path("errors")),
              "kelvoctl: stopped behind record 2 of standard input; what comes before is written\n");
}

TEST_F(ExportCommand, CtrlCLeavesAWholeDatabaseOfWhatWasRead) {
    const std::string file = contentsOf(drive());
    Piped program({"export", "--format", "sqlite", "-", "-o", path("out.db")}, path("errors"));
    // More than the program reads at once: when it has fetched the end, it has taken up the beginning.
    std::string input = file;
    while (input.size() < 16384) input += file.substr(24);
    program.write(input);
    for (int left = 1; left != 0;) ASSERT_EQ(::ioctl(program.input, FIONREAD, &left), 0);
    ::kill(program.child, SIGINT);
    EXPECT_EQ(program.wait(), 1);
    EXPECT_EQ(contentsOf(path("out.db")).substr(0, 15), "SQLite format 3");
    EXPECT_FALSE(std::filesystem::exists(path("out.db-journal")));
}

}  // namespace
}  // namespace kelvo
