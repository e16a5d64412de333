"""Checks the methods by which our classes answer to the system: a misspelt one is never called, and nobody says so."""
import re

# Whoever sends such a message says so first.
SENDERS = re.compile(r"^(tableView|outlineView|tabView|panel|window|application|control|menu|textView|splitView|sheet)"
                     r"(:|[A-Z]\w*(Did|Will|Should))")
# No protocol of the system has these: who calls them instead.
KNOWN = {
    "panel:shouldShowFilename:": "panels ask for it by name, since before there were protocols",
}


def faults(sources, tables):
    sent = {method.selector for protocol in tables.protocols.values() for method in protocol.methods}
    for entry in sources.classes.values():
        ours, system = sources.lineage(entry.name)
        contracts = set().union(*(one.protocols for one in ours)) if ours else entry.protocols
        sent_to_it = sent.union(*(sources.protocols.get(name, ()) for name in contracts), KNOWN)
        for selector, place in entry.implemented.items():
            if selector in sent_to_it or answers(tables, system, selector, False):
                continue
            if SENDERS.match(selector):
                yield f"{place}: {entry.name} has {selector}, which nothing in the system sends"
            elif selector not in sources.called:
                yield f"{place}: {entry.name} has {selector}, which nobody calls"
        for selector, place in entry.of_class.items():
            known = ("+", selector) in entry.promised or selector in sources.called
            if not known and not answers(tables, system, selector, True):
                yield f"{place}: {entry.name} has the class's method {selector}, which nobody calls"
        # What any object may be asked is for those to answer that do.
        keepers = sources.classes.values() if entry.name in tables.classes else (entry, *ours)
        yield from broken_promises(entry, keepers, system, tables)


def broken_promises(entry, keepers, system, tables):
    """What an interface says and no source for this system does: a compiler looks only at interfaces of what it compiles."""
    for (sign, selector), place in entry.promised.items():
        done = any(selector in (one.implemented if sign == "-" else one.of_class) for one in keepers)
        if not done and not answers(tables, system, selector, sign == "+"):
            yield f"{place}: {entry.name} promises {selector}, which no source for macOS has"


def answers(tables, name, selector, of_class):
    return name in tables.classes and tables.answers(name, selector, of_class)
