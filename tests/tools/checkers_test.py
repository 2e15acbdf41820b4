#!/usr/bin/env python3
"""Each checker finds a fault that is planted in a small tree, and passes over what is right."""

import os
import subprocess
import sys
import tempfile
import unittest

TOOLS = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..", "tools")


class Tree:
    """Runs a checker over a tree of the given files; gives the lines that it prints."""

    def __init__(self, checker):
        self.checker = os.path.join(TOOLS, checker)

    def faults(self, files):
        with tempfile.TemporaryDirectory() as root:
            for name, text in files.items():
                path = os.path.join(root, name)
                os.makedirs(os.path.dirname(path), exist_ok=True)
                with open(path, "w", encoding="utf-8") as file:
                    file.write(text)
            run = subprocess.run(
                [sys.executable, self.checker, root], capture_output=True, text=True, check=False
            )
        assert run.stderr == "", run.stderr
        assert (run.returncode == 0) == (run.stdout == "")
        return run.stdout.splitlines()


class Floors(unittest.TestCase):
    HOUSE = {
        "platform/gdi.h": "",
        "platform/harness.h": "",
        "platform/gdi/surface.h": "",
        "stage/walk.h": "",
        "editor/chrome.h": "",
        "tests/fixture.h": "",
    }
    BAD = [
        ("stage/walk.cpp", '#include "editor/chrome.h"\n', "higher floor"),
        ("platform/gdi/text.cpp", '#  include "stage/walk.h"\n', "higher floor"),
        ("stage/walk.cpp", '#include "walk.h"\n', "from the top"),
        ("stage/walk.cpp", '#include "tests/fixture.h"\n', "beside the house"),
        ("stage/walk.cpp", '#include "platform/harness.h"\n', "for tests"),
        ("stage/walk.cpp", '#include "platform/gdi/surface.h"\n', "the seam alone"),
        ("stage/walk.cpp", "#include <QString>\n", "the seam alone"),
        ("main.cpp", "#include <xcb/xcb.h>\n", "the seam alone"),
        ("stage/walk.cpp", "\n/* a\nb */ class Walk {\n};\n", "walk.cpp:3: no class"),
        ("stage/walk.h", "void f() { throw 1; }\n", "no throw"),
    ]
    GOOD = {
        "editor/chrome.cpp": '#include "stage/walk.h"\n#include "platform/gdi.h"\n#include <cstring>\n'
        '// class, try: "editor"\nenum class Side { left };\ntemplate <class T> T f();\n'
        'const char* text = "a class // \\" throw";\n',
        "platform/gdi/text.cpp": '#include "platform/gdi/surface.h"\n#include <QImage>\nclass A;\n'
        '#include "text.moc"\n',
        "tests/walk_test.cpp": '#include "stage/walk.h"\n#include <QTest>\n',
        "main.cpp": '#include "editor/chrome.h"\n',
    }

    def test_faults(self):
        for name, text, expected in self.BAD:
            with self.subTest(text):
                found = Tree("check-floors").faults({**self.HOUSE, name: text})
                self.assertEqual(len(found), 1, found)
                self.assertIn(expected, found[0])

    def test_rightful_code(self):
        self.assertEqual(Tree("check-floors").faults({**self.HOUSE, **self.GOOD}), [])


class Externs(unittest.TestCase):
    HEADER = "// What it is; f writes it.\nextern int Odo;\n"
    BAD = [
        ({"toon/a.h": HEADER, "toon/a.cpp": "int f() { int Odo = 1; return Odo; }\n"}, "not defined"),
        ({"toon/a.h": HEADER, "toon/b.cpp": "int Odo;\n"}, "not defined"),
        ({"toon/a.h": HEADER, "toon/a.cpp": "static int Odo = 0;\n"}, "not defined"),
        ({"toon/a.h": HEADER, "toon/a.cpp": "int Odo;\n", "toon/b.h": HEADER}, "declared in"),
        ({"toon/a.cpp": "int Odo;\n", "toon/b.cpp": "extern int Odo;\n"}, "in a source file"),
        ({"stage/a_host.h": HEADER, "toon/a.cpp": "int Odo;\n"}, "not defined"),
        ({"toon/a.h": "extern int Odo;\n", "toon/a.cpp": "int Odo;\n"}, "no comment"),
    ]
    GOOD = {
        "toon/a.h": "// Both counts; f writes them.\nextern unsigned Odo;\nextern char Name[128];\n"
        "extern const char* (*Namer)(int); // who names\nextern int Left, Right; // sides\n"
        'extern "C" int entry();\n',
        "toon/a.cpp": "namespace {\nint x;\n}\nunsigned Odo = 0;\nchar Name[128] = {0};\n"
        "const char* (*Namer)(int) = nullptr;\nint Left{}, Right{};\nint f() { return x; }\n",
        "stage/editor_host.h": "// The open editor.\nextern int Editor;\n",
        "editor/shell.cpp": "int Editor;\n",
        "platform/trace.h": "// Where lines go.\nextern void* Sink;\n",
        "platform/kernel/trace.cpp": "void* Sink = nullptr; // extern int Nothing;\n",
    }

    def test_faults(self):
        for files, expected in self.BAD:
            with self.subTest(expected):
                found = Tree("check-externs").faults(files)
                self.assertEqual(len(found), 1, found)
                self.assertIn(expected, found[0])

    def test_rightful_code(self):
        self.assertEqual(Tree("check-externs").faults(self.GOOD), [])


class Words(unittest.TestCase):
    # Put together from halves, so that this file has none of them.
    BAD = ["sp" "ec.md", "Pa" "rt 1.1", "the specifi" "cation", "TO" "DO", "/wo" "rk/main", "GTEST" "_SKIP()"]
    GOOD = "inspect, a special part of 1.1 things, out/work/main, specific, todos\n"

    def test_faults(self):
        for word in self.BAD:
            with self.subTest(word):
                self.assertEqual(len(Tree("check-words").faults({"docs/a.md": f"See {word}.\n"})), 1)

    def test_rightful_text(self):
        free = "\n".join(self.BAD)
        self.assertEqual(Tree("check-words").faults({"docs/a.md": self.GOOD, "DEVELOPERS.md": free}), [])


class Behaviour(unittest.TestCase):
    TESTS = {
        "tests/a/walk_test.cpp": "TEST(Walk, Goes) {}\n  TEST_P(Walk,\n  Stays) {}\n// TEST(Walk, Flies)\n",
        "tests/a/help_test.py": "class A:\n    def test_it(self):\n",
    }
    HEAD = "Text of `Walk.Flies`.\n\n| What the user does | What happens | Test |\n|---|---|---|\n"
    BAD = [
        ("| a | b | `Walk.Flies` |", "there is no test Walk.Flies"),
        ("| a | b | `Walk.Goes`, `help_test.py: test_all` |", "there is no test help_test.py: test_all"),
        ("| `Walk.Goes` | b | |", "no test"),
        ("| a | `Walk.Goes` |", "no test"),
    ]

    def faults(self, rows):
        return Tree("check-behaviour").faults({**self.TESTS, "docs/behaviour.md": self.HEAD + rows + "\n"})

    def test_faults(self):
        for row, expected in self.BAD:
            with self.subTest(row):
                found = self.faults(row)
                self.assertEqual(len(found), 1, found)
                self.assertIn(expected, found[0])

    def test_rightful_table(self):
        self.assertEqual(self.faults("| a | `b` | `Walk.Goes`, `Walk.Stays`, `help_test.py: test_it` |"), [])


if __name__ == "__main__":
    unittest.main()
