"""Checks the methods by which our classes answer to the system: a misspelt one is never called, and nobody says so."""
import functools
import re

from . import ways

# Whoever sends such a message says so first.
SENDERS = re.compile(r"^(tableView|outlineView|tabView|panel|window|application|control|menu|textView|splitView|sheet)"
                     r"(:|[A-Z]\w*(Did|Will|Should))")
# No protocol of the system has these: who calls them instead.
KNOWN = {
    "panel:shouldShowFilename:": "panels ask for it by name, since before there were protocols",
}


class Delegates:
    def __init__(self, sources, tables):
        self._sources, self._tables = sources, tables
        self._sent = self._signatures(tables.protocols.values())
        self._known_to = functools.cache(lambda name: self._signatures(self._family(name)))

    def faults(self):
        for entry in self._sources.classes.values():
            ours, system = self._sources.lineage(entry.name)
            yield from self._types(entry, system)
            yield from self._uncalled(entry, ours, system)
            yield from self._uncalled_of_class(entry, system)
            # What any object may be asked is for those to answer that do.
            keepers = self._sources.classes.values() if entry.name in self._tables.classes else (entry, *ours)
            yield from self._broken_promises(entry, keepers, system)

    @staticmethod
    def _signatures(holders):
        """selector -> signatures"""
        found = {}
        for method in (method for holder in holders for method in holder.methods if not method.of_class):
            found.setdefault(method.selector, []).append(method.signature)
        return found

    def _family(self, name):
        while name in self._tables.classes:
            yield self._tables.classes[name]
            name = self._tables.classes[name].parent

    def _types(self, entry, system):
        for selector, place in entry.implemented.items():
            # What we send ourselves may only happen to be called like something in a protocol.
            known = [*self._known_to(system).get(selector, ())]
            if SENDERS.match(selector) or selector not in self._sources.called:
                known += self._sent.get(selector, ())
            if known and ways.of_written(entry.types[selector]) not in map(ways.of_signature, known):
                yield f"{place}: {entry.name} has {selector} with other types than the system's"

    def _uncalled(self, entry, ours, system):
        contracts = set().union(*(one.protocols for one in ours)) if ours else entry.protocols
        sent_to_it = set(KNOWN).union(*(self._sources.protocols.get(name, ()) for name in contracts))
        for selector, place in entry.implemented.items():
            if selector in sent_to_it or selector in self._sent or self._answers(system, selector, False):
                continue
            if SENDERS.match(selector):
                yield f"{place}: {entry.name} has {selector}, which nothing in the system sends"
            elif selector not in self._sources.called:
                yield f"{place}: {entry.name} has {selector}, which nobody calls"

    def _uncalled_of_class(self, entry, system):
        for selector, place in entry.of_class.items():
            known = ("+", selector) in entry.promised or selector in self._sources.called
            if not known and not self._answers(system, selector, True):
                yield f"{place}: {entry.name} has the class's method {selector}, which nobody calls"

    def _broken_promises(self, entry, keepers, system):
        """What an interface says and no source for this system does: a compiler looks only at interfaces of what it compiles."""
        for (sign, selector), place in entry.promised.items():
            done = any(selector in (one.implemented if sign == "-" else one.of_class) for one in keepers)
            if not done and not self._answers(system, selector, sign == "+"):
                yield f"{place}: {entry.name} promises {selector}, which no source for macOS has"

    def _answers(self, name, selector, of_class):
        return name in self._tables.classes and self._tables.answers(name, selector, of_class)


def faults(sources, tables):
    return Delegates(sources, tables).faults()
