"""What the checkers share: which files are ours, and how to look at code without its comments."""

import os
import re
import subprocess
import sys

FLOORS = ["platform", "toon", "stage", "editor", "saver"]  # from the ground up
ASIDE = ["tests", "bench", "cli", "launch", "tools", "resources"]  # stand beside the house

TOKEN = re.compile(
    r"""
    //[^\n]* | /\*.*?\*/                               # comments
    | (?:u8|[uUL])?R"(?P<mark>[^(\s]*)\(.*?\)(?P=mark)"  # raw strings
    | "(?:\\.|[^"\\\n])*"                              # strings
    | (?<![0-9a-fA-F])'(?:\\.|[^'\\\n])+'              # characters, not the ' in 1'000
    """,
    re.VERBOSE | re.DOTALL,
)


def root_from_arguments():
    """The tree to look at: the first argument, or the one that this script lies in."""
    if len(sys.argv) > 1:
        return sys.argv[1]
    return os.path.dirname(os.path.dirname(os.path.abspath(__file__)))


def tracked(root):
    """All files that git knows or would take in; without git, all but what is built."""
    listing = subprocess.run(
        ["git", "-C", root, "ls-files", "-z", "--cached", "--others", "--exclude-standard"],
        capture_output=True,
        text=True,
        check=False,
    )
    if listing.returncode == 0 and os.path.exists(os.path.join(root, ".git")):
        names = set(listing.stdout.split("\0")) - {""}
        return sorted(name for name in names if os.path.isfile(os.path.join(root, name)))
    found = []
    for folder, inner, names in os.walk(root):
        inner[:] = [name for name in inner if name not in (".git", "build", "out")]
        found += [os.path.relpath(os.path.join(folder, name), root) for name in names]
    return sorted(found)


def sources(root):
    """The C++ files of ours."""
    return [name for name in tracked(root) if name.endswith((".cpp", ".h"))]


def read(root, name):
    with open(os.path.join(root, name), encoding="utf-8", errors="replace") as file:
        return file.read()


def bare(code, keep_strings=False):
    """The code with each comment and string a blank; line breaks stay, so that lines keep their
    numbers."""

    def blank(match):
        text = match.group()
        if keep_strings and not text.startswith(("//", "/*")):
            return text
        return " " + "\n" * text.count("\n")

    return TOKEN.sub(blank, code)


def report(faults):
    """Prints the faults and ends: 0 if there are none."""
    for fault in faults:
        print(fault)
    sys.exit(1 if faults else 0)
