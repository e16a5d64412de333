"""Checks a window's layout (XIB): what it connects has to be there, in the layout, in our sources or in the system, and
what a person works with has to be connected and named."""
import xml.etree.ElementTree as ElementTree
from xml.parsers import expat

from .bindings import bindings_of
from .classes import Classes
from .sources import named, setter
from .voiceover import is_silent

OWNER, FIRST_RESPONDER, APPLICATION = "-2", "-1", "-3"
CONNECTIONS = ("outlet", "action", "binding")
# Elements whose class the system spells otherwise.
CLASSES = {"customView": "NSView", "customObject": "NSObject"}
# Attributes that name another element.
REFERENCES = ("selectedItem", "headerView", "cornerView", "previousBinding", "firstItem", "secondItem", "initialItem")
# Without these nothing is shown.
SHOWN_BY = {"NSViewController": "view", "NSWindowController": "window"}
# What a person presses, and the bindings by which such a thing does something without an action.
PRESSED = ("NSButton", "NSSegmentedControl", "NSSlider", "NSStepper")
TAKEN_BY_BINDING = {"value", "selectedIndex", "selectedLabel", "selectedObject", "selectedTag", "selectedValue", "target"}


def parsed(path):
    """(the root, element -> line)"""
    builder, parser, lines = ElementTree.TreeBuilder(), expat.ParserCreate(), {}

    def begin(tag, attributes):
        lines[builder.start(tag, attributes)] = parser.CurrentLineNumber

    parser.StartElementHandler, parser.EndElementHandler, parser.CharacterDataHandler = begin, builder.end, builder.data
    parser.Parse(path.read_bytes(), True)
    return builder.close(), lines


