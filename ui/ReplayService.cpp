#include "ui/ReplayService.h"

#include <fmt/format.h>
#include <signal.h>
#include <sys/prctl.h>

#include <QProcessEnvironment>

#include "platform/telephony/TelephonyProtocol.h"

namespace kelvo {
namespace {

constexpr int kPatience = 10'000;  // milliseconds
constexpr int kLook = 10;          // milliseconds between two looks whether it listens

// What the service says names the service; the reader has opened a file.
std::string withoutItsName(std::string line) {
    constexpr std::string_view kName = "kelvo-telephonyd: ";
    while (line.ends_with('\n')) line.pop_back();
    return line.starts_with(kName) ? line.substr(kName.size()) : line;
}

}  // namespace

Result<std::unique_ptr<ReplayService>> ReplayService::start(const std::filesystem::path& program,
                                                            const std::string& capture) {
    std::unique_ptr<ReplayService> made(new ReplayService);
    if (!made->_runtime.isValid()) return Failure{made->_runtime.errorString().toStdString()};
    QProcess& service = made->_service;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("XDG_RUNTIME_DIR"), made->_runtime.path());
    service.setProcessEnvironment(environment);
    service.setChildProcessModifier([] { ::prctl(PR_SET_PDEATHSIG, SIGTERM); });
    service.setStandardOutputFile(QProcess::nullDevice());
    service.start(QString::fromStdString(program.native()),
                  {QStringLiteral("--replay"), QString::fromStdString(capture), QStringLiteral("--loop")});
    if (!service.waitForStarted(kPatience))
        return Failure{fmt::format("{}: it takes {} to replay a capture: {}", capture, program.filename().native(),
                                   service.errorString().toStdString())};
    const std::filesystem::path port = made->portDirectory() / (std::string(kPLTelephonyServicePort) + ".port");
    for (int waited = 0; waited < kPatience; waited += kLook) {
        std::error_code error;
        if (std::filesystem::exists(port, error)) return made;
        if (service.waitForFinished(kLook))
            return Failure{withoutItsName(service.readAllStandardError().toStdString())};
    }
    return Failure{capture + ": the service that replays it does not answer"};
}

ReplayService::~ReplayService() {
    _service.terminate();
    if (!_service.waitForFinished(kPatience)) _service.kill();
}

std::filesystem::path ReplayService::portDirectory() const {
    return std::filesystem::path(_runtime.path().toStdString()) / "kelvo/ports";
}

}  // namespace kelvo
