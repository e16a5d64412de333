"""What stands for Apple's developer tools takes what those take, and nothing else."""
import os
import shutil
import struct
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

from support import BUILD, ROOT

ICONUTIL = ROOT / "tools/macos/bin/iconutil"
IBTOOL = ROOT / "tools/macos/bin/ibtool"
RUNS_PROGRAM = ROOT / "tools/macos/bin/runs_program"
LAYOUT = '<document type="com.apple.InterfaceBuilder3.Cocoa.XIB"><objects/></document>'


class LayoutCompiler(unittest.TestCase):
    def compiled(self, text, *words):
        with tempfile.TemporaryDirectory() as folder:
            layout, result = Path(folder) / "a.xib", Path(folder) / "a.nib"
            layout.write_text(text, encoding="utf-8")
            done = subprocess.run([IBTOOL, *words, "--compile", result, layout], capture_output=True, text=True, check=False)
            return done.returncode, result.exists()

    def test_a_layout_is_put_where_the_compiled_one_belongs(self):
        self.assertEqual(self.compiled(LAYOUT, "--errors", "--output-format", "human-readable-text"), (0, True))

    def test_what_is_no_layout_is_refused(self):
        self.assertEqual(self.compiled(LAYOUT[:-3]), (1, False))
        self.assertEqual(self.compiled("<plist/>"), (1, False))

    def test_a_misspelt_word_is_refused(self):
        self.assertEqual(self.compiled(LAYOUT, "--errorz"), (2, False))


class IconMaker(unittest.TestCase):
    def made(self, pictures):
        """name -> width: what the program answers, and the file."""
        with tempfile.TemporaryDirectory() as folder:
            result = Path(folder) / "App.icns"
            (Path(folder) / "App.iconset").mkdir()
            for name, pixels in pictures.items():
                head = b"\x89PNG\r\n\x1a\n" + struct.pack(">I", 13) + b"IHDR" + struct.pack(">II", pixels, pixels)
                (Path(folder) / "App.iconset" / name).write_bytes(head)
            words = [ICONUTIL, "--convert", "icns", "--output", result, Path(folder) / "App.iconset"]
            done = subprocess.run(words, capture_output=True, text=True, check=False)
            return done.returncode, result.read_bytes() if result.exists() else b""

    def test_pictures_become_one_file(self):
        status, data = self.made({"icon_16x16.png": 16, "icon_16x16@2x.png": 32})
        self.assertEqual((status, data[:4], struct.unpack(">I", data[4:8])), (0, b"icns", (len(data),)))
        self.assertIn(b"icp4", data)
        self.assertIn(b"ic11", data)

    def test_a_picture_of_another_size_than_its_name_says_is_refused(self):
        self.assertEqual(self.made({"icon_16x16@2x.png": 16}), (1, b""))

    def test_a_picture_of_an_unknown_name_is_refused(self):
        self.assertEqual(self.made({"icon_48x48.png": 48}), (1, b""))


class WithoutABuild(unittest.TestCase):
    def setUp(self):
        holder = tempfile.TemporaryDirectory()
        self.addCleanup(holder.cleanup)
        self.folder = Path(holder.name)
        shutil.copytree(ROOT / "tools/macos", self.folder / "tools/macos")
        shutil.copy(ROOT / "tools/check_macos", self.folder / "tools")
        subprocess.run(["git", "init", "--quiet", self.folder], check=True)

    def said(self, part, **environment):
        done = subprocess.run([sys.executable, "-B", self.folder / "tools/check_macos", part], capture_output=True, text=True,
                              check=False, env=os.environ | environment)
        return done.returncode, done.stdout + done.stderr

    def test_a_check_without_what_it_stands_on_gets_it_or_says_how(self):
        self.assertEqual(self.said("delegates", PATH="/nowhere"), (1, "The checks for macOS need npm, which tools/setup installs.\n"))

    def test_a_check_of_what_was_built_says_that_nothing_was(self):
        (self.folder / "build/macos").mkdir(parents=True)
        for name in ("fetched", "MacOSX.sdk"):
            (self.folder / "build/macos" / name).symlink_to(BUILD / name)
        for part in ("binaries", "descriptions"):
            self.assertEqual(self.said(part), (1, "Nothing has been built for macOS yet: tools/check_macos build-arm64 build-x86_64 "
                                               "does it.\n"))


class RunsProgram(unittest.TestCase):
    def run_program(self, program, *words):
        with tempfile.TemporaryDirectory() as folder:
            source, result = Path(folder) / "a.lsp", Path(folder) / "a.qbc"
            source.write_text("(+ 1 2)", encoding="utf-8")
            done = subprocess.run([RUNS_PROGRAM, program, source, *words, "-o", result], capture_output=True, text=True, check=False)
            return done.returncode, result.exists()

    def test_the_compiler_of_lisp_makes_a_file(self):
        self.assertEqual(self.run_program("/build/Tessel.app/Contents/MacOS/tesselc"), (0, True))

    def test_another_program_is_not_run(self):
        self.assertEqual(self.run_program("/build/tests/unit_tests"), (1, False))

    def test_a_word_that_the_compiler_does_not_take_is_refused(self):
        self.assertEqual(self.run_program("/build/tesselc", "--fast"), (2, False))


if __name__ == "__main__":
    unittest.main()
