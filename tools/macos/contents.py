"""Checks what stands in a built program and its bundles beside code: AppKit reads only compiled layouts, and what a
description names has to be there."""
import plistlib


def faults(app, layouts, languages):
    """Of the program's folder: each of the `layouts` (names) has to stand compiled somewhere in each of the languages."""
    yield from (f"{path.relative_to(app)}: no system of today reads a layout that is not compiled" for path in app.rglob("*.xib"))
    for layout in layouts:
        for language in languages:
            if not list(app.rglob(f"{language}.lproj/{layout}.nib")):
                yield f"{layout} is not there in {language}"
    for description in app.rglob("Info.plist"):
        icon = plistlib.loads(description.read_bytes()).get("CFBundleIconFile")
        if icon and not (description.parent / f"Resources/{icon}.icns").exists():
            yield f"{description.relative_to(app)}: there is no icon {icon}"
