#include <fmt/format.h>

#include "packaging/manual/Completion.h"

namespace kelvo::manual {
namespace {

std::string with(const std::string& text, const char* special) {
    std::string escaped;
    for (const char c : text) {
        if (std::string_view(special).find(c) != std::string_view::npos) escaped += '\\';
        escaped += c;
    }
    return escaped;
}

// Within single quotes.
std::string quoted(const std::string& text) {
    std::string shell = "'";
    for (const char c : text) shell += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return shell + "'";
}

std::string suffixGlob(const Choice& choice) {
    if (choice.suffixes.empty()) return "_files";
    if (choice.suffixes.size() == 1)
        return fmt::format("_files -g \"*.{}\"", choice.suffixes.front());  // (…) qualifies
    return fmt::format("_files -g \"*.({})\"", fmt::join(choice.suffixes, "|"));
}

std::string words(const Choice& choice) {
    std::string list;
    for (const std::string& word : choice.words)
        list += (list.empty() ? "" : " ") + with(word, "\\ ()\"'$`:;&|<>*?[]~#");
    return list;
}

// The action of a specification: what may stand there.
std::string action(const Choice& choice) {
    if (choice.listed) return fmt::format("_values -s , fault {}", words(choice));
    if (choice.words.empty()) return choice.files ? suffixGlob(choice) : " ";
    if (!choice.files) return fmt::format("({})", words(choice));
    return fmt::format("{{ compadd -S \"\" -- {}; {} }}", words(choice), suffixGlob(choice));
}

std::string message(const Argument& argument) { return with(argument.type, ":\\"); }

std::string specifications(const Description& command, const KnownValues& known) {
    std::string specs;
    for (const Argument& option : command.options) {
        std::vector<std::string> others = option.excludes;
        if (!option.repeats) others.insert(others.end(), option.names.begin(), option.names.end());
        for (const std::string& name : option.names) {
            std::string spec = others.empty() ? "" : fmt::format("({})", fmt::join(others, " "));
            spec += name + (option.type.empty() || name.size() == 2 ? "" : "=");
            spec += "[" + with(option.text, "[]\\:") + "]";
            if (!option.type.empty())
                spec += fmt::format(":{}{}:{}", option.valueIsOptional ? ":" : "", message(option),
                                    action(choiceOf(option, known)));
            specs += " \\\n            " + quoted(spec);
        }
    }
    for (const Argument& argument : command.positionals)
        specs += " \\\n            " + quoted(fmt::format("{}:{}:{}", argument.repeats ? "*" : "1", message(argument),
                                                          action(choiceOf(argument, known))));
    return specs;
}

}  // namespace

std::string zshCompletion(const Description& program, const KnownValues& known) {
    std::string text =
        fmt::format("#compdef {0}\n# zsh completion for {0}, made of its own command line\n\n", program.name);
    if (program.commands.empty()) return text + fmt::format("_arguments -s -S{}\n", specifications(program, known));
    std::string commands;
    std::string cases;
    for (const Description& command : program.commands) {
        const std::string name = command.name.substr(command.name.find(' ') + 1);
        commands += "        " + quoted(with(name, ":") + ":" + command.text) + "\n";
        cases += fmt::format("        {})\n            _arguments -s -S{} && ret=0\n            ;;\n", name,
                             specifications(command, known));
    }
    text += fmt::format(
        "_{0}() {{\n"
        "    local curcontext=\"$curcontext\" state line ret=1\n"
        "    local -a commands\n"
        "    commands=(\n{1}    )\n"
        "    _arguments -C{2} \\\n"
        "            '(-)1:command:->command' '(-)*::argument:->argument' && ret=0\n"
        "    case $state in\n"
        "    command) _describe -t commands command commands && ret=0 ;;\n"
        "    argument)\n"
        "        case $words[1] in\n{3}        esac\n"
        "        ;;\n"
        "    esac\n"
        "    return ret\n"
        "}}\n\n_{0} \"$@\"\n",
        program.name, commands, specifications(program, known), cases);
    return text;
}

}  // namespace kelvo::manual
