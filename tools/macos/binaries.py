"""Checks what has been linked for macOS: processors, what is exported, and from which version of the system on it runs."""
import re
import shutil
import struct
import subprocess

MAGIC, BUNDLE = 0xFEEDFACF, 8  # of a file for one processor of 64 bits


def program(name):
    """Where a program of LLVM's is, which may have its version in its name."""
    found = shutil.which(name) or shutil.which(f"{name}-14")
    if not found:
        raise SystemExit(f"{name} is missing: tools/setup installs it")
    return found


def run(name, *words):
    return subprocess.run([program(name), *(str(word) for word in words)], capture_output=True, text=True, check=True).stdout


def header(file):
    """The beginning of a file as numbers, or nothing where it has none."""
    if file.is_symlink() or not file.is_file():
        return ()
    with file.open("rb") as stream:
        data = stream.read(16)
    return struct.unpack("<4I", data) if len(data) == 16 else ()


def is_linked(file):
    return header(file)[:1] == (MAGIC,)


def is_module(file):
    """Whether it is mapped by a program that calls its entry point."""
    return header(file)[3:] == (BUNDLE,)


def join(parts, whole):
    """One universal file of one for each processor."""
    whole.parent.mkdir(parents=True, exist_ok=True)
    run("llvm-lipo", "-create", *parts, "-output", whole)


def processors(file):
    return set(run("llvm-lipo", "-archs", file).split())


def exported(file, processor):
    listed = run("llvm-nm", f"--arch={processor}", "--extern-only", "--defined-only", "--just-symbol-name", file)
    return {word for word in listed.split() if word.startswith("_") and word not in ("__mh_bundle_header", "__mh_execute_header")}


def found_nowhere(file, processor):
    """What a linker that was told to leave it to the system has not looked for in any library."""
    listed = run("llvm-nm", f"--arch={processor}", "-m", "--undefined-only", file)
    return sorted(line.split()[-4] for line in listed.splitlines() if line.endswith("(dynamically looked up)"))


def exports(file, processor, wanted):
    symbols = exported(file, processor)
    yield from (f"{file.name} exports {symbol}, for {processor}, which it should not" for symbol in sorted(symbols - wanted))
    yield from (f"{file.name} does not export {symbol}, for {processor}" for symbol in sorted(wanted - symbols))


def load_commands(file, processor):
    return run("llvm-objdump", "--macho", f"--arch={processor}", "--private-headers", file)


def foreign_places(commands):
    """Where a file looks for libraries, and what it calls itself, beyond places of the system and those from where it stands."""
    named = re.findall(r"cmd LC_(?:RPATH|LOAD_DYLIB|ID_DYLIB)\n.*\n\s*(?:path|name) (\S+)", commands)
    return [place for place in named if not place.startswith(("@rpath/", "@loader_path", "/usr/", "/System/"))]


def oldest_system(commands):
    found = re.search(r"cmd LC_BUILD_VERSION\n(?:.*\n)*?\s*minos (\S+)", commands)
    return found.group(1) if found else "none"


def faults(file, wanted, system):
    """`wanted`: the symbols that it exports, or None when any will do. `system`: the oldest version that it is built for."""
    halves = processors(file)
    for processor in ("arm64", "x86_64"):
        if processor not in halves:
            yield f"{file.name} has no half for {processor}"
            continue
        yield from exports(file, processor, wanted) if wanted is not None else ()
        yield from (f"{file.name} calls {symbol}, for {processor}, which no library has" for symbol in found_nowhere(file, processor))
        commands = load_commands(file, processor)
        yield from (f"{file.name} cannot be moved, for {processor}: {place}" for place in foreign_places(commands))
        oldest = oldest_system(commands)
        if oldest != system:
            yield f"{file.name} runs from macOS {oldest} on, for {processor}, and not {system}"
