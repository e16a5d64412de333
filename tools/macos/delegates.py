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
        for selector, file in entry.implemented.items():
            known = selector in KNOWN or (system in tables.classes and tables.answers(system, selector, False))
            if known or selector in sent or any(selector in sources.protocols.get(name, ()) for name in contracts):
                continue
            if SENDERS.match(selector):
                yield f"{file.name}: {entry.name} has {selector}, which nothing in the system sends"
            elif selector.split(":")[0] not in sources.called and selector not in sources.called:
                yield f"{file.name}: {entry.name} has {selector}, which nobody calls"
