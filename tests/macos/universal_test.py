"""Two builds, for one processor each, become one for both."""
import os
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

from support import BUILD, ROOT, write_files
from macos import binaries

MODULE = "samples/primes.zmb"


class Universal(unittest.TestCase):
    def setUp(self):
        holder = tempfile.TemporaryDirectory()
        self.addCleanup(holder.cleanup)
        self.folder = Path(holder.name)
        for processor in ("arm64", "x86_64"):
            (self.folder / processor / "MacOS").mkdir(parents=True)
            shutil.copyfile(BUILD / processor / MODULE, self.folder / processor / "MacOS/code")
            write_files(self.folder / processor, {"Info.plist": "<plist/>"})

    def joined(self):
        words = [ROOT / "tools/macos_universal", *(self.folder / name for name in ("arm64", "x86_64", "both"))]
        return subprocess.run(words, capture_output=True, text=True, check=False,
                              env=os.environ | {"LIPO": binaries.program("llvm-lipo")})

    def test_code_serves_both_processors_and_the_rest_is_there_once(self):
        done = self.joined()
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        told = subprocess.run([binaries.program("llvm-lipo"), "-archs", self.folder / "both/MacOS/code"], capture_output=True,
                              text=True, check=True)
        self.assertEqual(sorted(told.stdout.split()), ["arm64", "x86_64"])
        self.assertEqual((self.folder / "both/Info.plist").read_text(encoding="utf-8"), "<plist/>")

    def refuses(self, sentence):
        done = self.joined()
        self.assertEqual(done.returncode, 1)
        self.assertIn(sentence, done.stderr)

    def test_what_differs_and_is_no_code_is_refused(self):
        write_files(self.folder / "x86_64", {"Info.plist": "<plist></plist>"})
        self.refuses("Info.plist is not the same in both")
        self.assertFalse((self.folder / "both").exists())

    def test_what_only_one_has_is_refused(self):
        write_files(self.folder / "x86_64", {"more": ""})
        self.refuses("more is in one of them only")

    def test_code_for_the_same_processor_is_refused(self):
        shutil.copyfile(self.folder / "arm64/MacOS/code", self.folder / "x86_64/MacOS/code")
        self.refuses("cannot be joined")

    def test_a_result_that_is_there_is_left_alone(self):
        write_files(self.folder, {"both": "mine"})
        self.refuses("is there already")
        self.assertEqual((self.folder / "both").read_text(encoding="utf-8"), "mine")


if __name__ == "__main__":
    unittest.main()
