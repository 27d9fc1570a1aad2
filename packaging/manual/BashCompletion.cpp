#include <fmt/format.h>

#include "packaging/manual/Completion.h"

namespace kelvo::manual {
namespace {

std::string quoted(const std::string& text) {
    std::string shell = "'";
    for (const char c : text) shell += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return shell + "'";
}

// Words reach bash one a line; what compgen would expand in them is taken literally.
std::string oneALine(const std::vector<std::string>& words) {
    std::string lines;
    for (const std::string& word : words) {
        if (!lines.empty()) lines += "\n";
        for (const char c : word)
            lines += std::string("\\\"'$`").find(c) != std::string::npos ? std::string("\\") + c : std::string(1, c);
    }
    return quoted(lines);
}

std::string completing(const Choice& choice, const std::string& function) {
    std::string steps;
    if (choice.files) {
        std::string suffixes = fmt::format("{}", fmt::join(choice.suffixes, "|"));
        steps += suffixes.empty() ? "_filedir; " : fmt::format("_filedir '@({})'; ", suffixes);
    }
    if (!choice.words.empty())
        steps += fmt::format("{}_{} {}; ", function, choice.listed ? "list" : "words", oneALine(choice.words));
    return steps;
}

void addCommand(std::string& values, std::string& options, std::string& arguments, const Description& command,
                const std::string& name, const KnownValues& known, const std::string& function) {
    std::vector<std::string> names;
    for (const Argument& option : command.options) {
        names.insert(names.end(), option.names.begin(), option.names.end());
        if (option.type.empty() || option.valueIsOptional) continue;
        std::string patterns;
        for (const std::string& one : option.names)
            patterns += (patterns.empty() ? "" : "|") + quoted(name + " " + one);
        values += fmt::format("        {}) {}return ;;\n", patterns, completing(choiceOf(option, known), function));
    }
    options += fmt::format("            {}) {}_words {} ;;\n", quoted(name), function, oneALine(names));
    for (const Argument& argument : command.positionals)
        arguments += fmt::format("        {}) {};;\n", quoted(name), completing(choiceOf(argument, known), function));
}

}  // namespace

std::string bashCompletion(const Description& program, const KnownValues& known) {
    const std::string function = "_" + program.name;
    std::string values;
    std::string options;
    std::string arguments;
    std::vector<std::string> commands;
    addCommand(values, options, arguments, program, "", known, function);
    for (const Description& command : program.commands) {
        const std::string name = command.name.substr(command.name.find(' ') + 1);
        commands.push_back(name);
        addCommand(values, options, arguments, command, name, known, function);
    }
    std::string text = fmt::format("# bash completion for {0}, made of its own command line\n", program.name);
    text += fmt::format(
        "{0}_words() {{\n"
        "    local IFS=$'\\n'\n"
        "    COMPREPLY+=($(compgen -W \"$1\" -- \"$cur\"))\n"
        "    compopt -o filenames\n"
        "    [[ ${{#COMPREPLY[@]}} -eq 1 && ${{COMPREPLY[0]}} == *: ]] && compopt -o nospace\n"
        "    __ltrim_colon_completions \"$cur\"\n"
        "}}\n"
        "{0}_list() {{\n"
        "    local before=\n"
        "    [[ $cur == *,* ]] && before=\"${{cur%,*}},\"\n"
        "    local IFS=$'\\n'\n"
        "    COMPREPLY+=($(compgen -P \"$before\" -W \"$1\" -- \"${{cur##*,}}\"))\n"
        "    compopt -o nospace\n"
        "}}\n"
        "{0}() {{\n"
        "    local cur prev words cword split\n"
        "    _init_completion -s -n : || return\n",
        function);
    text += "    local command=\n";
    if (!commands.empty()) {
        text += fmt::format(
            "    local i\n"
            "    for ((i = 1; i < cword; i++)); do\n"
            "        case ${{words[i]}} in {}) command=${{words[i]}}; break ;; esac\n"
            "    done\n",
            fmt::join(commands, "|"));
    }
    text += "    case \"$command $prev\" in\n" + values + "    esac\n    $split && return\n";
    text += "    if [[ $cur == -* ]]; then\n        case \"$command\" in\n" + options +
            "        esac\n        return\n    fi\n";
    if (!commands.empty()) arguments += fmt::format("        '') {}_words {} ;;\n", function, oneALine(commands));
    if (!arguments.empty()) text += "    case \"$command\" in\n" + arguments + "    esac\n";
    return text + fmt::format("}} && complete -F {} {}\n", function, program.name);
}

}  // namespace kelvo::manual
