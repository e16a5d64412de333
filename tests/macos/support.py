"""What the tests of the checks share: the tables, read once, and the compiler with what stands for Apple's SDK."""
import functools
import subprocess
import sys
import tempfile
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "tools"))

from macos import binaries, sdk  # noqa: E402

BUILD = ROOT / "build/macos"


@functools.cache
def tables_and_listings():
    return sdk.read(BUILD / "fetched")


def tables():
    return tables_and_listings()[0]


def write_files(folder, texts):
    """name -> text: the paths of the files."""
    paths = []
    for name, text in texts.items():
        paths.append(Path(folder) / name)
        paths[-1].write_text(text, encoding="utf-8")
    return paths


def clang(text, *options, name="source.mm"):
    """What the compiler for macOS says of a source, and whether it takes it."""
    with tempfile.TemporaryDirectory() as folder:
        source, = write_files(folder, {name: text})
        words = [binaries.program("clang++"), "-target", "arm64-apple-macos12.0", "-isysroot", BUILD / "MacOSX.sdk",
                 "-stdlib=libc++", "-std=c++20", "-D_LIBCPP_ABI_VERSION=1", "-D_LIBCPP_ABI_NAMESPACE=__1", "-fuse-ld=lld",
                 "-Wno-unused-command-line-argument",
                 "-Wall", "-Wextra", "-Werror", "-Wundeclared-selector", *options, source]
        done = subprocess.run([str(word) for word in words], capture_output=True, text=True, check=False)
        return done.returncode == 0, done.stderr
