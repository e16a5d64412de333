"""Checks property lists that describe a program or a bundle: what the system asks for is there, and of the right kind."""
import plistlib
import re

VERSION = re.compile(r"\d+(\.\d+){0,2}$")
IDENTIFIER = re.compile(r"[A-Za-z0-9-]+(\.[A-Za-z0-9-]+)+$")
ANY_TEXT = re.compile(r".+")
BOTH = {
    "CFBundleDevelopmentRegion": ANY_TEXT, "CFBundleExecutable": ANY_TEXT, "CFBundleIdentifier": IDENTIFIER,
    "CFBundleInfoDictionaryVersion": re.compile(r"6\.0$"), "CFBundleName": ANY_TEXT,
    "CFBundlePackageType": re.compile(r"(APPL|BNDL)$"), "CFBundleShortVersionString": VERSION, "CFBundleVersion": VERSION,
    "LSMinimumSystemVersion": VERSION,
}
PROGRAM = {"CFBundleIconFile": ANY_TEXT, "NSPrincipalClass": ANY_TEXT}
SWITCHES = {"NSHighResolutionCapable"}


def faults(name, data, system):
    """Of a property list's bytes. `system`: the oldest version that the build is for."""
    try:
        described = plistlib.loads(data)
    except Exception as error:  # whatever the parser has to say
        yield f"{name}: is no property list: {error}"
        return
    wanted = BOTH | (PROGRAM if described.get("CFBundlePackageType") == "APPL" else {})
    for key, form in wanted.items():
        value = described.get(key)
        if value is None:
            yield f"{name}: {key} is not there"
        elif not isinstance(value, str) or not form.match(value):
            yield f"{name}: {key} is {value!r}"
    for key in SWITCHES if described.get("CFBundlePackageType") == "APPL" else ():
        if described.get(key) is not True:
            yield f"{name}: {key} is not switched on"
    if described.get("LSMinimumSystemVersion", system) != system:
        yield f"{name}: LSMinimumSystemVersion is not {system}, which the build is for"
