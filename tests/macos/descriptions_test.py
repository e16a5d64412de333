"""The check of property lists finds what the system would miss."""
import plistlib
import unittest

import support  # noqa: F401
from macos import descriptions

SOUND = {
    "CFBundleDevelopmentRegion": "en", "CFBundleExecutable": "Tessel", "CFBundleIdentifier": "org.tessel.Tessel",
    "CFBundleInfoDictionaryVersion": "6.0", "CFBundleName": "Tessel", "CFBundlePackageType": "APPL",
    "CFBundleShortVersionString": "1.0.0", "CFBundleVersion": "1.0.0", "LSMinimumSystemVersion": "12.0",
    "CFBundleIconFile": "Tessel", "NSPrincipalClass": "NSApplication", "NSHighResolutionCapable": True,
}


class Descriptions(unittest.TestCase):
    def faults(self, **changes):
        described = {key: value for key, value in {**SOUND, **changes}.items() if value is not None}
        return list(descriptions.faults("Info.plist", plistlib.dumps(described), "12.0"))

    def test_a_sound_one_passes(self):
        self.assertEqual(self.faults(), [])

    def test_every_key_is_asked_for(self):
        for key in SOUND:
            if key not in ("CFBundlePackageType", "NSHighResolutionCapable"):
                self.assertEqual(self.faults(**{key: None}), [f"Info.plist: {key} is not there"])
        self.assertEqual(self.faults(NSHighResolutionCapable=None), ["Info.plist: NSHighResolutionCapable is not switched on"])
        self.assertIn("Info.plist: CFBundlePackageType is not there", self.faults(CFBundlePackageType=None))

    def test_a_bundle_needs_less_than_a_program(self):
        self.assertEqual(self.faults(CFBundlePackageType="BNDL", NSPrincipalClass=None, CFBundleIconFile=None,
                                     NSHighResolutionCapable=None), [])

    def test_a_version_is_made_of_numbers(self):
        self.assertEqual(self.faults(CFBundleVersion="1.0-beta"), ["Info.plist: CFBundleVersion is '1.0-beta'"])
        self.assertEqual(self.faults(CFBundleVersion=1.0), ["Info.plist: CFBundleVersion is 1.0"])

    def test_an_identifier_has_a_domain(self):
        self.assertEqual(self.faults(CFBundleIdentifier="Tessel"), ["Info.plist: CFBundleIdentifier is 'Tessel'"])

    def test_a_switch_is_no_text(self):
        self.assertEqual(self.faults(NSHighResolutionCapable="YES"), ["Info.plist: NSHighResolutionCapable is not switched on"])

    def test_another_oldest_system_than_the_builds_is_found(self):
        self.assertEqual(self.faults(LSMinimumSystemVersion="11.0"),
                         ["Info.plist: LSMinimumSystemVersion is not 12.0, which the build is for"])

    def test_what_is_no_property_list_is_said(self):
        fault, = descriptions.faults("Info.plist", plistlib.dumps(SOUND)[:-20], "12.0")
        self.assertTrue(fault.startswith("Info.plist: is no property list: "), fault)


if __name__ == "__main__":
    unittest.main()
