"""Reads Apple's tables of classes, protocols, functions, constants and enumerations.

They stand in one section of a library that bridges JavaScript to the system and were made by its authors from the
system's own headers: each class with its parent, its protocols and every method, by selector, with the types that go in
and out. The offsets in the section count from the beginning of the part that they point into.
"""
import struct
from dataclasses import dataclass, field
from enum import IntEnum

NEXT = 0x80000000  # in a number of four bytes: another of its list follows, or what belongs to it does
NONE = 0x7FFFFFFF


class Kind(IntEnum):
    """What a type is. Enumerations count as whole numbers here, typed pointers to `char` as texts."""
    CHAR, INT, SHORT, LONG = 0x00, 0x01, 0x02, 0x04
    UNSIGNED_INT, UNSIGNED_SHORT, UNSIGNED_LONG = 0x06, 0x07, 0x09
    FLOAT, DOUBLE, BYTE, VOID, TEXT, OBJECT = 0x0A, 0x0B, 0x0C, 0x0D, 0x0E, 0x0F
    OBJECT_OF_PROTOCOLS, OBJECT_OF_CLASS, SAME_CLASS, STRING, MUTABLE_STRING, CLASS, SELECTOR = 0x10, 0x11, 0x12, 0x13, 0x14, 0x15, 0x16
    ARRAY, STRUCT, POINTER, ANY_POINTER, FUNCTION, BOOLEAN, BLOCK = 0x17, 0x18, 0x19, 0x1A, 0x1B, 0x1C, 0x1D


@dataclass
class Type:
    kind: int
    name: str = ""  # of a class or a structure
    protocols: list = field(default_factory=list)
    inner: "Type | None" = None  # what a pointer points to, what an array is of
    signature: int = 0  # of a block or a function: what `Tables.signature` takes


@dataclass
class Signature:
    result: Type
    arguments: list
    more: bool  # whether further arguments may follow


@dataclass
class Method:
    selector: str
    of_class: bool
    signature: Signature


@dataclass
class Class:
    name: str
    parent: str  # empty for a root
    protocols: list
    methods: list


@dataclass
class Protocol:
    name: str
    protocols: list
    methods: list


