"""Our classes and the system's as one family: who descends from whom, and what each answers to."""
from .sources import getters, setter
from .tables import Kind


class Classes:
    def __init__(self, sources, tables):
        self._sources, self._tables = sources, tables
        self._of_any_object = tables.protocol_methods("NSObject")

    def is_known(self, name):
        """Whether it is a class of the system, or one of ours that has a source."""
        return name in self._tables.classes or (name in self._sources.classes and bool(self._sources.classes[name].implemented))

    def ours(self, name):
        """Our classes from this one upward."""
        return self._sources.lineage(name)[0]

    def family(self, name):
        """The names of this class and all above it."""
        ours, system = self._sources.lineage(name)
        names = [entry.name for entry in ours]
        while system in self._tables.classes:
            names.append(system)
            system = self._tables.classes[system].parent
        return names

    def is_a(self, name, wanted):
        return wanted == "id" or wanted in self.family(name)

    def answers(self, name, selector):
        ours, system = self._sources.lineage(name)
        if any(selector in entry.declared for entry in ours):
            return True
        return system in self._tables.classes and self._tables.answers(system, selector, False)

    def gives(self, name, key):
        """Whether something can be read of it by that key."""
        return any(self._reads(name, selector) for selector in getters(key))

    def acts(self, name, selector):
        """Whether it is an action: of ours one that says so."""
        ours, system = self._sources.lineage(name)
        return any(selector in entry.actions for entry in ours) or (
            selector.count(":") == 1 and system in self._tables.classes and self._tables.answers(system, selector, False))

    def anybody_acts(self, selector):
        return any(self.acts(name, selector) for name in (*self._sources.classes, *self._tables.classes))

    def wants(self, name, prop):
        """(class, protocols) that the system says of what is put into a property of it; nothing where it does not say."""
        method = self._system_method(name, setter(prop))
        given = method.signature.arguments[0] if method else None
        return (given.name or "id", given.protocols) if given else ("id", [])

    def fits(self, name, wanted, protocols):
        """Whether it is of that class, and takes part in the protocols: it says so, or has one of their methods."""
        return self.is_a(name, wanted) and all(self._says(name, one) or self.part_in(name, one) for one in protocols)

    def part_in(self, name, protocol):
        """The first of our own methods by which a class takes part in a protocol of the system; empty where there is none."""
        own = self._tables.protocol_methods(protocol) - self._of_any_object
        return min((selector for entry in self.ours(name) for selector in entry.implemented if selector in own), default="")

    def _says(self, name, protocol):
        said = set().union(*(entry.protocols for entry in self.ours(name)),
                           *(self._tables.classes[one].protocols for one in self.family(name) if one in self._tables.classes))
        return any(protocol in self._with_parents(one) for one in said)

    def _with_parents(self, protocol):
        entry = self._tables.protocols.get(protocol)
        return {protocol}.union(*(self._with_parents(one) for one in entry.protocols)) if entry else {protocol}

    def _reads(self, name, selector):
        for entry in self.ours(name):
            if selector in entry.declared:
                return entry.declared[selector] not in ("void", "IBAction")
        method = self._system_method(name, selector)
        return method is not None and method.signature.result.kind != Kind.VOID

    def _system_method(self, name, selector):
        for one in self.family(name):
            entry = self._tables.classes.get(one)
            for holder in (entry, *map(self._tables.protocols.get, entry.protocols)) if entry else ():
                for method in holder.methods:
                    if method.selector == selector and not method.of_class:
                        return method
        return None
