"""The check of what stands in a program finds what is missing there."""
import plistlib
import struct
import tempfile
import unittest
from pathlib import Path

import support  # noqa: F401
from macos import binaries, contents


class Contents(unittest.TestCase):
    def faults(self, *without, beside=()):
        with tempfile.TemporaryDirectory() as folder:
            app = Path(folder)
            for name in {"Contents/Resources/en.lproj/Window.nib", "Contents/Resources/de.lproj/Window.nib",
                         "Contents/Resources/App.icns", "Contents/MacOS/App", *beside} - set(without):
                (app / name).parent.mkdir(parents=True, exist_ok=True)
                (app / name).write_bytes(struct.pack("<I12x", binaries.MAGIC) if name == "Contents/MacOS/App" else b"")
            (app / "Contents/Info.plist").write_bytes(plistlib.dumps({"CFBundleIconFile": "App", "CFBundleExecutable": "App"}))
            return [*contents.faults(app, ["Window"], ["en", "de"]), *contents.described(app)]

    def test_nothing_is_wrong_where_all_is_there(self):
        self.assertEqual(self.faults(), [])

    def test_a_layout_that_is_not_compiled_is_found(self):
        name = "Contents/Resources/en.lproj/Window.xib"
        self.assertEqual(self.faults(beside=[name]), [f"{name}: no system of today reads a layout that is not compiled"])

    def test_a_language_without_the_layout_is_found(self):
        self.assertEqual(self.faults("Contents/Resources/de.lproj/Window.nib"), ["Window is not there in de"])

    def test_a_missing_icon_is_found(self):
        self.assertEqual(self.faults("Contents/Resources/App.icns"), ["Contents/Info.plist: there is no icon App"])

    def test_a_missing_program_is_found(self):
        self.assertEqual(self.faults("Contents/MacOS/App"), ["Contents/Info.plist: there is no program App"])


if __name__ == "__main__":
    unittest.main()
