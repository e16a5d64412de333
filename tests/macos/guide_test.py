"""What the guide for a person with a Mac names is there."""
import plistlib
import re
import unittest

from support import ROOT

GUIDE = (ROOT / "docs/macos.md").read_text(encoding="utf-8")
TRIAL = re.compile(r"^\| (\d+) \| (.+?) \| (.+?) \|$", re.MULTILINE)
OURS = re.compile(r"(?<![\w/.])(?:\./(?:run|test)\b|(?:tools|packaging|docs)/[\w./-]*\w)")
# What comes with the system, with Apple's developer tools, and with what is built by.
OTHERS = {"cmake", "codesign", "ditto", "open", "spctl", "xattr", "xcrun"}


class Guide(unittest.TestCase):
    def test_there_are_twenty_things_to_look_at_each_with_what_is_to_be_seen(self):
        found = TRIAL.findall(GUIDE)
        self.assertEqual([number for number, _, _ in found], [str(number) for number in range(1, 21)])
        self.assertEqual([number for number, do, see in found if len(do) < 10 or len(see) < 10], [])

    def test_every_command_is_there(self):
        words = [line.split()[0] for line in GUIDE.splitlines() if re.match(r" {4,6}\S", line)]
        ours = [word for word in words if word not in OTHERS and not word.startswith("build/")]
        self.assertEqual([word for word in ours if not (ROOT / word).exists()], [])
        self.assertIn("tools/macos_sign", words)

    def test_every_file_of_the_project_that_it_names_is_there(self):
        names = set(OURS.findall(GUIDE))
        self.assertLessEqual({"./run", "./test", "tools/macos_report", "packaging/tessel.entitlements"}, names)
        self.assertEqual([name for name in names if not (ROOT / name).exists()], [])

    def test_the_parts_of_the_report_are_those_that_it_has(self):
        report = (ROOT / "tools/macos_report").read_text(encoding="utf-8")
        parts = re.search(r"^all_parts=\((.*)\)$", report, re.MULTILINE).group(1).split()
        told = [word for line in re.findall(r"tools/macos_report ([a-z ]+)`", GUIDE) for word in line.split()]
        self.assertTrue(told)
        self.assertEqual([part for part in told if part not in parts], [])
        self.assertEqual([part for part in parts if f"part_{part}()" not in report], [])

    def test_entitlements_are_a_property_list_that_switches_library_validation_off(self):
        said = plistlib.loads((ROOT / "packaging/tessel.entitlements").read_bytes())
        self.assertEqual(said, {"com.apple.security.cs.disable-library-validation": True})


if __name__ == "__main__":
    unittest.main()
