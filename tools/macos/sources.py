"""What our Objective-C++ sources declare, implement and call: classes with parents, protocols, outlets and methods."""
import re
from dataclasses import dataclass, field
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
COMMENT = re.compile(r"//[^\n]*|/\*.*?\*/", re.DOTALL)
INTERFACE = re.compile(r"@interface\s+(\w+)\s*(\(\s*\w*\s*\))?\s*(?::\s*(\w+))?\s*(?:<([^>]*)>)?(.*?)@end", re.DOTALL)
IMPLEMENTATION = re.compile(r"@implementation\s+(\w+)\s*(?:\(\s*\w*\s*\))?(.*?)@end", re.DOTALL)
PROTOCOL = re.compile(r"@protocol\s+(\w+)\s*(?:<([^>]*)>)?((?:(?!@protocol)[^;])(?:.*?))@end", re.DOTALL)
METHOD = re.compile(r"^([-+])\s*\(", re.MULTILINE)
TEXT = re.compile(r'"(?:\\.|[^"\\\n])*"' + r"|'(?:\\.|[^'\\\n])'")
BRACKET = re.compile(r"[\[\](){}]")
WORD_OF_SELECTOR = re.compile(r"(\w+):(?!:)")
# Selectors and keys that a source names: as such, in a text, or after a point.
SPOKEN_OF = re.compile(r'@selector\(([\w:]+)\)|@"([A-Za-z]\w*:*)"|\.(\w+)')
NAMED = re.compile(r'selector="([\w:]+)"|keyPath="(?:\w+\.)*(\w+)"')
OUTLET = re.compile(r"IBOutlet\s+(\w+)(?:\s*<[^>]*>)?\s*\*?\s*(\w+)\s*;")
PROPERTY = re.compile(r"@property\s*(?:\(([^)]*)\))?\s*(?:IBOutlet\s+)?([\w<>\s]+?)\s*\*?\s*(\w+)\s*;")


@dataclass
class OurClass:
    name: str
    parent: str = ""
    protocols: set = field(default_factory=set)
    outlets: dict = field(default_factory=dict)  # name -> class
    declared: dict = field(default_factory=dict)  # selector of a method -> type of what it answers
    implemented: dict = field(default_factory=dict)  # selector -> file and line
    types: dict = field(default_factory=dict)  # selector of a method -> types of what it answers and is given
    of_class: dict = field(default_factory=dict)  # selector of one of the class's own methods -> file and line
    promised: dict = field(default_factory=dict)  # (sign, selector) of a method in an interface -> file and line
    actions: set = field(default_factory=set)


def named(file):
    """What a person calls a file: its place in the project."""
    return str(file.relative_to(ROOT)) if file.is_relative_to(ROOT) else file.name


def without_comments(file):
    """A source's text; every line keeps its number."""
    return COMMENT.sub(lambda comment: "\n" * comment.group().count("\n"), file.read_text(encoding="utf-8"))


def messages(text):
    """(what stands first, selector) of everything in square brackets: messages, and what else is written so."""
    open_brackets, kept, place = [], [[]], 0
    text = TEXT.sub('""', text)
    for bracket in BRACKET.finditer(text):
        kept[-1].append(text[place:bracket.start()])
        place = bracket.end()
        if bracket.group() in "[({":
            open_brackets.append(bracket.group())
            kept.append([])
        elif open_brackets:
            inside = "".join(kept.pop())
            kept[-1].append(" () ")
            if open_brackets.pop() == "[":
                yield message(inside)


def message(inside):
    words = WORD_OF_SELECTOR.findall(inside)
    parts = inside.split()
    if words:
        return parts[0], "".join(f"{word}:" for word in words)
    return (parts[0], parts[-1]) if parts else ("", "")


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


def types_in(declaration):
    """What stands in parentheses: the type of what a method answers, and of what it is given."""
    depth, types = 0, []
    for letter in declaration:
        depth -= letter == ")"
        if depth > 0:
            types[-1] += letter
        elif letter == "(":
            types.append("")
        depth += letter == "("
    return [kind.strip() for kind in types]


def methods_in(text, end):
    """(sign, selector, types, where) of each method in a class. `end`: what a method's head ends with."""
    for start in METHOD.finditer(text):
        head = text[start.start() + 1:text.index(end, start.end())]
        yield start.group(1), selector_of(head), types_in(head), start.start()


def setter(name):
    return f"set{name[:1].upper()}{name[1:]}:"


def getters(key):
    """By which of these something may be read by that key."""
    return key, f"is{key[:1].upper()}{key[1:]}"


class Sources:
    """`called`: selectors of messages and selectors and keys that are named. `sent`: messages by what stands first in them."""

    def __init__(self, files, others=(), layouts=()):
        """`others`: sources for another system, which call as well. `layouts`: XIB files, which do so by name."""
        self.classes, self.protocols, self.called, self.sent = {}, {}, set(), set()
        texts = {file: without_comments(file) for file in (*files, *others)}
        for file in files:
            text = texts[file]
            for found in PROTOCOL.finditer(text):
                self.protocols[found.group(1)] = {selector for _, selector, _, _ in methods_in(found.group(3), ";")}
            for found in INTERFACE.finditer(text):
                self._read_interface(file, text[:found.start(5)].count("\n") + 1, *found.group(1, 3, 4, 5))
            for found in IMPLEMENTATION.finditer(text):
                self._read_implementation(file, text[:found.start(2)].count("\n") + 1, *found.groups())
        for text in texts.values():
            self._read_calls(text)
        for file in layouts:
            self._call(*(name for pair in NAMED.findall(file.read_text(encoding="utf-8")) for name in pair))

    def _class(self, name):
        return self.classes.setdefault(name, OurClass(name))

    def _call(self, *names):
        """Who names a property may set it."""
        self.called.update(names)
        self.called.update(setter(name) for name in names if name and ":" not in name)

    def _read_calls(self, text):
        sent = set(messages(text))
        self.sent |= sent
        self.called |= {selector for _, selector in sent}
        self._call(*(name for groups in SPOKEN_OF.findall(text) for name in groups))

    def _read_interface(self, file, line, name, parent, protocols, body):
        entry = self._class(name)
        entry.parent = entry.parent or parent or ""
        entry.protocols |= {word.strip() for word in (protocols or "").split(",") if word.strip()}
        entry.outlets |= {outlet: kind for kind, outlet in OUTLET.findall(body)}
        for sign, selector, (result, *_), start in methods_in(body, ";"):
            entry.promised.setdefault((sign, selector), f"{named(file)}:{line + body[:start].count(chr(10))}")
            if sign == "-":
                entry.declared[selector] = result
            if result == "IBAction":
                entry.actions.add(selector)
        for attributes, kind, prop in PROPERTY.findall(body):
            entry.declared[prop] = kind
            if "readonly" not in attributes:
                entry.declared[setter(prop)] = "void"

    def _read_implementation(self, file, line, name, body):
        entry = self._class(name)
        for sign, selector, types, start in methods_in(body, "{"):
            where = f"{named(file)}:{line + body[:start].count(chr(10))}"
            (entry.implemented if sign == "-" else entry.of_class)[selector] = where
            if sign == "-":
                entry.declared.setdefault(selector, types[0])
                entry.types[selector] = types

    def lineage(self, name):
        """Our classes from this one upward, and the first that is the system's."""
        ours = []
        while name in self.classes and self.classes[name].parent:
            ours.append(self.classes[name])
            name = self.classes[name].parent
        return ours, name
