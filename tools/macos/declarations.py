"""Writes headers from Apple's tables: every class and protocol of Foundation and AppKit with its methods, and the
functions, constants and enumerations. With them a compiler knows which class answers to which message, as on a Mac.

Some of what the system's own headers say is not in the tables: which texts and pointers may be changed, which methods of
a protocol have to be there, and what is out of use. Here no method has to be there, pointers that a class is given are
`const`, and OUT_OF_USE lists what we call all the same.
"""
import re

from .listings import script_name
from .tables import Kind

PLAIN = {
    Kind.CHAR: "char", Kind.INT: "int", Kind.SHORT: "short", Kind.LONG: "NSInteger", Kind.UNSIGNED_INT: "unsigned int",
    Kind.UNSIGNED_SHORT: "unichar", Kind.UNSIGNED_LONG: "NSUInteger", Kind.FLOAT: "float", Kind.DOUBLE: "double",
    Kind.BYTE: "unsigned char", Kind.VOID: "void", Kind.TEXT: "const char *", Kind.OBJECT: "id",
    Kind.SAME_CLASS: "instancetype", Kind.STRING: "NSString *", Kind.MUTABLE_STRING: "NSMutableString *",
    Kind.CLASS: "Class", Kind.SELECTOR: "SEL", Kind.BOOLEAN: "BOOL",
}
NUMBERS = (Kind.LONG, Kind.UNSIGNED_LONG)
# The tables leave out how the names of an enumeration's members begin: like its own, without an ending that says what it
# is, or as here.
ENDING = re.compile(r"(Behavior|Flags|Format|Mask|Mode|Operation|Options?|Order|Policy|Position|State|Style|Types?|Value)$")
MEMBERS_BEGIN = {
    "NSAutoresizingMaskOptions": "NSView", "NSComparisonResult": "NSOrdered", "NSLineBreakMode": "NSLineBreakBy",
    "NSPropertyListMutabilityOptions": "NSPropertyList", "NSWindowOrderingMode": "NSWindow",
}
# Values that can be combined are whole numbers in C++; all others are of a type of their own.
COMBINED = re.compile(r"(Options|Mask|Flags|Traits|Actions)$|^NSDragOperation$")
# The headers beside this file have these.
BY_HAND = {"NSNotFound", "NSZeroPoint", "NSZeroSize", "NSZeroRect", "NSAppKitVersionNumber"}
# What we call though the system's headers say, since when, that it should not be called any more.
OUT_OF_USE = {
    "setDirectory:": "10.6", "directory": "10.6", "filenames": "10.6", "panel:shouldShowFilename:": "10.6",
    "FSPathMakeRef": "10.8", "NSFilenamesPboardType": "10.14", "NSAnyEventMask": "10.12", "NSApplicationDefined": "10.12",
    "NSClosableWindowMask": "10.12", "NSKeyDownMask": "10.12", "NSLeftMouseDown": "10.12", "NSLeftMouseUp": "10.12",
    "NSRoundedBezelStyle": "10.14", "NSShiftKeyMask": "10.12", "NSTitledWindowMask": "10.12",
}


