#include "tools/Kelvoctl.h"

#include <CLI/CLI.hpp>

#include "platform/version/Version.h"
#include "tools/DecodeCommand.h"
#include "tools/DoctorCommand.h"
#include "tools/EventsCommand.h"
#include "tools/ExplainCommand.h"
#include "tools/ExportCommand.h"
#include "tools/ImportCommand.h"
#include "tools/ShareCommand.h"
#include "tools/SnapshotCommand.h"
#include "tools/StartCommandCommand.h"
#include "tools/WatchCommand.h"
#include "tools/report/ReportCommand.h"

namespace kelvo {

std::unique_ptr<CLI::App> makeKelvoctl() {
    auto app = std::make_unique<CLI::App>(
        "Kelvo in the terminal: the screens of a phone's radio, of captures and of snapshots.", "kelvoctl");
    app->require_subcommand(1);
    app->set_version_flag("--version", versionLine("kelvoctl"));
    app->footer("\"kelvoctl COMMAND --help\" tells more about a command.");
    addDecodeCommand(*app);
    addWatchCommand(*app);
    addEventsCommand(*app);
    addReportCommand(*app);
    addSnapshotCommand(*app);
    addImportCommand(*app);
    addExportCommand(*app);
    addShareCommand(*app);
    addStartCommandCommand(*app);
    addDoctorCommand(*app);
    addExplainCommand(*app);
    return app;
}

}  // namespace kelvo
