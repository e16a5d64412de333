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


BUILD = descriptions.Build("1.0.0", "12.0", lambda name: name == "NSApplication")


class Descriptions(unittest.TestCase):
    def faults(self, kind="app", **changes):
        described = {key: value for key, value in {**SOUND, **changes}.items() if value is not None}
        data = plistlib.dumps(described)  # in the order of the keys, the first of them in line 5
        return list(descriptions.Description(f"T.{kind}/Contents/Info.plist", data, BUILD).faults())

    def finds(self, fault, **changes):
        self.assertEqual(self.faults(**changes), [f"T.app/Contents/Info.plist:{fault}"])

    def test_a_sound_one_passes(self):
        self.assertEqual(self.faults(), [])

    def test_every_key_is_asked_for(self):
        for key in SOUND:
            if key != "NSHighResolutionCapable":
                self.finds(f" {key} is not there", **{key: None})
        self.finds(" NSHighResolutionCapable is not switched on", NSHighResolutionCapable=None)

    def test_a_bundle_needs_less_than_a_program(self):
        self.assertEqual(self.faults("bundle", CFBundlePackageType="BNDL", NSPrincipalClass=None, CFBundleIconFile=None,
                                     NSHighResolutionCapable=None), [])

    def test_a_bundle_does_not_call_itself_a_program_nor_the_other_way_round(self):
        self.finds("17: CFBundlePackageType is 'BNDL', and not 'APPL'", CFBundlePackageType="BNDL")
        self.assertEqual(self.faults("bundle"), ["T.bundle/Contents/Info.plist:17: CFBundlePackageType is 'APPL', and not 'BNDL'"])

    def test_a_version_is_made_of_numbers(self):
        self.assertEqual(self.faults(CFBundleVersion="1.0-beta")[0], "T.app/Contents/Info.plist:21: CFBundleVersion is '1.0-beta'")
        self.finds("21: CFBundleVersion is 1.0", CFBundleVersion=1.0)

    def test_a_version_is_the_builds(self):
        self.finds("19: CFBundleShortVersionString is '1.0.1', and not '1.0.0'", CFBundleShortVersionString="1.0.1")

    def test_an_identifier_has_a_domain(self):
        self.finds("11: CFBundleIdentifier is 'Tessel'", CFBundleIdentifier="Tessel")

    def test_a_class_has_to_be_there(self):
        self.finds("27: NSPrincipalClass is NSApplications, which is no class", NSPrincipalClass="NSApplications")

    def test_a_switch_is_no_text(self):
        self.finds(" NSHighResolutionCapable is not switched on", NSHighResolutionCapable="YES")

    def test_a_key_that_nobody_knows_is_found(self):
        self.finds("23: LSMinimumSystem is a key that nothing checks", LSMinimumSystem="12.0")

    def test_a_key_that_stands_there_twice_is_found(self):
        data = plistlib.dumps(SOUND).replace(b"<dict>", b"<dict><key>CFBundleName</key><string>Other</string>")
        fault, = descriptions.Description("T.app/Contents/Info.plist", data, BUILD).faults()
        self.assertEqual(fault, "T.app/Contents/Info.plist:4: CFBundleName stands there twice")

    def test_another_oldest_system_than_the_builds_is_found(self):
        self.finds("23: LSMinimumSystemVersion is '11.0', and not '12.0'", LSMinimumSystemVersion="11.0")

    def test_what_is_no_property_list_is_said(self):
        for data, said in ((plistlib.dumps(SOUND)[:-20], "is no property list: "), (plistlib.dumps([SOUND]), "is no table of keys")):
            fault, = descriptions.Description("T.app/Contents/Info.plist", data, BUILD).faults()
            self.assertTrue(fault.startswith(f"T.app/Contents/Info.plist: {said}"), fault)


if __name__ == "__main__":
    unittest.main()
