"""Checks property lists that describe a program or a bundle: what the system asks for is there, of the right kind, and says
what was built."""
import plistlib
import re
from dataclasses import dataclass
from pathlib import PurePosixPath
from typing import Callable

VERSION = re.compile(r"\d+(\.\d+){0,2}\Z")
IDENTIFIER = re.compile(r"[A-Za-z0-9-]+(\.[A-Za-z0-9-]+)+\Z")
ANY_TEXT = re.compile(r".+")
BOTH = {
    "CFBundleDevelopmentRegion": ANY_TEXT, "CFBundleExecutable": ANY_TEXT, "CFBundleIdentifier": IDENTIFIER,
    "CFBundleInfoDictionaryVersion": re.compile(r"6\.0\Z"), "CFBundleName": ANY_TEXT, "CFBundlePackageType": ANY_TEXT,
    "CFBundleShortVersionString": VERSION, "CFBundleVersion": VERSION, "LSMinimumSystemVersion": VERSION,
}
PROGRAM = {"CFBundleIconFile": ANY_TEXT, "NSPrincipalClass": ANY_TEXT}
SWITCHES = {"NSHighResolutionCapable"}
# The first is how it says itself which version it is; the system compares the second.
VERSIONS = ("CFBundleShortVersionString", "CFBundleVersion")


@dataclass
class Build:
    """What was built: its version, the oldest system that it is for, and whether a class is there."""
    version: str
    oldest_system: str
    is_class: Callable


class Description:
    """`name`: where it stands, from the folder of its bundle on."""

    def __init__(self, name, data, build):
        self._name, self._data, self._build = name, data, build
        self._is_program = PurePosixPath(name).parts[-3].endswith(".app")

    def faults(self):
        try:
            self._described = plistlib.loads(self._data)
        except Exception as error:  # whatever the parser has to say
            yield f"{self._name}: is no property list: {error}"
            return
        if not isinstance(self._described, dict):
            yield f"{self._name}: is no table of keys"
            return
        yield from self._forms()
        yield from self._others()
        yield from self._values()

    def _at(self, key):
        line = self._data.split(f"<key>{key}</key>".encode())[0].count(b"\n") + 1
        return f"{self._name}:{line}: {key}"

    def _forms(self):
        for key, form in (BOTH | (PROGRAM if self._is_program else {})).items():
            value = self._described.get(key)
            if value is None:
                yield f"{self._name}: {key} is not there"
            elif not isinstance(value, str) or not form.match(value):
                yield f"{self._at(key)} is {value!r}"
        for key in sorted(SWITCHES) if self._is_program else ():
            if self._described.get(key) is not True:
                yield f"{self._name}: {key} is not switched on"

    def _others(self):
        """A misspelt key is one that nobody reads."""
        for key in self._described:
            if key not in BOTH | PROGRAM and key not in SWITCHES:
                yield f"{self._at(key)} is a key that nothing checks"
            if self._data.count(f"<key>{key}</key>".encode()) > 1:
                yield f"{self._at(key)} stands there twice"

    def _values(self):
        wanted = {"CFBundlePackageType": "APPL" if self._is_program else "BNDL",
                  "LSMinimumSystemVersion": self._build.oldest_system, **{key: self._build.version for key in VERSIONS}}
        for key, value in wanted.items():
            said = self._described.get(key, value)
            if isinstance(said, str) and said != value:
                yield f"{self._at(key)} is {said!r}, and not {value!r}"
        principal = self._described.get("NSPrincipalClass")
        if isinstance(principal, str) and not self._build.is_class(principal):
            yield f"{self._at('NSPrincipalClass')} is {principal}, which is no class"
