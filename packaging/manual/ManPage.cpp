#include "packaging/manual/ManPage.h"

#include <fmt/format.h>

#include <algorithm>
#include <cctype>
#include <utility>

#include "platform/version/Version.h"

namespace kelvo::manual {
namespace {

std::string escaped(const std::string& text) {
    std::string roff;
    for (const char c : text) {
        switch (c) {
            case '\\': roff += "\\e"; break;
            case '-': roff += "\\-"; break;
            case '\'': roff += "\\(aq"; break;
            case '"': roff += "\\(dq"; break;
            case '`': roff += "\\(ga"; break;
            case '^': roff += "\\(ha"; break;
            case '~': roff += "\\(ti"; break;
            default: roff += c;
        }
    }
    return roff.starts_with('.') ? "\\&" + roff : roff;
}

std::string joined(const std::vector<std::string>& parts, const char* between) {
    return fmt::format("{}", fmt::join(parts, between));
}

std::string bold(const std::string& text) { return "\\fB" + escaped(text) + "\\fP"; }
std::string slanted(const std::string& text) { return "\\fI" + escaped(text) + "\\fP"; }

// "\fB\-o\fP, \fB\-\-output\fP \fIOUT.pcap\fP"
std::string tag(const Argument& argument) {
    std::vector<std::string> names;
    for (const std::string& name : argument.names) names.push_back(bold(name));
    std::string text = joined(names, ", ");
    if (!argument.type.empty()) text += " " + slanted(argument.type);
    return text;
}

std::string sentence(const Argument& argument) {
    std::string text = argument.text;
    std::vector<std::string> facts;
    if (argument.isRequired) facts.emplace_back("required");
    if (!argument.initial.empty()) facts.push_back("by default " + argument.initial);
    if (!argument.needs.empty()) facts.push_back("needs " + joined(argument.needs, ", "));
    if (!argument.excludes.empty()) facts.push_back("not with " + joined(argument.excludes, ", "));
    return facts.empty() ? text : fmt::format("{} ({})", text, joined(facts, "; "));
}

std::string optionsSection(const std::vector<Argument>& options) {
    std::string text = ".SH OPTIONS\n";
    for (const Argument& option : options) text += fmt::format(".TP\n{}\n{}\n", tag(option), escaped(sentence(option)));
    return text;
}

std::string synopsis(const Description& description) {
    std::string text = fmt::format(".SH SYNOPSIS\n.B {}\n[\\fIOPTIONS\\fP]\n", escaped(description.name));
    if (!description.commands.empty()) text += "\\fICOMMAND\\fP [\\fIARGUMENTS\\fP]\n";
    for (const Argument& argument : description.positionals) {
        const std::string name = slanted(argument.names.front()) + (argument.repeats ? "..." : "");
        text += argument.isRequired ? name + "\n" : "[" + name + "]\n";
    }
    return text;
}

/// The help's last words: running text, lines that stand as they are (they begin with blanks), and at the end examples.
struct Footer {
    std::string text;
    std::string examples;

    explicit Footer(const std::string& footer) {
        std::string* into = &text;
        for (const std::string& line : split(footer, '\n')) {
            if (line == "Examples:" || line == "Example:") {
                keep(into, false);
                into = &examples;
            } else if (line.empty()) {
                keep(into, false);
                _between = true;
            } else {
                keep(into, line.starts_with("  "));
                *into += (std::exchange(_between, false) && !_kept && !into->empty() ? ".PP\n" : "") +
                         escaped(line.substr(_kept ? 2 : 0)) + "\n";
            }
        }
        keep(into, false);
    }

private:
    void keep(std::string* into, bool asItIs) {
        if (asItIs != std::exchange(_kept, asItIs)) *into += asItIs ? ".PP\n.RS 2\n.nf\n" : ".fi\n.RE\n";
    }
    bool _kept = false;
    bool _between = false;
};

std::string seeAlso(const Description& description) {
    std::vector<std::string> pages;
    for (const Description& command : description.commands) pages.push_back(pageName(command) + "(1)");
    for (const char* page : {"kelvo(1)", "kelvoctl(1)", "kelvo-telephonyd(1)", "kelvo-modem(1)", "kelvo-capture(5)",
                             "kelvo-snapshot(5)"}) {
        if (pageName(description) + "(1)" != page) pages.emplace_back(page);
    }
    std::string text = ".SH SEE ALSO\n";
    for (std::size_t at = 0; at < pages.size(); ++at) {
        const std::size_t bracket = pages[at].find('(');
        text += fmt::format(".BR {} {}{}\n", escaped(pages[at].substr(0, bracket)), pages[at].substr(bracket),
                            at + 1 < pages.size() ? " ," : "");
    }
    return text;
}

std::string lowerFirst(std::string text) {
    const bool isName = text.size() > 1 && std::isupper(static_cast<unsigned char>(text[1])) != 0;
    if (!text.empty() && !isName && !text.starts_with("Kelvo"))
        text[0] = static_cast<char>(std::tolower(static_cast<unsigned char>(text[0])));
    while (text.ends_with('.')) text.pop_back();
    return text;
}

}  // namespace

std::string pageName(const Description& description) {
    std::string name = description.name;
    std::replace(name.begin(), name.end(), ' ', '-');
    return name;
}

std::string manPage(const Description& description, const std::string& more) {
    std::string title = pageName(description);
    std::transform(title.begin(), title.end(), title.begin(), [](unsigned char c) { return std::toupper(c); });
    const Footer footer(description.footer);
    std::string page = fmt::format(".TH {} 1 \"\" \"Kelvo {}\" \"Kelvo\"\n.ad l\n.nh\n", escaped(title), version());
    page += fmt::format(".SH NAME\n{} \\- {}\n", escaped(pageName(description)), escaped(lowerFirst(description.text)));
    page += synopsis(description);
    const std::string end = description.text.ends_with('.') ? "" : ".";
    page += fmt::format(".SH DESCRIPTION\n{}{}\n", escaped(description.text), end);
    for (const Argument& argument : description.positionals)
        page += fmt::format(".TP\n{}\n{}\n", slanted(argument.names.front()), escaped(sentence(argument)));
    if (!footer.text.empty()) page += ".PP\n" + footer.text;
    if (!description.commands.empty()) {
        page += ".SH COMMANDS\n";
        for (const Description& command : description.commands)
            page += fmt::format(".TP\n.BR {} (1)\n{}\n", escaped(pageName(command)), escaped(command.text));
    }
    page += optionsSection(description.options) + more;
    if (!footer.examples.empty()) page += ".SH EXAMPLES\n" + footer.examples;
    return page + seeAlso(description);
}

}  // namespace kelvo::manual