class Headers:
    """The declarations of some frameworks, all in one file."""

    def __init__(self, tables, listings, frameworks):
        self._tables, self._listings, self._frameworks = tables, listings, frameworks
        self._classes_named, self._protocols_named, self._structs_named, self._enums_named = set(), set(), set(), set()
        self._members_named = self._listed("const")

    def text(self):
        classes, protocols = self._members()
        contracts = [self._protocol(name) for name in self._lowest_first(protocols, self._protocol_depth)]
        bodies = [self._class(name) for name in self._lowest_first(classes, self._class_depth)]
        rest = [*self._constants(), *self._functions()]
        self._enums_named |= self._listed("const") & set(self._tables.enums)
        return "\n".join(["#pragma once", *self._named(classes, protocols), *map(self._enum, sorted(self._enums_named)),
                          *self._enum_constants(), *contracts, *bodies, *rest, ""])

    def _listed(self, kind):
        return set().union(*(self._listings.names[framework].get(kind, set()) for framework in self._frameworks))

    def _members(self):
        listed = self._listed("class") | self._listed("interface")
        classes = {name for name in listed if name in self._tables.classes}
        for name in list(classes):
            while name := self._tables.classes[name].parent:
                classes.add(name)
        protocols = {name for name in self._tables.protocols if name in listed or f"{name}Protocol" in listed}
        protocols.update(*(self._tables.classes[name].protocols for name in classes))
        todo = list(protocols)
        while todo:
            more = set(self._tables.protocols[todo.pop()].protocols) - protocols
            protocols |= more
            todo += more
        return classes, protocols

    def _class_depth(self, name):
        parent = self._tables.classes[name].parent
        return 1 + self._class_depth(parent) if parent else 0

    def _protocol_depth(self, name):
        return 1 + max(map(self._protocol_depth, self._tables.protocols[name].protocols), default=0)

    @staticmethod
    def _lowest_first(names, depth):
        return sorted(names, key=lambda name: (depth(name), name))

    def _named(self, classes, protocols):
        yield from (f"@class {name};" for name in sorted(classes | self._classes_named))
        yield from (f"@protocol {name};" for name in sorted(protocols | self._protocols_named))
        yield from (f"struct {name};" for name in sorted(self._structs_named))

    def _class(self, name):
        entry = self._tables.classes[name]
        root = "" if entry.parent else "__attribute__((objc_root_class))\n"
        parent = f" : {entry.parent}" if entry.parent else ""
        protocols = f" <{', '.join(entry.protocols)}>" if entry.protocols else ""
        fields = "\n{\n    Class isa;\n}" if root else ""
        methods = "\n".join(self._method(name, method, True) for method in entry.methods)
        return f"{root}@interface {name}{parent}{protocols}{fields}\n{methods}\n@end"

    def _protocol(self, name):
        entry = self._tables.protocols[name]
        protocols = f" <{', '.join(entry.protocols)}>" if entry.protocols else ""
        methods = "\n".join(self._method(name, method, False) for method in entry.methods)
        return f"@protocol {name}{protocols}\n@optional\n{methods}\n@end"

    def _method(self, owner, method, constant):
        words = method.selector.split(":")[:-1]
        result_enum, enums = self._enums_of(owner, method.selector, len(words))
        result = self._result(method.signature.result, method.selector, result_enum)
        given = [self._type(argument, enum, constant and (argument.kind != Kind.ANY_POINTER or "ytes" in word))
                 for word, argument, enum in zip(words, method.signature.arguments, enums)]
        if method.signature.more:  # then the tables leave out those that are always given
            given = ["NSString *" if word.endswith("ormat") else "id" for word in words]
        parts = [f"{word}:({kind})a{place}" for place, (word, kind) in enumerate(zip(words, given))]
        return (f"{'+' if method.of_class else '-'} ({result}){' '.join(parts) or method.selector}"
                f"{self._more(method, words)}{self._out(method.selector)};")

    @staticmethod
    def _more(method, words):
        if not method.signature.more:
            return ""
        if words[-1].endswith("ormat"):
            return f", ... __attribute__((format(__NSString__, {len(words)}, {len(words) + 1})))"
        return ", ... NS_REQUIRES_NIL_TERMINATION" if "bjects" in words[-1] else ", ..."

    def _enums_of(self, owner, selector, count):
        for name in (owner, f"{owner}Protocol"):
            found = self._listings.enums.get((name, script_name(selector)))
            if found and len(found[1]) == count:
                return found
        # A property: what it is of, and what its setter takes.
        if count == 0 and (found := self._listings.enums.get((owner, re.sub("^is(.)", lambda m: m[1].lower(), selector)))):
            return found[0], []
        return None, [None] * count

    def _result(self, kind, selector, enum):
        if kind.kind == Kind.BYTE and "nsigned" not in selector:
            return "BOOL"  # the tables take either for the other where nothing else goes in or out
        if kind.kind == Kind.ANY_POINTER and selector == "bytes":
            return "const void *"
        return "id" if kind.kind == Kind.BLOCK else self._type(kind, enum, False)

    def _type(self, kind, enum, constant):
        if enum in self._tables.enums and kind.kind in NUMBERS:
            self._enums_named.add(enum)
            return enum
        if kind.kind in PLAIN:
            return PLAIN[kind.kind]
        if kind.kind == Kind.ANY_POINTER:
            return "const void *" if constant else "void *"
        if kind.kind in (Kind.POINTER, Kind.ARRAY):
            return self._pointer(kind.inner, constant)
        if kind.kind in (Kind.OBJECT_OF_CLASS, Kind.OBJECT_OF_PROTOCOLS):
            return self._object(kind)
        if kind.kind == Kind.STRUCT:
            return self._struct(kind.name)
        if kind.kind in (Kind.BLOCK, Kind.FUNCTION):
            signature = self._tables.signature(kind.signature)
            given = ", ".join(self._type(argument, None, False) for argument in signature.arguments)
            return f"{self._result(signature.result, '', None)} ({'^' if kind.kind == Kind.BLOCK else '*'})({given or 'void'})"
        return "void *"  # vectors

    def _pointer(self, inner, constant):
        if inner.kind in (Kind.BLOCK, Kind.FUNCTION, Kind.SAME_CLASS):
            return "void *"
        text = self._type(inner, None, False)
        plain = inner.kind in PLAIN and inner.kind not in (Kind.OBJECT, Kind.STRING, Kind.MUTABLE_STRING, Kind.TEXT)
        return f"{'const ' if constant and (plain or inner.kind == Kind.STRUCT) else ''}{text} *"

    def _object(self, kind):
        self._protocols_named.update(kind.protocols)
        protocols = f"<{', '.join(kind.protocols)}>" if kind.protocols else ""
        if kind.kind == Kind.OBJECT_OF_PROTOCOLS:
            return f"id{protocols}"
        self._classes_named.add(kind.name)
        return f"{kind.name}{protocols} *"

    def _struct(self, name):
        if not name.isidentifier() or name.startswith("unnamed"):
            return "struct unnamed"
        self._structs_named.add(name)
        return f"struct {name}"

    def _enum(self, name):
        members = {}
        for begin in self._begins(name):
            for member, value in self._tables.enums[name].items():
                full = member if member.startswith("NS") else begin + member
                if full not in self._members_named:  # two enumerations may have one word
                    self._members_named.add(full)
                    members[full] = value
        text = ", ".join(f"{member} = {self._value(value)}" for member, value in members.items())
        if COMBINED.search(name):
            return f"typedef NSUInteger {name};\nenum : NSUInteger {{ {text} }};"
        return f"typedef enum {name} : NSInteger {{ {text} }} {name};"

    @staticmethod
    def _begins(name):
        if name in MEMBERS_BEGIN:
            return [MEMBERS_BEGIN[name]]
        return dict.fromkeys([name, name.removesuffix("s"), ENDING.sub("", name)])

    @staticmethod
    def _value(value):
        return f"(-{-(value + 1)} - 1)" if value < 0 else str(value)

    def _enum_constants(self):
        for name, enum in sorted(self._listings.enum_constants.items()):
            if name in self._tables.values and enum in self._enums_named:
                yield f"static const {enum} {name}{self._out(name)} = ({enum}){self._value(self._tables.values[name])};"

    @staticmethod
    def _out(name):
        return f' __attribute__((deprecated("since {OUT_OF_USE[name]}")))' if name in OUT_OF_USE else ""

    def _constants(self):
        for name in sorted(self._listed("const") - BY_HAND - set(self._listings.enum_constants)):
            if name in self._tables.constants:
                kind = self._type(self._tables.constants[name], None, False)
                yield f'FOUNDATION_EXPORT {kind} const {name}{self._out(name)};' if "(" not in kind else ""
            elif isinstance(self._tables.values.get(name), int):
                yield f"static const NSInteger {name}{self._out(name)} = {self._value(self._tables.values[name])};"
            elif isinstance(self._tables.values.get(name), float):
                yield f"static const double {name} = {self._tables.values[name]!r};"

    def _functions(self):
        for name in sorted(self._listed("function")):
            signature = self._tables.functions.get(name)
            if signature is None or signature.more:
                continue
            given = ", ".join(self._type(kind, None, True) for kind in signature.arguments) or "void"
            result = self._result(signature.result, name, None)
            if "(" not in result:
                yield f'FOUNDATION_EXPORT {result} {name}({given}){self._out(name)};'
