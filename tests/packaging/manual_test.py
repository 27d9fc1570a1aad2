#!/usr/bin/python3
"""Manual pages and completions, made of the programs' command lines, in the programs that read them: man, bash, zsh, fish.
Usage: manual_test.py PROGRAMS BUILD   (BUILD has manual/ and manual5/)"""
import os
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

PROGRAMS, BUILD = (Path(argument).resolve() for argument in sys.argv[1:3])
MANUAL = BUILD / "manual"
PAGES = sorted([*MANUAL.glob("man/*.1"), *(BUILD / "manual5").glob("*.5")])
PROGRAM_NAMES = ("kelvo", "kelvo-telephonyd", "kelvo-modem", "kelvoctl")
BASH_COMPLETION = Path("/usr/share/bash-completion/bash_completion")


def commands():
    """The commands of kelvoctl, as its help lists them."""
    text = subprocess.run([PROGRAMS / "kelvoctl", "--help"], check=True, capture_output=True, text=True).stdout
    return re.findall(r"^  ([a-z][a-z-]*) +\S", text[text.index("Subcommands:"):], re.MULTILINE)


def lacks(test, what):
    """What a machine may lack; a line tells that nothing was tested."""
    print(f"left out: completion in {what}, which is not installed", flush=True)
    test.skipTest(f"no {what}")


class Pages(unittest.TestCase):
    def test_there_is_one_for_every_program_and_every_command(self):
        names = [page.name for page in PAGES]
        self.assertIn("decode", commands())
        self.assertEqual(sorted(names), sorted([*(f"{name}.1" for name in PROGRAM_NAMES), "kelvo-capture.5", "kelvo-snapshot.5",
                                                *(f"kelvoctl-{command}.1" for command in commands())]))

    @unittest.skipUnless(shutil.which("man"), "no man")
    def test_are_shown_without_a_warning(self):
        for page in PAGES:
            shown = subprocess.run(["man", "--warnings", "-E", "UTF-8", "-l", "-Tutf8", "-Z", page], capture_output=True,
                                   text=True, env={**os.environ, "LC_ALL": "C.UTF-8", "MANROFFSEQ": "", "MANWIDTH": "80"})
            self.assertEqual((page.name, shown.returncode, shown.stderr), (page.name, 0, ""))

    @unittest.skipUnless(shutil.which("lexgrog"), "no lexgrog")
    def test_are_found_by_what_they_are_about(self):
        for page in PAGES:
            found = subprocess.run(["lexgrog", page], capture_output=True, text=True)
            self.assertRegex(found.stdout, rf'^{page}: "{page.stem} - [a-zA-Z].*[a-z)]"\n$')

    def test_say_what_help_says(self):
        for name, arguments in [(name, [name]) for name in PROGRAM_NAMES] + [
                (f"kelvoctl-{command}", ["kelvoctl", command]) for command in commands()]:
            helped = subprocess.run([PROGRAMS / arguments[0], *arguments[1:], "--help"], check=True, capture_output=True,
                                    text=True).stdout
            options = set(re.findall(r"^ +(?:-\w,)?(--[a-z-]+)", helped, re.MULTILINE))
            self.assertIn("--help", options)
            text = (MANUAL / "man" / f"{name}.1").read_text().replace("\\-", "-")
            self.assertEqual(set(re.findall(r"^\.TP\n(?:\\fB-\w\\fP, )?\\fB(--[a-z-]+)\\fP", text, re.MULTILINE)), options)

    def test_show_an_option_with_its_value_its_words_and_what_it_goes_with(self):
        text = (MANUAL / "man" / "kelvoctl-import.1").read_text()
        self.assertIn(".TP\n\\fB\\-o\\fP, \\fB\\-\\-output\\fP \\fIOUT.pcap\\fP\n", text)
        self.assertIn("(not with \\-\\-list)", text)
        self.assertIn(".SH SYNOPSIS\n.B kelvoctl import\n[\\fIOPTIONS\\fP]\n\\fIFILE\\fP...\n", text)
        self.assertIn(".SH EXAMPLES\n", text)


class Completion(unittest.TestCase):
    """What is offered behind a beginning, in a directory with one file of each kind."""

    def setUp(self):
        directory = tempfile.TemporaryDirectory()
        self.addCleanup(directory.cleanup)
        self.directory = Path(directory.name)
        for name in ("drive.pcap", "saved.kelvo", "road.frames", "notes.txt"):
            (self.directory / name).touch()
        (self.directory / "more").mkdir()

    def offered(self, line):
        raise NotImplementedError

    def check(self):
        self.assertEqual(self.offered("kelvoctl "), set(commands()))
        self.assertEqual(self.offered("kelvoctl start"), {"start-command"})
        self.assertEqual(self.offered("kelvoctl decode --technology "), {"ifx", "gsm", "cdma", "lte", "utran"})
        self.assertEqual(self.offered("kelvoctl decode --technology g"), {"gsm"})
        self.assertEqual(self.offered("kelvoctl decode --prov"), {"--provenance"})
        self.assertEqual(self.offered("kelvoctl decode dr"), {"drive.pcap"})
        self.assertEqual(self.offered("kelvoctl snapshot s"), {"saved.kelvo"})
        self.assertEqual(self.offered("kelvoctl import --output d"), {"drive.pcap"})
        self.assertEqual(self.offered("kelvo-telephonyd --replay d"), {"drive.pcap"})
        self.assertEqual(self.offered("kelvo-telephonyd --generation 201"), {"2010", "2014", "2018"})
        self.assertEqual(self.offered("kelvo-modem --faults noi"), {"noise"})
        self.assertEqual(self.offered("kelvo-modem --faults noise,fl"), {self.before_comma + word for word in ("flipped-bits", "flood")})
        self.assertEqual(self.offered("kelvoctl explain Srx"), {"Srxlev"})
        self.assertEqual(self.offered("kelvo --vers"), {"--version"})
        self.assertEqual(self.offered("kelvoctl export --format "), {"csv", "jsonl", "sqlite", "influx"})
        self.assertEqual(self.offered("kelvoctl export --wi"), {"--wide"})
        self.assertEqual(self.offered("kelvoctl doctor --ud"), {"--udev-rule"})
        self.assertEqual(self.offered("kelvoctl start-command --technology u"), {"utran"})
        self.assertEqual(self.offered("kelvoctl share sa"), {"saved.kelvo"})
        for command in ("export", "report", "share", "events"):
            self.assertEqual((command, self.offered(f"kelvoctl {command} dr")), (command, {"drive.pcap"}))
        self.assertEqual(self.offered("kelvo dr"), {"drive.pcap"})
        self.assertEqual(self.offered("kelvo-modem --replay ro"), {"road.frames"})
        self.assertEqual(self.offered("kelvo sa"), {"saved.kelvo"})

    before_comma = "noise,"


