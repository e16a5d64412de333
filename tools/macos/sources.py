"""What our Objective-C++ sources declare and implement: classes with parents, protocols, outlets and methods."""
import re
from dataclasses import dataclass, field

COMMENT = re.compile(r"//[^\n]*|/\*.*?\*/", re.DOTALL)
INTERFACE = re.compile(r"@interface\s+(\w+)\s*(\(\s*\w*\s*\))?\s*(?::\s*(\w+))?\s*(?:<([^>]*)>)?(.*?)@end", re.DOTALL)
IMPLEMENTATION = re.compile(r"@implementation\s+(\w+)\s*(?:\(\s*\w*\s*\))?(.*?)@end", re.DOTALL)
PROTOCOL = re.compile(r"@protocol\s+(\w+)\s*(?:<([^>]*)>)?((?:(?!@protocol)[^;])(?:.*?))@end", re.DOTALL)
METHOD = re.compile(r"^([-+])\s*\(", re.MULTILINE)
HEAD = re.compile(r"^[-+]\s*\([^;{]*", re.MULTILINE)
CALLED = re.compile(r"@selector\(([\w:]+)\)|\b(\w+)(?=[:\]])|\.(\w+)")
NAMED = re.compile(r'(?:selector="|keyPath="(?:\w+\.)*)([\w:]+)"')
OUTLET = re.compile(r"IBOutlet\s+(\w+)(?:\s*<[^>]*>)?\s*\*?\s*(\w+)\s*;")
PROPERTY = re.compile(r"@property\s*(?:\(([^)]*)\))?\s*(?:IBOutlet\s+)?([\w<>\s]+?)\s*\*?\s*(\w+)\s*;")


@dataclass
class OurClass:
    name: str
    parent: str = ""
    protocols: set = field(default_factory=set)
    outlets: dict = field(default_factory=dict)  # name -> class
    declared: set = field(default_factory=set)  # selectors of methods
    implemented: dict = field(default_factory=dict)  # selector -> file
    actions: set = field(default_factory=set)


def without_types(text):
    """The text without anything in parentheses."""
    depth, kept = 0, []
    for letter in text:
        depth += letter == "("
        if depth == 0:
            kept.append(letter)
        depth -= letter == ")"
    return "".join(kept)


def selector_of(declaration):
    """Of what stands after the sign of a method."""
    words = without_types(declaration)
    parts = re.findall(r"(\w*)\s*:", words)
    return "".join(f"{part}:" for part in parts) if parts else words.split()[0]


def methods_in(text, end):
    """(sign, selector, type of what it answers) of each method in a class. `end`: what a method's head ends with."""
    for start in METHOD.finditer(text):
        head = text[start.start() + 1:text.index(end, start.end())]
        yield start.group(1), selector_of(head), head[head.index("(") + 1:head.index(")")].strip()


def setter(name):
    return f"set{name[:1].upper()}{name[1:]}:"


class Sources:
    """`called`: first words of the messages that are sent, selectors that are named, and what is read by a point."""

    def __init__(self, files, others=(), layouts=()):
        """`others`: sources for another system, which call as well. `layouts`: XIB files, which do so by name."""
        self.classes, self.protocols, self.called = {}, {}, set()
        for file in files:
            text = COMMENT.sub("", file.read_text(encoding="utf-8"))
            for found in PROTOCOL.finditer(text):
                self.protocols[found.group(1)] = {selector for _, selector, _ in methods_in(found.group(3), ";")}
            for found in INTERFACE.finditer(text):
                self._read_interface(*found.group(1, 3, 4, 5))
            for found in IMPLEMENTATION.finditer(text):
                self._read_implementation(file, *found.groups())
        for file in (*files, *others):
            text = HEAD.sub("", COMMENT.sub("", file.read_text(encoding="utf-8")))
            self.called.update(*(found.groups() for found in CALLED.finditer(text)))
        for file in layouts:
            self.called |= set(NAMED.findall(file.read_text(encoding="utf-8")))

    def _class(self, name):
        return self.classes.setdefault(name, OurClass(name))

    def _read_interface(self, name, parent, protocols, body):
        entry = self._class(name)
        entry.parent = entry.parent or parent or ""
        entry.protocols |= {word.strip() for word in (protocols or "").split(",") if word.strip()}
        entry.outlets |= {outlet: kind for kind, outlet in OUTLET.findall(body)}
        for _, selector, result in methods_in(body, ";"):
            entry.declared.add(selector)
            if result == "IBAction":
                entry.actions.add(selector)
        for attributes, _, prop in PROPERTY.findall(body):
            entry.declared.add(prop)
            if "readonly" not in attributes:
                entry.declared.add(setter(prop))

    def _read_implementation(self, file, name, body):
        entry = self._class(name)
        for sign, selector, _ in methods_in(body, "{"):
            if sign == "-":
                entry.implemented[selector] = file

    def lineage(self, name):
        """Our classes from this one upward, and the first that is the system's."""
        ours = []
        while name in self.classes and self.classes[name].parent:
            ours.append(self.classes[name])
            name = self.classes[name].parent
        return ours, name