class Layout:
    def __init__(self, path, sources, tables):
        self._path, self._sources, self._tables = path, sources, tables
        self._classes = Classes(sources, tables)
        self._elements, self._faults = {}, []

    def faults(self):
        try:
            self._root, self._lines = parsed(self._path)
        except expat.ExpatError as error:
            return [f"{named(self._path)}:{error.lineno}: is no layout: {expat.ErrorString(error.code)}"]
        self._number()
        for element in self._root.iter():
            self._check_element(element)
            for connection in element.findall("connections/*"):
                self._check_connection(element, connection)
        return self._faults

    def _fault(self, element, text):
        who = f"{element.get('id')} ({element.tag})" if element.get("id") else element.tag
        self._faults.append(f"{named(self._path)}:{self._lines[element]}: {who} {text}")

    def _number(self):
        for element in self._root.iter():
            name = element.get("id")
            if name is None:
                continue
            if name in self._elements:
                self._fault(element, "stands there twice")
            self._elements[name] = element

    def _class_of(self, element):
        custom = element.get("customClass")
        return custom if custom and self._classes.is_known(custom) else self._system_class(element)

    @staticmethod
    def _system_class(element):
        return CLASSES.get(element.tag) or f"NS{element.tag[:1].upper()}{element.tag[1:]}"

    def _check_element(self, element):
        self._check_references(element)
        if element.get("id") is None or element.tag in CONNECTIONS or element.get("id") in (FIRST_RESPONDER, APPLICATION):
            return
        if self._system_class(element) not in self._tables.classes:
            self._fault(element, "is nothing that the system has")
            return
        name = self._class_of(element)
        self._check_class(element)
        self._check_outlets(element, name)
        self._check_asked(element, name)
        self._check_pressed(element, name)
        if element.tag == "arrayController":
            self._check_controller(element)
        if is_silent(element, self._classes, name):
            self._fault(element, "has no name for a person who cannot see it")

    def _check_references(self, element):
        for attribute in REFERENCES:
            if element.get(attribute) and element.get(attribute) not in self._elements:
                self._fault(element, f"names {element.get(attribute)} as its {attribute}, which is nowhere")

    def _check_class(self, element):
        custom = element.get("customClass")
        if custom is None:
            return
        if not self._classes.is_known(custom):
            self._fault(element, f"is of the class {custom}, which is nowhere")
        elif element.get("id") != OWNER and not self._classes.is_a(custom, self._system_class(element)):
            self._fault(element, f"is of the class {custom}, which is no {self._system_class(element)}")

    def _check_outlets(self, element, name):
        """All that a source waits for, once each."""
        connected = [outlet.get("property") for outlet in element.findall("connections/outlet")]
        family = self._classes.family(name) if element.get("id") == OWNER else ()
        wanted = [outlet for entry in self._classes.ours(name) for outlet in entry.outlets]
        for outlet in (*wanted, *(SHOWN_BY[one] for one in family if one in SHOWN_BY)):
            if outlet not in connected:
                self._fault(element, f"leaves the outlet {outlet} of {name} empty")
        for outlet in sorted({outlet for outlet in connected if connected.count(outlet) > 1}):
            self._fault(element, f"connects the outlet {outlet} more than once")

    def _is_told(self, element, selector):
        """Whether the sources send that to the element, by the name that its owner has for it."""
        outlets = self._root.iterfind(f".//outlet[@destination='{element.get('id')}']")
        return any((outlet.get("property"), selector) in self._sources.sent for outlet in outlets)

    def _check_asked(self, element, name):
        """An owner that has something to answer is asked by whatever asks such things."""
        owner = self._class_of(self._elements[OWNER]) if OWNER in self._elements else ""
        if not self._classes.is_a(name, "NSView") and not self._classes.is_a(name, "NSWindow"):
            return
        for outlet in ("delegate", "dataSource"):
            answer = next(filter(None, (self._classes.part_in(owner, one) for one in self._classes.wants(name, outlet)[1])), "")
            there = element.find(f"connections/outlet[@property='{outlet}']") is not None
            if answer and not there and not self._is_told(element, setter(outlet)):
                self._fault(element, f"has no {outlet}, and {owner} has {answer}")

    def _check_pressed(self, element, name):
        if not any(self._classes.is_a(name, one) for one in PRESSED):
            return
        bound = {binding.get("name") for binding in element.findall("connections/binding")}
        if element.find("connections/action") is None and not bound & TAKEN_BY_BINDING and not self._is_told(element, "setAction:"):
            self._fault(element, "does nothing: it sends no action")

    def _check_controller(self, element):
        if element.get("avoidsEmptySelection") != "NO":
            self._fault(element, "selects its first row by itself")
        row = element.get("objectClassName", "NSMutableDictionary")
        if not self._classes.is_known(row):
            self._fault(element, f"has rows of the class {row}, which is nowhere")
            return
        for key in element.findall("declaredKeys/string"):
            if row in self._sources.classes and not self._classes.gives(row, key.text):
                self._fault(key, f"declares {key.text}, which {row} has not")

    def _check_connection(self, element, connection):
        place = connection.get("destination") or connection.get("target")
        target = self._elements.get(place)
        if target is None:
            self._fault(connection, f"connects {element.get('id')} with {place}, which is nowhere")
            return
        check = getattr(self, f"_check_{connection.tag}", None) if connection.tag in CONNECTIONS else None
        if check is None:
            self._fault(connection, f"is a connection of {element.get('id')} of a kind that nothing checks")
        else:
            check(element, connection, target)

    def _check_outlet(self, element, connection, target):
        name, outlet = self._class_of(element), connection.get("property")
        kinds = [entry.outlets[outlet] for entry in self._classes.ours(name) if outlet in entry.outlets]
        if not kinds and not self._classes.answers(name, setter(outlet)):
            self._fault(connection, f"is an outlet {outlet} that {name} has not")
            return
        kind, protocols = (kinds[0], []) if kinds else self._classes.wants(name, outlet)
        if not self._classes.fits(self._class_of(target), kind, protocols):
            wanted = " ".join([kind, *(f"<{protocol}>" for protocol in protocols)])
            self._fault(connection, f"puts {target.get('id')} into {outlet}, which is for {wanted}")

    def _check_action(self, element, connection, target):
        name, selector = self._class_of(target), connection.get("selector")
        if target.get("id") == FIRST_RESPONDER:
            if not self._classes.anybody_acts(selector):
                self._fault(connection, f"sends {selector}, which is nobody's action")
        elif not self._classes.acts(name, selector):
            self._fault(connection, f"sends {selector}, which is no action of {name}")

    def _check_binding(self, element, connection, target):
        name, bound = connection.get("name"), self._class_of(element)
        if name not in bindings_of(self._classes.family(bound)):
            self._fault(connection, f"binds {name}, by which no {self._system_class(element)} can be bound")
        for transformer in connection.findall(".//string[@key='NSValueTransformerName']"):
            if f"{transformer.text}TransformerName" not in self._tables.constants:
                self._fault(transformer, f"names the transformer {transformer.text}, which the system has not")
        owner = self._class_of(target)
        first, *rest = connection.get("keyPath").split(".")
        if not self._classes.gives(owner, first):
            self._fault(connection, f"binds {element.get('id')} to {first}, which {owner} has not")
        elif rest:
            self._check_rows(element, connection, target, first, rest)

    def _check_rows(self, element, connection, target, first, keys):
        """Beyond the rows of an array controller: what one row has."""
        row = target.get("objectClassName")
        if first not in ("arrangedObjects", "selection") or row not in self._sources.classes or len(keys) != 1:
            self._fault(connection, f"binds {element.get('id')} to {first}.{'.'.join(keys)}, which cannot be followed")
        elif not self._classes.gives(row, keys[0]):
            self._fault(connection, f"binds {element.get('id')} to {keys[0]}, which {row} has not")