class Tables:
    """`constants`: name -> type, of those that are symbols. `values`: name -> value, of the others."""

    def __init__(self, section):
        self._data = section
        if section[:4] != b"NSMD":
            raise ValueError("these are not the tables of classes")
        (self._constants, self._enums, self._signatures, self._functions, self._protocols, self._classes, self._structs,
         self._unions) = struct.unpack_from("<8I", section, 6)
        self._texts = 38
        self._known, self._read_signatures = {}, {}
        self.enums = dict(self._read_enums())
        self.constants, self.values = self._read_constants()
        self._read_structs()
        raw_protocols, raw_classes = self._read_protocols(), self._read_classes()
        self._class_names = {place: entry[0] for place, entry in raw_classes.items()}
        names = set(self._class_names.values())
        # A protocol that is called like a class has a word added in the tables.
        self._protocol_names = {place: self._own_name(entry[0], names) for place, entry in raw_protocols.items()}
        self.protocols = {self._protocol_names[place]: Protocol(self._protocol_names[place], self._names_of(entry[1]),
                                                                self._methods(entry[2]))
                          for place, entry in raw_protocols.items()}
        self.classes = {name: Class(name, self._class_names.get(parent, ""), self._names_of(protocols),
                                    self._methods(members))
                        for name, protocols, parent, members in raw_classes.values()}
        self.functions = {name: self.signature(place) for name, place in self._read_functions()}
        self.constants = {name: self._type(place)[0] for name, place in self.constants.items()}

    def answers(self, name, selector, of_class):
        """Whether the class, one of its parents or of their protocols has the method."""
        while name:
            entry = self.classes[name]
            if (selector, of_class) in self._selectors(name):
                return True
            name = entry.parent
        return False

    def protocol_methods(self, name):
        """The selectors of a protocol and of those it takes in."""
        entry = self.protocols[name]
        found = {method.selector for method in entry.methods}
        return found.union(*(self.protocol_methods(other) for other in entry.protocols))

    def _selectors(self, name):
        if name not in self._known:
            entry = self.classes[name]
            known = {(method.selector, method.of_class) for method in entry.methods}
            for protocol in entry.protocols:
                known |= {(selector, False) for selector in self.protocol_methods(protocol)}
            self._known[name] = known
        return self._known[name]

    @staticmethod
    def _own_name(name, class_names):
        stem = name.removesuffix("Protocol")
        return stem if stem in class_names else name

    def _names_of(self, places):
        return [self._protocol_names[place] for place in places]

    def _number(self, place):
        return struct.unpack_from("<I", self._data, place)[0]

    def _text(self, offset):
        start = self._texts + (offset & ~NEXT)
        return self._data[start:self._data.index(b"\0", start)].decode("utf-8")

    def _list(self, place):
        numbers = []
        while True:
            number = self._number(place)
            place += 4
            numbers.append(number & ~NEXT)
            if not number & NEXT:
                return numbers, place

    def _read_enums(self):
        place = self._enums
        while place < self._signatures:
            name, members, more = self._text(self._number(place)), {}, True
            place += 4
            while more:
                number, value = struct.unpack_from("<Iq", self._data, place)
                members[self._text(number)] = value
                place += 12
                more = number & NEXT
            yield name, members

    def _read_constants(self):
        symbols, values, place = {}, {}, self._constants
        while place < self._enums:
            name, how = self._text(self._number(place)), self._data[place + 4]
            place += 5
            if how == 0:
                symbols[name] = place
                place = self._skip_type(place)
            elif how == 1:
                values[name] = struct.unpack_from("<q", self._data, place)[0]
                place += 8
            elif how == 2:
                values[name] = struct.unpack_from("<d", self._data, place)[0]
                place += 8
            elif how == 3:  # the value is cut
                values[name] = ""
                place += 4
            else:
                raise ValueError(f"the constant {name} is of a kind that is not known: {how}")
        return symbols, values

    def _read_structs(self):
        """The names of structures by their place; what is in them is not needed."""
        self._struct_names, place = {}, self._structs
        while place < self._unions:
            self._struct_names[place - self._structs] = self._text(self._number(place))
            place, more = place + 6, True
            while more:
                member = self._number(place)
                more = member & NEXT
                place = place + 4 if member == NONE else self._skip_type(place + 6)

    def _read_functions(self):
        for place in range(self._functions, self._protocols, 8):
            yield self._text(self._number(place)), self._number(place + 4)

    def _read_protocols(self):
        entries, place = {}, self._protocols
        while place < self._classes:
            start, name, others = place - self._protocols, self._number(place), []
            place += 4
            if name & NEXT:
                others, place = self._list(place)
            members, place = self._members(place)
            entries[start] = (self._text(name), others, members)
        return entries

    def _read_classes(self):
        entries, place = {}, self._classes
        while place < self._structs:
            start, name, protocols, members = place - self._classes, self._number(place), [], []
            place += 8
            if name & NEXT:
                protocols, place = self._list(place)
            parent = self._number(place)
            place += 4
            if parent & NEXT:
                members, place = self._members(place)
            entries[start] = (self._text(name), protocols, parent & ~NEXT, members)
        return entries

    def _members(self, place):
        """[(selector, whether it is the class's, place of the signature)] of methods and of properties."""
        members, more = [], True
        while more:
            flags = self._data[place]
            place, more, of_class = place + 1, flags & 0x80, bool(flags & 0x08)
            if flags & 0x01:
                members.append((self._text(self._number(place + 4)), of_class, self._number(place + 8)))
                place += 12
                if not flags & 0x02:
                    members.append((self._text(self._number(place)), of_class, self._number(place + 4)))
                    place += 8
            elif flags & 0x10:
                members.append((self._text(self._number(place)), of_class, self._number(place + 4)))
                place += 8
        return members, place

    def _methods(self, members):
        methods = {}
        for selector, of_class, place in members:
            methods.setdefault((selector, of_class), Method(selector, of_class, self.signature(place)))
        return list(methods.values())

    def signature(self, offset):
        """Most methods share theirs with others."""
        if offset not in self._read_signatures:
            self._read_signatures[offset] = self._read_signature(offset)
        return self._read_signatures[offset]

    def _read_signature(self, offset):
        place, types, further, more = self._signatures + offset, [], False, True
        while more:
            flags = self._data[place]
            further, more = further or bool(flags & 0x40), flags & 0x80
            read, place = self._type(place)
            types.append(read)
        return Signature(types[0], types[1:], further)

    def _skip_type(self, place):
        kind = self._data[place] & 0x3F
        place += 1
        if kind in (Kind.ARRAY, Kind.POINTER):
            return self._skip_type(place + (2 if kind == Kind.ARRAY else 0))
        if kind in (Kind.OBJECT_OF_PROTOCOLS, Kind.OBJECT_OF_CLASS):
            return self._list(place)[1]
        return place + 4 if kind in (Kind.STRUCT, Kind.BLOCK, Kind.FUNCTION) else place

    def _type(self, place):
        kind = self._data[place] & 0x3F
        place += 1
        if kind == Kind.ARRAY:
            inner, place = self._type(place + 2)
            return Type(kind, inner=inner), place
        if kind == Kind.POINTER:
            inner, place = self._type(place)
            return Type(kind, inner=inner), place
        if kind == Kind.OBJECT_OF_PROTOCOLS:
            places, place = self._list(place)
            return Type(kind, protocols=self._names_of(places)), place
        if kind == Kind.OBJECT_OF_CLASS:
            places, place = self._list(place)
            return Type(kind, name=self._class_names[places[0]], protocols=self._names_of(places[1:])), place
        if kind == Kind.STRUCT:
            return Type(kind, name=self._struct_names.get(self._number(place), "")), place + 4
        if kind in (Kind.BLOCK, Kind.FUNCTION):
            return Type(kind, signature=self._number(place)), place + 4
        return Type(kind), place
