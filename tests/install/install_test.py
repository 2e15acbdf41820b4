#!/usr/bin/env python3
"""Installs what is built into a directory of its own, twice: for a prefix with a blank in it, as a
user would, and staged for /usr, as a package is. What desktops look for is found there, and what one
file says of another holds.

    install_test.py CMAKE BUILD"""

import glob
import gzip
import os
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
BUILD = os.path.abspath(sys.argv.pop())
CMAKE = sys.argv.pop()
TYPE = "application/x-dorbo-toon"
SIZES = (16, 22, 24, 32, 48, 64, 128, 256)


def run(*words, **environment):
    done = subprocess.run(
        words, capture_output=True, text=True, check=False, env={**os.environ, "LC_ALL": "C.UTF-8", **environment}
    )
    if done.returncode != 0:
        raise AssertionError(f"{words}: {done.stdout}{done.stderr}")
    return done.stdout + done.stderr


def read(*path):
    name = os.path.join(*path)
    with (gzip.open if name.endswith(".gz") else open)(name, "rt", encoding="utf-8") as file:
        return file.read()


class Install(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.ground = tempfile.mkdtemp()
        cls.addClassCleanup(shutil.rmtree, cls.ground)
        cls.prefix = os.path.join(cls.ground, "a prefix")
        cls.share = os.path.join(cls.prefix, "share")
        cls.staged = os.path.join(cls.ground, "staged")
        # With a component the list of an earlier installation stays, by which that can be removed.
        install = (CMAKE, "--install", BUILD, "--component", "Unspecified", "--prefix")
        run(*install, cls.prefix, DESTDIR="")
        run(*install, "/usr", DESTDIR=cls.staged)
        run("update-mime-database", os.path.join(cls.share, "mime"))
        run("update-desktop-database", os.path.join(cls.share, "applications"))

    def expect_files(self, *names):
        missing = [name for name in names if not os.path.isfile(os.path.join(self.prefix, name))]
        self.assertEqual(missing, [])

    def entries(self):
        return glob.glob(os.path.join(self.share, "applications/*.desktop"))

    def test_programs_toons_and_completions_lie_where_they_are_looked_for(self):
        self.expect_files("bin/dorbo", "bin/toon", "libexec/xscreensaver/dorbo-hack",
                          "share/xscreensaver/config/dorbo-hack.xml", "share/bash-completion/completions/toon",
                          "share/fish/vendor_completions.d/toon.fish", "share/zsh/site-functions/_toon")
        toons = [os.path.basename(name)[:-5] for name in glob.glob(os.path.join(ROOT, "toons/*.json"))]
        self.assertEqual(len(toons), 8)
        self.expect_files(*(f"share/dorbo/toons/{name}.zkt" for name in toons))
        for name in ("bin/dorbo", "bin/toon", "libexec/dorbo/dorbo-start", "libexec/xsecurelock/saver_dorbo"):
            self.assertTrue(os.access(os.path.join(self.prefix, name), os.X_OK), name)

    def test_everybody_may_read_everything_and_nothing_tells_of_the_building_place(self):
        for folder, _, names in os.walk(os.path.join(self.staged, "usr")):
            self.assertEqual(os.stat(folder).st_mode & 0o555, 0o555, folder)
            for name in names:
                path = os.path.join(folder, name)
                self.assertEqual(os.stat(path).st_mode & 0o444, 0o444, path)
                with open(path, "rb") as file:
                    if "/bin/" not in path and "/libexec/" not in path:  # debug texts stay until they are stripped
                        self.assertNotIn(ROOT.encode(), file.read(), path)

    def test_icons_are_there_in_every_size(self):
        folders = [f"{size}x{size}" for size in SIZES]
        for icon in ("apps/dorbo", "mimetypes/application-x-dorbo-toon"):
            self.expect_files(f"share/icons/hicolor/scalable/{icon}.svg",
                              *(f"share/icons/hicolor/{folder}/{icon}.png" for folder in folders))
        for size, folder in zip(SIZES, folders):
            for name in glob.glob(os.path.join(self.share, "icons/hicolor", folder, "*/*.png")):
                with open(name, "rb") as file:
                    self.assertEqual(file.read()[16:24], size.to_bytes(4, "big") * 2, name)

    def test_entries_are_valid_and_name_the_launcher_and_icons_by_what_is_installed(self):
        self.assertEqual(len(self.entries()), 3)
        self.assertEqual(run("desktop-file-validate", *self.entries()), "")
        for entry in self.entries():
            text = read(entry)
            launcher = os.path.join(self.prefix, "libexec/dorbo/dorbo-start")
            self.assertRegex(text, f'(?m)^Exec="{re.escape(launcher)}" (dorbo|toon) ')
            icon = re.search(r"(?m)^Icon=(.*)", text).group(1)
            self.expect_files(f"share/icons/hicolor/48x48/apps/{icon}.png")
            staged = read(self.staged, "usr/share/applications", os.path.basename(entry))
            self.assertRegex(staged, r"(?m)^Exec=/usr/libexec/dorbo/dorbo-start ")

    def test_toons_are_known_by_name_and_by_their_first_bytes(self):
        toon = os.path.join(self.share, "dorbo/toons/intro.zkt")
        with open(toon, "rb") as file:
            start = file.read(40)
        files = {"named.ZKT": (b"anything", True), "unnamed": (start, True),
                 "other": (b"Dorbo Toon Frame File, a text", False)}
        for name, (content, known) in files.items():
            path = os.path.join(self.ground, name)
            with open(path, "wb") as file:
                file.write(content)
            told = run("gio", "info", "-a", "standard::content-type,standard::icon", path,
                       XDG_DATA_DIRS=self.share + ":/usr/share", XDG_DATA_HOME=self.ground)
            self.assertEqual(f"standard::content-type: {TYPE}\n" in told, known, told)
            self.assertEqual("standard::icon: application-x-dorbo-toon," in told, known, told)

    def test_a_double_click_plays_and_the_editor_is_offered(self):
        cache = read(self.share, "applications/mimeinfo.cache")
        self.assertIn(f"{TYPE}=dorbo-player.desktop;dorbo-toon-editor.desktop;\n", cache)

    def test_metainfo_is_valid_and_names_what_is_installed(self):
        name = os.path.join(self.share, "metainfo/org.dorbo.dorbo.metainfo.xml")
        run("appstreamcli", "validate", "--no-net", "--pedantic", name)
        text = read(name)
        self.expect_files(*(f"share/applications/{entry}" for entry in re.findall(r'desktop-id">(.*?)<', text)),
                          *(f"bin/{program}" for program in re.findall(r"<binary>(.*?)<", text)))
        self.assertIn(f"<mediatype>{TYPE}<", text)

    def test_all_tell_the_same_version(self):
        version = re.search(r"(?m)^CMAKE_PROJECT_VERSION:\w+=(.*)", read(BUILD, "CMakeCache.txt")).group(1)
        places = {
            "doc/dorbo/changelog.gz": r"^dorbo \((.*?)\)",
            "metainfo/org.dorbo.dorbo.metainfo.xml": r'<release version="(.*?)"',
            "man/man6/dorbo.6.gz": r'\.TH .* "Dorbo (.*?)"',
            "man/man1/toon.1.gz": r'\.TH .* "Dorbo (.*?)"',
        }
        for name, pattern in places.items():
            self.assertEqual(re.search(pattern, read(self.share, name)).group(1), version, name)

    def test_documents_are_clean_and_lead_to_what_is_installed(self):
        for page in ("man6/dorbo.6.gz", "man1/toon.1.gz"):
            path = os.path.join(self.share, "man", page)
            self.assertEqual(run("mandoc", "-T", "lint", path), "")
            named = re.findall(r"/usr/(share/\S*\w)", read(path).replace("\\-", "-"))
            self.assertEqual([name for name in named if not os.path.exists(os.path.join(self.prefix, name))], [])
        for page in glob.glob(os.path.join(self.share, "doc/dorbo/*.md")):
            for link in re.findall(r"\]\(([\w./-]+)\)", read(page)):
                self.expect_files(os.path.join("share/doc/dorbo", link))

    def test_the_page_of_dorbo_names_every_setting(self):
        keys = re.findall(r'_KEY\[\] = "(.*?)"', read(ROOT, "toon/settings.cpp"))
        self.assertEqual(len(keys), 5)
        page = read(self.share, "man/man6/dorbo.6.gz")
        self.assertEqual([key for key in keys if f"\n.B {key}\n" not in page], [])


if __name__ == "__main__":
    unittest.main()
