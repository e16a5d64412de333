"""Puts together what stands for Apple's SDK on Linux: headers and stubs, laid out as in the real one."""
import hashlib
import os
import shutil
import subprocess
from pathlib import Path

from . import fetched, stubs
from .declarations import Headers
from .listings import Listings
from .tables import Tables

HERE = Path(__file__).resolve().parent
MADE_BY = ("declarations", "fetched", "listings", "sdk", "stubs", "tables")
DECLARED = ("AppKit", "Foundation")  # from the tables; of the others a few functions are declared by hand
FRAMEWORKS = ("AppKit", "CoreFoundation", "CoreGraphics", "CoreServices", "Foundation")
LIBRARIES = "/System/Library/Frameworks/{0}.framework/Versions/A/{0}"
# Who links with one of these has the others too.
PASSED_ON = {"Cocoa": [LIBRARIES.format(name) for name in ("AppKit", "CoreFoundation", "CoreGraphics", "Foundation")],
             "Foundation": [LIBRARIES.format("CoreFoundation"), "/usr/lib/libobjc"]}
# What a Mac has from elsewhere. The headers are the same as here.
OTHERS = ("sqlite3", "icuuc", "icudata", "icui18n", "curl", "edit", "ecl", "gc", "crypto", "ssl", "deflate")
# Below /usr/include or its folder for this machine: what belongs to those libraries, and nothing else.
OTHER_HEADERS = ("sqlite3.h", "sqlite3ext.h", "unicode", "curl", "editline", "histedit.h", "ecl", "gc", "gc.h", "gmp.h", "CLI",
                 "atomic_ops", "atomic_ops.h",
                 "openssl", "libdeflate.h", "boost", "nlohmann")
CLI11 = """add_library(CLI11::CLI11 INTERFACE IMPORTED)
target_include_directories(CLI11::CLI11 INTERFACE "${CMAKE_CURRENT_LIST_DIR}/../../../include")
"""
NLOHMANN_JSON = """add_library(nlohmann_json::nlohmann_json INTERFACE IMPORTED)
target_include_directories(nlohmann_json::nlohmann_json INTERFACE "${CMAKE_CURRENT_LIST_DIR}/../../../include")
"""
BOOST = """set(Boost_locale_FOUND TRUE)
add_library(Boost::headers INTERFACE IMPORTED)
target_include_directories(Boost::headers INTERFACE "${CMAKE_CURRENT_LIST_DIR}/../../../include")
# This machine's Boost is older than a Mac's, and makes use of what newer C++ libraries have left out.
target_compile_definitions(Boost::headers INTERFACE _LIBCPP_ENABLE_CXX17_REMOVED_UNARY_BINARY_FUNCTION)
add_library(Boost::locale UNKNOWN IMPORTED)
set_target_properties(Boost::locale PROPERTIES INTERFACE_LINK_LIBRARIES Boost::headers
  IMPORTED_LOCATION "${CMAKE_CURRENT_LIST_DIR}/../../../lib/libboost_locale.tbd")
"""
# From its sources, which Debian has; Homebrew's comes with the same names.
GTEST = """set(sources "/usr/src/googletest")
add_library(gmock STATIC EXCLUDE_FROM_ALL "${sources}/googletest/src/gtest-all.cc" "${sources}/googlemock/src/gmock-all.cc")
target_include_directories(gmock SYSTEM PUBLIC "${sources}/googletest/include" "${sources}/googlemock/include"
  PRIVATE "${sources}/googletest" "${sources}/googlemock")
target_compile_options(gmock PRIVATE -w)
add_library(gmock_main STATIC EXCLUDE_FROM_ALL "${sources}/googlemock/src/gmock_main.cc")
target_link_libraries(gmock_main PUBLIC gmock)
add_library(GTest::gmock ALIAS gmock)
add_library(GTest::gmock_main ALIAS gmock_main)
"""
PACKAGES = {"sqlite3": "-lsqlite3", "icu-uc": "-licuuc -licudata", "libedit": "-ledit",
            "libdeflate": "-ldeflate"}


def section_of_tables(library):
    """The one section with the tables, out of a library for macOS."""
    data = library.read_bytes()
    place = data.index(b"__objc_metadata\0" * 2)  # section and segment have the same name
    size = int.from_bytes(data[place + 40:place + 48], "little")
    offset = int.from_bytes(data[place + 48:place + 52], "little")
    return data[offset:offset + size]


def read(folder):
    """(tables, listings) of what has been fetched."""
    return (Tables(section_of_tables(folder / "tables")), Listings(folder / "types", [*FRAMEWORKS, "Runtime"]))


def write(path, text):
    path.parent.mkdir(parents=True, exist_ok=True)
    path.write_text(text, encoding="utf-8")


def link(path, target):
    path.parent.mkdir(parents=True, exist_ok=True)
    path.symlink_to(target)


def link_all(path, sources):
    """One file, or all files of folders that a distribution keeps apart."""
    there = [source for source in sources if source.exists()]
    if not there:
        raise SystemExit(f"{path.name} is not on this machine; tools/setup installs what the build needs.")
    if len(there) == 1:
        link(path, there[0])
        return
    for source in there:
        for file in source.rglob("*"):
            if file.is_file():
                link(path / file.relative_to(source), file)


