#include <fmt/format.h>

#include "packaging/manual/Completion.h"

namespace kelvo::manual {
namespace {

std::string quoted(const std::string& text) {
    std::string shell = "'";
    for (const char c : text) shell += c == '\'' || c == '\\' ? std::string("\\") + c : std::string(1, c);
    return shell + "'";
}

// The arguments that offer what may stand there, a word a line.
std::string offered(const Choice& choice) {
    std::string commands;
    if (!choice.words.empty()) {
        commands = "printf \"%s\\n\"";
        for (const std::string& word : choice.words) commands += " " + quoted(word);
        if (choice.listed) commands = "__fish_append , (" + commands + ")";
    }
    const auto add = [&](const std::string& command) { commands += (commands.empty() ? "" : "; ") + command; };
    if (choice.files && choice.suffixes.empty()) add("__fish_complete_path (commandline -ct)");
    if (choice.files)  // one at a time: of two words, the first is taken for the beginning of the name
        for (const std::string& suffix : choice.suffixes) add("__fish_complete_suffix ." + suffix);
    if (commands.empty()) return " -x";
    return fmt::format(" -k -x -a {}", quoted("(" + commands + ")"));
}

std::string lines(const Description& command, const std::string& start, const KnownValues& known) {
    std::string text;
    for (const Argument& option : command.options) {
        text += start;
        for (const std::string& name : option.names)
            text += name.starts_with("--") ? " -l " + name.substr(2) : " -s " + name.substr(1);
        text += " -d " + quoted(option.text);
        if (!option.type.empty() && !option.valueIsOptional) text += offered(choiceOf(option, known));
        text += "\n";
    }
    for (const Argument& argument : command.positionals) text += start + offered(choiceOf(argument, known)) + "\n";
    return text;
}

}  // namespace

std::string fishCompletion(const Description& program, const KnownValues& known) {
    std::string text =
        fmt::format("# fish completion for {0}, made of its own command line\ncomplete -c {0} -f\n", program.name);
    if (program.commands.empty()) return text + lines(program, "complete -c " + program.name, known);
    text += lines(program, fmt::format("complete -c {} -n __fish_use_subcommand", program.name), known);
    for (const Description& command : program.commands) {
        const std::string name = command.name.substr(command.name.find(' ') + 1);
        text += fmt::format("complete -c {} -n __fish_use_subcommand -a {} -d {}\n", program.name, name,
                            quoted(command.text));
        text += lines(command, fmt::format("complete -c {} -n '__fish_seen_subcommand_from {}'", program.name, name),
                      known);
    }
    return text;
}

}  // namespace kelvo::manual
