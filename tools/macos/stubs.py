"""Writes what stands for the system's libraries when programs for macOS are linked on Linux: text files that list the
symbols of each. What the tables do not know is listed here, or taken from the Linux library of the same origin."""
import subprocess

TARGETS = "[ x86_64-macos, arm64-macos ]"
# The functions that compilers call for Objective-C stand in no header.
OBJECTIVE_C = """_objc_msgSend _objc_msgSendSuper2 _objc_msgSendSuper _objc_msgSend_stret _objc_msgSendSuper2_stret
_objc_msgSend_fpret __objc_empty_cache __objc_empty_vtable ___objc_personality_v0 _objc_begin_catch _objc_end_catch
_objc_exception_throw _objc_exception_rethrow _OBJC_EHTYPE_id _objc_ehtype_vtable _objc_retain _objc_release _objc_autorelease
_objc_alloc _objc_alloc_init _objc_allocWithZone _objc_opt_class _objc_opt_new _objc_opt_self _objc_opt_isKindOfClass
_objc_opt_respondsToSelector _objc_setProperty_nonatomic _objc_setProperty_atomic _objc_setProperty_nonatomic_copy
_objc_setProperty_atomic_copy _objc_setProperty _objc_getProperty _objc_copyStruct _objc_enumerationMutation
_objc_sync_enter _objc_sync_exit _objc_autoreleasePoolPush _objc_autoreleasePoolPop _objc_retainAutoreleasedReturnValue
_objc_autoreleaseReturnValue _objc_storeStrong""".split()
# Of libraries in C++ the symbols here are spelt otherwise, after another C++ library: those that we call.
BOOST_LOCALE = [
    "__ZN5boost6locale11gnu_gettext21create_messages_facetIcEEPNS0_14message_formatIT_EERKNS1_13messages_infoE",
    "__ZN5boost6locale19base_message_formatIcE2idE",
]
# What the C++ library of Linux has for another kind of number.
CPP_OF_A_MAC = ["__ZNSt3__120__libcpp_atomic_waitEPVKvx"]
CORE_FOUNDATION = ["___CFConstantStringClassReference"]


def stub(name, symbols=(), classes=(), passed_on=()):
    """The text of a stub. `name`: where the system has the library. `passed_on`: libraries whose symbols count as its own."""
    lines = ["--- !tapi-tbd", "tbd-version: 4", f"targets: {TARGETS}", f"install-name: '{name}'", "current-version: 1",
             "compatibility-version: 1"]
    if passed_on:
        others = ", ".join(f"'{other}'" for other in passed_on)
        lines += ["reexported-libraries:", f"  - targets: {TARGETS}", f"    libraries: [ {others} ]"]
    if symbols or classes:
        lines += ["exports:", f"  - targets: {TARGETS}"]
        if symbols:
            lines.append("    symbols: [ " + ", ".join(f"'{symbol}'" for symbol in sorted(symbols)) + " ]")
        if classes:
            lines.append("    objc-classes: [ " + ", ".join(sorted(classes)) + " ]")
    return "\n".join([*lines, "...", ""])


def exported_on_linux(library, program="llvm-nm"):
    """The symbols of a Linux library, as a Mach-O one would spell them."""
    listed = subprocess.run([program, "--dynamic", "--defined-only", "--just-symbol-name", library], capture_output=True,
                            text=True, check=True)
    return {"_" + name.split("@")[0] for name in listed.stdout.split()}


def framework_symbols(tables, names):
    """(symbols, classes) of a framework, of whose names the tables know which are symbols."""
    symbols = {"_" + name for name in names.get("const", ()) if name in tables.constants}
    symbols |= {"_" + name for name in names.get("function", ()) if name in tables.functions}
    return symbols, {name for name in names.get("class", ()) if name in tables.classes}
