#!/usr/bin/env python3
"""Holds the man page and the completions of `toon` against what it tells of itself: each names every
command and every option that its help names, and no option that it doesn't.

    help_test.py TOON"""

import os
import re
import subprocess
import sys
import unittest

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
TOON = sys.argv.pop()
OPTION = re.compile(r"(?<![\w-])--?[a-z][\w-]*")


def told(*arguments):
    return subprocess.run([TOON, *arguments], capture_output=True, text=True, check=True).stdout


def read(path):
    with open(os.path.join(ROOT, path), encoding="utf-8") as file:
        return file.read()


class Help(unittest.TestCase):
    def setUp(self):
        self.commands = re.findall(r"^  toon (\w+) ", told("--help"), re.MULTILINE)
        self.options = {"--help"}
        for command in self.commands:
            usage = told(command, "--help").splitlines()[0]
            self.options |= set(OPTION.findall(usage))

    def test_tells_of_commands(self):
        self.assertIn("film", self.commands)
        self.assertIn("--size", self.options)

    def check(self, names, options):
        self.assertEqual(set(self.commands) - names, set())
        self.assertEqual(options, self.options)

    def test_man_page(self):
        page = re.sub(r"^\.T[HP].*", "", read("docs/toon.1").replace("\\-", "-"), flags=re.MULTILINE)
        self.check(set(re.findall(r"\w+", page)), set(OPTION.findall(page)))

    def test_bash(self):
        text = read("completions/toon.bash")
        given = " ".join(re.findall(r'words="([^"]*)"', text) + ["--help"])
        self.check(set(re.findall(r"\w+", text)), set(OPTION.findall(given)))

    def test_zsh(self):
        text = read("completions/_toon")
        self.check(set(re.findall(r"'(\w+):", text)), set(re.findall(r"'(--?[a-z][\w-]*)[:\[]", text)))

    def test_fish(self):
        text = "".join(line for line in read("completions/toon.fish").splitlines(True) if line.startswith("complete "))
        long = {"--" + name for name in re.findall(r" -l ([\w-]+)", text)}
        short = {"-" + name for name in re.findall(r" -s (\w) ", text)}
        self.check(set(re.findall(r" -a (\w+) ", text)), long | short)


if __name__ == "__main__":
    unittest.main()
