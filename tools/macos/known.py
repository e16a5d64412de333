"""Faults that are known and not mended yet: they are told, and they do not hide others."""


def known_faults(text, part):
    """Those of a part of the checks, in a list with the part's name in front of each."""
    return {line.partition(" ")[2] for line in text.splitlines() if line.startswith(f"{part} ")}


def judged(part, found, known):
    """(whether the part passes, what is said): it does when exactly the known faults are there."""
    said = [f"Known, and not mended yet: {fault}" if fault in known else fault for fault in found]
    said += [f"Mended, and to be taken out of tools/macos/known_faults.txt: {fault}" for fault in sorted(known - set(found))]
    passes = set(found) == known
    if passes:
        said.append(f"{part}: {'nothing else is wrong' if found else 'nothing is wrong'}")
    return passes, said