class Bash(Completion):
    def offered(self, line):
        words = line.split(" ")
        cut = [part for word in words for part in re.split("(:)", word) if part or word == ""]
        script = f"""
            source {BASH_COMPLETION}; source {MANUAL}/bash/{words[0]}
            compopt() {{ :; }}
            COMP_WORDBREAKS=$' \\t\\n"\\'><=;|&(:'
            COMP_LINE=$1 COMP_POINT=${{#1}} COMP_WORDS=("${{@:2}}") COMP_CWORD=$(($# - 2)) COMP_TYPE=9
            _{words[0]} {words[0]} "${{COMP_WORDS[-1]}}" "${{COMP_WORDS[-2]}}"
            printf '%s\\n' "${{COMPREPLY[@]}}" """
        said = subprocess.run(["bash", "--norc", "-c", script, "bash", line, *cut], capture_output=True, text=True,
                              cwd=self.directory)
        self.assertEqual(said.stderr, "")
        return set(said.stdout.split("\n")) - {""}

    def test_offers_what_may_follow(self):
        if not shutil.which("bash") or not BASH_COMPLETION.exists():
            lacks(self, "bash")
        self.check()
        self.assertEqual(self.offered("kelvoctl decode "), {"drive.pcap", "more"})
        self.assertEqual(self.offered("kelvo-telephonyd --port a"), {"auto"})
        self.assertEqual(self.offered("kelvo-telephonyd --port tc"), {"tcp:"})
        self.assertIn("Cell ID", self.offered("kelvoctl explain Cell"))


class Zsh(Completion):
    """zsh completes only in a terminal: a zsh of its own in a pseudo-terminal, asked for the list of matches. It completes what stands
    behind a comma as a word of its own."""
    before_comma = ""

    def offered(self, line):
        script = f"""
            zmodload zsh/zpty
            zpty shell zsh -f -i
            zpty -w shell "PS1=; cd {self.directory}; fpath=({MANUAL}/zsh \\$fpath); autoload -Uz compinit; compinit -D -u"
            zpty -w shell 'zstyle ":completion:*" list-separator ""; zstyle ":completion:*" verbose no'
            zpty -w shell 'unset zle_bracketed_paste; setopt no_beep no_always_last_prompt; LISTMAX=1000'
            zpty -w shell 'show() {{ compadd() {{ local -a found; builtin compadd -O found "$@";'\
' [[ "$*" == *"-O "* || "$*" == *"-A "* || "$*" == *"-D "* ]] || print -rl -- "<"${{^found}}">" >>{self.directory}.found;'\
' builtin compadd "$@" }}; _main_complete }}; zle -C show complete-word show; bindkey "^I" show; print re""ady'
            zpty -r shell said '*ready*'
            zpty -n -w shell {shell_quoted(line)}$'\\t'
            zpty -n -w shell $'\\C-a\\C-kprint do""ne\\n'
            zpty -r shell said '*done*'
            zpty -d shell"""
        found = Path(f"{self.directory}.found")
        found.write_text("")
        self.addCleanup(lambda: found.unlink(missing_ok=True))
        subprocess.run(["zsh", "-f", "-c", script], capture_output=True, text=True, timeout=600,
                       env={**os.environ, "TERM": "dumb", "HOME": str(self.directory)})
        return {word for word in re.findall(r"^<(.*)>$", found.read_text(), re.MULTILINE)}

    def test_offers_what_may_follow(self):
        if not shutil.which("zsh"):
            lacks(self, "zsh")
        self.check()


class Fish(Completion):
    def offered(self, line):
        script = f"for file in {MANUAL}/fish/*.fish; source $file; end; complete -C {shell_quoted(line)}"
        said = subprocess.run(["fish", "--no-config", "-c", script], capture_output=True, text=True, cwd=self.directory,
                              env={**os.environ, "HOME": str(self.directory)})
        self.assertEqual(said.stderr, "")
        return {match.split("\t")[0] for match in said.stdout.split("\n")} - {""}

    def test_offers_what_may_follow(self):
        if not shutil.which("fish"):
            lacks(self, "fish")
        self.check()


def shell_quoted(text):
    return "'" + text.replace("'", "'\\''") + "'"


del Completion  # not a test itself

if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