def found_here(name, places):
    for place in places:
        if (Path(place) / name).exists():
            return Path(place) / name
    raise SystemExit(f"{name} is not on this machine; tools/setup installs what the build needs.")


def machine():
    return subprocess.run(["gcc", "-print-multiarch"], capture_output=True, text=True, check=True).stdout.strip()


def put_headers(sdk, folder):
    include = sdk / "usr/include"
    for layer in ("any", "12", "arm64", "x86_64"):
        shutil.copytree(folder / "c" / layer, include, dirs_exist_ok=True)
    shutil.copytree(folder / "c++", include / "c++/v1")
    for name in OTHER_HEADERS:
        link_all(sdk / "usr/local/include" / name, [Path("/usr/include") / name, Path("/usr/include") / machine() / name])


def put_frameworks(sdk, tables, listings):
    text = Headers(tables, listings, DECLARED).text()
    for name in FRAMEWORKS:
        place = sdk / f"System/Library/Frameworks/{name}.framework"
        symbols, classes = stubs.framework_symbols(tables, listings.names[name])
        symbols |= set(stubs.CORE_FOUNDATION) if name == "CoreFoundation" else set()
        write(place / f"{name}.tbd", stubs.stub(LIBRARIES.format(name), symbols, classes, PASSED_ON.get(name, ())))
        link(place / f"Versions/A/{name}.tbd", f"../../{name}.tbd")  # where the linker looks for what others pass on
        shutil.copytree(HERE / "headers" / name, place / "Headers")
        for kind in ("class", "interface"):
            for entry in listings.names[name].get(kind, ()) if name in DECLARED else ():
                if not (place / "Headers" / f"{entry}.h").exists():
                    write(place / "Headers" / f"{entry}.h", f"#import <{name}/{name}.h>\n")
    write(sdk / "System/Library/Frameworks/Foundation.framework/Headers/SystemTables.h", text)
    write(sdk / "System/Library/Frameworks/Cocoa.framework/Cocoa.tbd",
          stubs.stub(LIBRARIES.format("Cocoa"), passed_on=PASSED_ON["Cocoa"]))


def put_libraries(sdk, folder, tables, listings):
    symbols, classes = stubs.framework_symbols(tables, listings.names["Runtime"])
    write(sdk / "usr/lib/libobjc.tbd", stubs.stub("/usr/lib/libobjc.A.dylib", symbols | set(stubs.OBJECTIVE_C), classes))
    shutil.copy(folder / "libSystem.tbd", sdk / "usr/lib/libSystem.tbd")
    places = (f"/usr/lib/{machine()}", "/usr/lib")
    cpp = set().union(*(stubs.exported_on_linux(found_here(f"lib{name}.so.1", places)) for name in ("c++", "c++abi")))
    write(sdk / "usr/lib/libc++.tbd", stubs.stub("/usr/lib/libc++.1.dylib", cpp | set(stubs.CPP_OF_A_MAC)))
    for name in OTHERS:
        symbols = stubs.exported_on_linux(found_here(f"lib{name}.so", places))
        write(sdk / f"usr/local/lib/lib{name}.tbd", stubs.stub(f"/usr/local/lib/lib{name}.dylib", symbols))
    write(sdk / "usr/local/lib/libboost_locale.tbd", stubs.stub("/usr/local/lib/libboost_locale.dylib", stubs.BOOST_LOCALE))
    for name, text in (("CLI11", CLI11), ("Boost", BOOST), ("nlohmann_json", NLOHMANN_JSON), ("GTest", GTEST)):
        write(sdk / f"usr/local/share/cmake/{name}/{name}Config.cmake", text)
    for name, libraries in PACKAGES.items():
        write(sdk / f"usr/local/lib/pkgconfig/{name}.pc",
              f"prefix=${{pcfiledir}}/../..\nName: {name}\nDescription: {name}\nVersion: 1\nLibs: -L${{prefix}}/lib {libraries}\n"
              f"Cflags: -I${{prefix}}/include{'/editline' if name == 'libedit' else ''}\n")


def state(folder):
    """What the SDK is made from, in one word."""
    sources = [*(HERE / f"{name}.py" for name in MADE_BY), *sorted(path for path in (HERE / "headers").rglob("*") if path.is_file())]
    words = [(folder / "complete").read_text(encoding="utf-8"), *(path.read_text(encoding="utf-8") for path in sources)]
    return hashlib.sha256("\0".join(words).encode()).hexdigest()


def make(build):
    """The SDK's folder, made again only when what it is made from has changed."""
    folder, sdk = build / "fetched", build / "MacOSX.sdk"
    fetched.fetch(folder)
    stamp, wanted = sdk / "complete", state(folder)
    if stamp.exists() and stamp.read_text(encoding="utf-8") == wanted:
        return sdk
    part = build / f"sdk.{os.getpid()}"
    shutil.rmtree(part, ignore_errors=True)
    tables, listings = read(folder)
    put_headers(part, folder)
    put_frameworks(part, tables, listings)
    put_libraries(part, folder, tables, listings)
    shutil.copytree(folder / "licences", part / "licences")
    write(part / "complete", wanted)
    shutil.rmtree(sdk, ignore_errors=True)
    part.rename(sdk)
    return sdk
