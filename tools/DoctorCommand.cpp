#include "tools/DoctorCommand.h"

#include <QCoreApplication>
#include <memory>

#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayJson.h"
#include "tools/StandardOutput.h"
#include "tools/doctor/Doctor.h"
#include "tools/doctor/SystemInputs.h"

namespace kelvo {

namespace {

struct Options {
    std::optional<std::string> port;
    bool probe = false;
    bool json = false;
    bool rule = false;
};

// Of the first port that may be a diagnostic one, or of the one that was named.
std::string ruleFor(const Findings& findings) {
    if (findings.ports.empty()) throw CommandFailure("there is no port to write a rule for: plug the modem in");
    const wire::CandidateNode& node = findings.ports.front().node;
    if (!node.usb) throw CommandFailure(node.path + " is not on USB: udev cannot tell it from others");
    return udevRule(node);
}

void examineSystem(const Options& options) {
    static char name[] = "kelvoctl";
    int count = 1;
    char* arguments[] = {name, nullptr};
    const QCoreApplication application(count, arguments);  // sockets and the bus need one
    const Findings findings = examine(systemInputs(), options.port, options.probe);
    if (options.rule) return writeToStandardOutput(ruleFor(findings));
    writeToStandardOutput(options.json ? printedJson(findingsJson(findings)) : findingsText(findings));
}

}  // namespace

void addDoctorCommand(CLI::App& app) {
    CLI::App& command = addCommand(
        app, "doctor", "Tells which port a modem is behind, what is in the way, and what to do next; changes nothing");
    const auto options = std::make_shared<Options>();
    command
        .add_option("--port", options->port,
                    "Looks at this port alone; without it, or with auto, at all that there are")
        ->type_name("auto|PATH|tcp:HOST:PORT|unix:PATH");
    CLI::Option* probe = command.add_flag(
        "--probe", options->probe,
        "Asks the modem as well for its version, its build and which records it has, and tells which screens it can\n"
        "fill; opening its port can drop the data connection of some modems");
    CLI::Option* json = command.add_flag("--json", options->json, "The findings as JSON");
    command
        .add_flag(
            "--udev-rule", options->rule,
            "Prints a udev rule instead, which gives the port to the group dialout and tells the modem manager to\n"
            "leave it alone")
        ->excludes(probe)
        ->excludes(json);
    command.footer(
        "Examples:\n"
        "  kelvoctl doctor\n"
        "  kelvoctl doctor --port /dev/ttyUSB0 --probe\n"
        "  kelvoctl doctor --port /dev/ttyUSB0 --udev-rule | sudo tee /etc/udev/rules.d/78-kelvo-modem.rules\n");
    command.callback([options] { examineSystem(*options); });
}

}  // namespace kelvo
