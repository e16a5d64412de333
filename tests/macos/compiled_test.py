"""The check of what was compiled finds sources that no build knows, and says where a name stands that nobody has."""
import subprocess
import tempfile
import unittest
from pathlib import Path

import support
from macos import compiled

SAID = """ld64.lld: error: undefined symbol: _SetThemeCursor
>>> referenced by unity_dialogs_0.mm.o

ld64.lld: error: undefined symbol: _OBJC_CLASS_$_NSOpenPanels
>>> referenced by unity_dialogs_0.mm.o
"""


class Compiled(unittest.TestCase):
    def setUp(self):
        holder = tempfile.TemporaryDirectory()
        self.addCleanup(holder.cleanup)
        self.folder = Path(holder.name)

    def test_what_a_build_has_read_is_told_by_its_own_record(self):
        support.write_files(self.folder, {"one.h": "", "one.cpp": '#include "one.h"\n', "build.ninja": """rule cxx
  command = c++ -MD -MF $out.d -c $in -o $out
  depfile = $out.d
  deps = gcc
build one.o: cxx one.cpp
"""})
        subprocess.run(["ninja", "-C", self.folder], check=True, capture_output=True)
        read = compiled.read_by_compiler(self.folder)
        self.assertLessEqual({str(self.folder / "one.cpp"), str(self.folder / "one.h")}, read)

    def test_a_source_that_nothing_compiles_is_found(self):
        files = [Path(name) for name in ("/host/a.cpp", "/host/platform/cocoa/B.mm", "/host/c.h")]
        self.assertEqual(list(compiled.left_out({"/host/a.cpp"}, files)), ["B.mm is compiled by nothing for macOS"])

    def test_sources_for_another_system_are_left_out(self):
        files = [Path(f"/host/platform/{name}") for name in ("gnustep/A.mm", "gnustep.cpp", "freedesktop.cpp", "ElfCheck.cpp")]
        self.assertEqual(list(compiled.left_out(set(), files)), [])

    def test_where_a_name_stands_that_nobody_has_is_told(self):
        file, = support.write_files(self.folder, {"Panel.mm": "void SetThemeCursor(int);\n\n[NSOpenPanels alloc];\nSetThemeCursors;\n"})
        self.assertEqual(list(compiled.undefined(SAID, [file])),
                         ["Panel.mm:3: names NSOpenPanels, which no library has",
                          "Panel.mm:1: names SetThemeCursor, which no library has"])

    def test_where_nothing_is_undefined_nothing_is_told(self):
        self.assertEqual(list(compiled.undefined("error: expected ';'", [self.folder / "none.mm"])), [])


if __name__ == "__main__":
    unittest.main()
