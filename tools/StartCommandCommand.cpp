#include "tools/StartCommandCommand.h"

#include <fmt/format.h>

#include <memory>

#include "LogGenerator/Factory.h"
#include "platform/encodings/PropertyList.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"

namespace kelvo {

namespace {

void printStartCommand(Technology technology) {
    const auto generator = generatorFromTechnology(namesOf(technology).identifier);
    if (!generator) throw CommandFailure(fmt::format("no generator decodes {}", namesOf(technology).name));
    writeToStandardOutput(textOf(orFail(writeXmlPropertyList(generator->getStartCommand()))));
}

}  // namespace

void addStartCommandCommand(CLI::App& app) {
    CLI::App& command =
        addCommand(app, "start-command",
                   "Prints the start command of a technology, the log codes it asks for, as an XML property list");
    const auto technology = std::make_shared<std::optional<Technology>>();
    addTechnologyOption(command, *technology, "The technology")->required();
    command.footer("Example:\n  kelvoctl start-command --technology lte\n");
    command.callback([technology] { printStartCommand(**technology); });
}

}  // namespace kelvo
