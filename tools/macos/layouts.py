"""Checks a window's layout (XIB): what it connects has to be there, in the layout, in our sources or in the system."""
import xml.etree.ElementTree as ElementTree

from .sources import setter

OWNER, FIRST_RESPONDER, APPLICATION = "-2", "-1", "-3"
# Elements whose class the system spells otherwise.
CLASSES = {"customView": "NSView", "customObject": "NSObject", "window": "NSWindow", "view": "NSView",
           "arrayController": "NSArrayController"}
# What a person works with, and needs to be told the name of.
CONTROLS = {"button", "popUpButton", "tableView", "segmentedControl", "textField", "comboBox", "slider"}


class Layout:
    def __init__(self, path, sources, tables):
        self._path, self._sources, self._tables = path, sources, tables
        self._root = ElementTree.parse(path).getroot()
        self._elements, self._faults = {}, []

    def faults(self):
        self._number()
        for element in self._root.iter():
            self._check_class(element)
            if element.tag == "arrayController" and element.get("avoidsEmptySelection") != "NO":
                self._fault(element, "selects its first row by itself")
            if element.tag in CONTROLS and not self._is_named(element):
                self._fault(element, "has no name for a person who cannot see it")
            for connection in element.findall("connections/*"):
                self._check_connection(element, connection)
        return self._faults

    def _fault(self, element, text):
        self._faults.append(f"{self._path.name}: {element.get('id')} ({element.tag}) {text}")

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
        return custom if custom in self._sources.classes else self._system_class(element)

    @staticmethod
    def _system_class(element):
        return CLASSES.get(element.tag) or f"NS{element.tag[:1].upper()}{element.tag[1:]}"

    def _is_a(self, name, wanted):
        ours, system = self._sources.lineage(name)
        if wanted == "id" or wanted in [entry.name for entry in ours]:
            return True
        while system:
            if system == wanted:
                return True
            system = self._tables.classes[system].parent if system in self._tables.classes else ""
        return False

    def _check_class(self, element):
        custom = element.get("customClass")
        if custom is None or element.get("id") in (FIRST_RESPONDER, APPLICATION):
            return
        if custom not in self._sources.classes or not self._sources.classes[custom].implemented:
            self._fault(element, f"is of the class {custom}, which is nowhere")
        elif element.get("id") != OWNER and not self._is_a(custom, self._system_class(element)):
            self._fault(element, f"is of the class {custom}, which is no {self._system_class(element)}")

    def _answers(self, name, selector):
        ours, system = self._sources.lineage(name)
        if any(selector in entry.declared or selector in entry.implemented for entry in ours):
            return True
        return system in self._tables.classes and self._tables.answers(system, selector, False)

    def _check_connection(self, element, connection):
        target = self._elements.get(connection.get("destination") or connection.get("target"))
        if target is None:
            self._fault(element, f"is connected with {connection.get('destination') or connection.get('target')}, which is nowhere")
            return
        check = getattr(self, f"_check_{connection.tag}", None)
        if check is None:
            self._fault(element, f"has a connection of a kind that nothing checks: {connection.tag}")
        else:
            check(element, connection, target)

    def _check_outlet(self, element, connection, target):
        name, outlet = self._class_of(element), connection.get("property")
        kinds = [entry.outlets[outlet] for entry in self._sources.lineage(name)[0] if outlet in entry.outlets]
        if kinds and not self._is_a(self._class_of(target), kinds[0]):
            self._fault(element, f"has the outlet {outlet} for {kinds[0]}, and {target.get('id')} is none")
        if not kinds and not self._answers(name, setter(outlet)):
            self._fault(element, f"has no outlet {outlet}")

    def _check_action(self, element, connection, target):
        name, selector = self._class_of(target), connection.get("selector")
        actions = {action for entry in self._sources.lineage(name)[0] for action in entry.actions}
        if target.get("id") != FIRST_RESPONDER and selector not in actions:
            self._fault(element, f"sends {selector}, which is no action of {name}")

    def _check_binding(self, element, connection, target):
        name = connection.get("name")
        if f"NS{name[:1].upper()}{name[1:]}Binding" not in self._tables.constants:
            self._fault(element, f"binds {name}, which nothing can be bound by")
        owner = self._class_of(target)
        first, *rest = connection.get("keyPath").split(".")
        if not self._has_key(owner, first):
            self._fault(element, f"is bound to {first}, which {owner} has not")
        elif rest:
            self._check_rows(element, target, first, rest)

    def _check_rows(self, element, target, first, keys):
        """Beyond the rows of an array controller: what one row has."""
        row = target.get("objectClassName")
        if first not in ("arrangedObjects", "selection") or row not in self._sources.classes or len(keys) != 1:
            self._fault(element, f"is bound to {first}.{'.'.join(keys)}, which cannot be followed")
        elif not self._has_key(row, keys[0]):
            self._fault(element, f"is bound to {keys[0]}, which {row} has not")

    def _has_key(self, name, key):
        return self._answers(name, key) or self._answers(name, f"is{key[:1].upper()}{key[1:]}")

    def _is_named(self, element):
        cells = [cell for cell in element if cell.get("key") == "cell"]
        if any(part.get("description") for holder in (element, *cells) for part in holder.findall("accessibility")):
            return True
        if element.tag == "textField":  # a line of text is what it says
            return any(cell.get("editable", "YES") == "NO" for cell in cells)
        if element.tag == "segmentedControl":
            segments = [segment for cell in cells for segment in cell.findall("segments/segment")]
            return bool(segments) and all(segment.get("label") or segment.get("toolTip") for segment in segments)
        return element.tag == "button" and any(cell.get("title") for cell in cells)
