"""What the package's TypeScript declarations say and its tables do not: which framework a name belongs to, and where a
number is of an enumeration."""
import re

DECLARED = re.compile(r"^declare (class|interface|const|function) (\w+)", re.MULTILINE)
OWNER = re.compile(r"^declare (?:class|interface) (\w+)")
MEMBER = re.compile(r"^  (?:static )?(?:readonly )?(?:get |set )?(\w+)(\?)?(\((.*)\))?: (.*);$")
ENUM = re.compile(r"interop\.Enum<typeof (\w+)>")
ENUM_CONSTANT = re.compile(r"^declare const (\w+): interop\.Enum<typeof (\w+)>;", re.MULTILINE)


def script_name(selector):
    """What JavaScript calls a method: tableView:shouldSelectRow: is tableViewShouldSelectRow."""
    first, *others = selector.split(":")
    return first + "".join(part[:1].upper() + part[1:] for part in others)


def split_arguments(text):
    """The arguments of a method. Functions among them have commas of their own."""
    arguments, depth, start = [], 0, 0
    for place, letter in enumerate(text):
        depth += letter in "(<[{"
        depth -= letter in ")]}" or (letter == ">" and text[place - 1] != "=")
        if letter == "," and depth == 0:
            arguments.append(text[start:place])
            start = place + 1
    return [*arguments, text[start:]] if text.strip() else []


def enum_of(text):
    found = ENUM.fullmatch(text.split(": ", 1)[-1].removesuffix(" | null").strip())
    return found.group(1) if found else None


class Listings:
    """`names`: framework -> kind -> names. `enums`: (class or protocol, script's name) -> (of the result, of each argument)."""

    def __init__(self, folder, frameworks):
        self.names, self.enums, self.enum_constants = {}, {}, {}
        for framework in frameworks:
            text = (folder / f"{framework}.d.ts").read_text(encoding="utf-8")
            kinds = self.names.setdefault(framework, {})
            for kind, name in DECLARED.findall(text):
                kinds.setdefault(kind, set()).add(name)
            self.enum_constants |= dict(ENUM_CONSTANT.findall(text))
            self._read_members(text)

    def _read_members(self, text):
        owner = None
        for line in text.splitlines():
            if found := OWNER.match(line):
                owner = found.group(1)
            elif found := MEMBER.match(line):
                self._note(owner, *found.group(1, 4, 5))

    def _note(self, owner, name, arguments, result):
        entry = (enum_of(result), [enum_of(argument) for argument in split_arguments(arguments or "")])
        if entry[0] or any(entry[1]):
            self.enums.setdefault((owner, name), entry)
