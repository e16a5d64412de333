"""Checks what a build for macOS has compiled: every source, and no name that nobody has."""
import os
import re
import subprocess

from .sources import named

SOURCE = (".cpp", ".mm", ".m", ".c")
# Sources for another system, and what they are for.
ELSEWHERE = (
    (re.compile(r"/gnustep[/.]"), "the toolkit of Linux"),
    (re.compile(r"/platform/freedesktop\.cpp$"), "the folders and programs of Linux"),
    (re.compile(r"/platform/Elf\w+\.cpp$"), "the kind of file that Linux loads"),
)
UNDEFINED = re.compile(r"undefined symbol: _(?:OBJC_CLASS_\$_)?([A-Za-z]\w*)$", re.MULTILINE)


def read_by_compiler(folder):
    """All files that have been read for what a build folder holds."""
    listed = subprocess.run(["ninja", "-C", folder, "-t", "deps"], capture_output=True, text=True, check=True)
    return {os.path.normpath(folder / line.strip()) for line in listed.stdout.splitlines() if line.startswith("    ")}


def left_out(read, files):
    """Of the sources among the files those that are for this system, and are not among what has been read."""
    for file in files:
        elsewhere = any(place.search(file.as_posix()) for place, _ in ELSEWHERE)
        if file.suffix in SOURCE and not elsewhere and str(file) not in read:
            yield f"{named(file)} is compiled by nothing for macOS"


def undefined(said, files):
    """Where the sources name what a linker has not found, as it says; it knows only the files that it links."""
    names = sorted(set(UNDEFINED.findall(said)))
    texts = {file: file.read_text(encoding="utf-8").splitlines() for file in files if names}
    for name in names:
        word = re.compile(rf"\b{name}\b")
        for file, lines in texts.items():
            for number, line in enumerate(lines, 1):
                if word.search(line):
                    yield f"{named(file)}:{number}: names {name}, which no library has"
