"""Checks what stands in a built program and its bundles beside code: AppKit reads only compiled layouts, and what a
description names has to be there."""
import plistlib

from . import binaries


def faults(app, layouts, languages):
    """Of the program's folder: each of the `layouts` (names) has to stand compiled somewhere in each of the languages."""
    yield from (f"{path.relative_to(app)}: no system of today reads a layout that is not compiled" for path in app.rglob("*.xib"))
    for layout in layouts:
        for language in languages:
            if not list(app.rglob(f"{language}.lproj/{layout}.nib")):
                yield f"{layout} is not there in {language}"


def described(folder):
    """Of what the descriptions in a folder name."""
    for description in sorted(folder.rglob("Info.plist")):
        try:
            said = plistlib.loads(description.read_bytes())
            icon, program = said.get("CFBundleIconFile"), said.get("CFBundleExecutable")
        except Exception:  # which is told by the check of descriptions
            continue
        if icon and not (description.parent / f"Resources/{icon}.icns").exists():
            yield f"{description.relative_to(folder)}: there is no icon {icon}"
        if program and not binaries.is_linked(description.parent / f"MacOS/{program}"):
            yield f"{description.relative_to(folder)}: there is no program {program}"
