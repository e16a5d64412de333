"""What is linked for macOS may call only what the system has, and exports only what it should."""
import tempfile
import unittest
from pathlib import Path

from support import binaries, clang

MODULE = """#import <AppKit/AppKit.h>
extern "C" int tsrxEntryPoint()
{
    return [NSOpenPanel openPanel] != nil;
}
extern "C" int another()
{
    return 1;
}
"""
MISSING = """#import <AppKit/AppKit.h>
extern "C" void NSBeeps();
@interface NSOpenPanels : NSObject
@end
extern "C" int tsrxEntryPoint()
{
    NSBeeps();
    return [NSOpenPanels class] != nil;
}
"""
LINKED = ("-bundle", "-framework", "Cocoa", "-Wl,-exported_symbol,_tsrxEntryPoint")


class Linker(unittest.TestCase):
    def setUp(self):
        self._folder = tempfile.TemporaryDirectory()
        self.addCleanup(self._folder.cleanup)
        self.folder = Path(self._folder.name)

    def link(self, processor, *options, system="12.0", text=MODULE):
        half = self.folder / f"{processor}.half"
        taken, said = clang(text, "-target", f"{processor}-apple-macos{system}", *LINKED, *options, "-o", half)
        self.assertTrue(taken, said)
        return half

    def joined(self, *halves):
        whole = self.folder / "whole"
        binaries.join(halves, whole)
        return list(binaries.faults(whole, {"_tsrxEntryPoint"}, "12.0"))

    def test_a_module_that_looks_in_a_place_of_the_machine_it_was_built_on_is_found(self):
        halves = self.link("arm64", "-Wl,-rpath,/work/place"), self.link("x86_64", "-Wl,-rpath,@loader_path/..")
        self.assertEqual(self.joined(*halves), ["whole cannot be moved, for arm64: /work/place"])

    def test_a_module_with_its_entry_point_alone_passes(self):
        self.assertEqual(self.joined(self.link("arm64"), self.link("x86_64")), [])

    def test_a_further_export_of_one_half_is_found(self):
        faults = self.joined(self.link("arm64"), self.link("x86_64", "-Wl,-exported_symbol,_another"))
        self.assertEqual(faults, ["whole exports _another, for x86_64, which it should not"])

    def test_an_export_that_one_half_has_lost_is_found(self):
        without = MODULE.replace('extern "C" int tsrx', '__attribute__((visibility("hidden"))) extern "C" int tsrx')
        faults = self.joined(self.link("arm64", text=without), self.link("x86_64"))
        self.assertEqual(faults, ["whole does not export _tsrxEntryPoint, for arm64"])

    def test_what_is_left_to_be_looked_up_at_run_time_is_found(self):
        calling = MODULE.replace("return [", "extern void NSBeeps(); NSBeeps(); return [")
        halves = self.link("arm64", "-Wl,-undefined,dynamic_lookup", text=calling), self.link("x86_64", "-Wl,-undefined,dynamic_lookup")
        self.assertEqual(self.joined(*halves), ["whole calls _NSBeeps, for arm64, which no library has"])

    def test_a_missing_half_is_found(self):
        self.assertEqual(self.joined(self.link("x86_64")), ["whole has no half for arm64"])

    def test_another_oldest_system_is_found(self):
        faults = self.joined(self.link("arm64"), self.link("x86_64", system="13.0"))
        self.assertEqual(faults, ["whole runs from macOS 13.0 on, for x86_64, and not 12.0"])

    def test_modules_are_told_from_other_files(self):
        module, text = self.link("arm64"), self.folder / "text"
        text.write_text("it is long enough to have a beginning")
        library = self.link("x86_64", "-Wl,-dylib")
        self.assertEqual([binaries.is_linked(file) for file in (module, library, text, self.folder)], [True, True, False, False])
        self.assertEqual([binaries.is_module(file) for file in (module, library)], [True, False])

    def test_functions_and_classes_that_the_system_has_not_got_are_found(self):
        taken, said = clang(MISSING, *LINKED, "-o", self.folder / "half")
        self.assertFalse(taken)
        self.assertIn("undefined symbol: _NSBeeps", said)
        self.assertIn("undefined symbol: _OBJC_CLASS_$_NSOpenPanels", said)


if __name__ == "__main__":
    unittest.main()
