"""What stands for Apple's developer tools takes what those take, and nothing else."""
import subprocess
import tempfile
import unittest
from pathlib import Path

from support import ROOT

IBTOOL = ROOT / "tools/macos/bin/ibtool"
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


if __name__ == "__main__":
    unittest.main()
