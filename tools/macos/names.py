"""Checks what sources name in texts, where no compiler looks: keys, selectors and layouts, which raise when they are not there."""
import re

from .sources import getters, named, setter, without_comments

KEY = re.compile(r'\b(?:valueForKey|valueForKeyPath|willChangeValueForKey|didChangeValueForKey):\s*@"([\w.]+)"')
SELECTOR = re.compile(r'\bNSSelectorFromString\(\s*@"([\w:]+)"')
LAYOUT = re.compile(r'NibName(?:d)?:\s*@"(\w+)"|windowNibName\s*\{\s*return\s+@"(\w+)"')
# No class of the system says that it has these.
KNOWN = {
    "undo:": "texts answer to it all the same",
}


def faults(files, sources, tables, layouts):
    """`layouts`: names of the windows' layouts."""
    methods = {method.selector for holder in (*tables.classes.values(), *tables.protocols.values()) for method in holder.methods}
    known = methods.union(KNOWN, *(entry.declared for entry in sources.classes.values()))
    for file in files:
        text = without_comments(file)
        for found in KEY.finditer(text):
            for key in found.group(1).split("."):
                if known.isdisjoint((*getters(key), setter(key))):
                    yield f"{place(file, text, found)}: reads the key {key}, which nothing has"
        for found in SELECTOR.finditer(text):
            if found.group(1) not in known:
                yield f"{place(file, text, found)}: names {found.group(1)}, to which nothing answers"
        for found in LAYOUT.finditer(text):
            name = next(filter(None, found.groups()))
            if name not in layouts:
                yield f"{place(file, text, found)}: loads the layout {name}, which is nowhere"


def place(file, text, found):
    return f"{named(file)}:{text.count(chr(10), 0, found.end()) + 1}"
