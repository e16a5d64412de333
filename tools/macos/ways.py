"""How values are handed over, as far as it matters to whoever calls a method by name: a class of the system expects one way,
and one of ours that has another is given, or gives, rubbish."""
from .tables import Kind

STRUCTURES = ("NSRect", "NSPoint", "NSSize", "NSRange", "CGRect", "CGPoint", "CGSize")
FLOATING = ("CGFloat", "double", "float", "NSTimeInterval")
ADDRESSES = (Kind.TEXT, Kind.OBJECT, Kind.OBJECT_OF_PROTOCOLS, Kind.OBJECT_OF_CLASS, Kind.SAME_CLASS, Kind.STRING,
             Kind.MUTABLE_STRING, Kind.CLASS, Kind.SELECTOR, Kind.ARRAY, Kind.POINTER, Kind.ANY_POINTER, Kind.FUNCTION, Kind.BLOCK)
# All others are whole numbers.
OF_KIND = {Kind.VOID: "void", Kind.STRUCT: "structure", **dict.fromkeys((Kind.FLOAT, Kind.DOUBLE), "floating"),
           **dict.fromkeys((Kind.BOOLEAN, Kind.CHAR, Kind.BYTE), "truth"), **dict.fromkeys(ADDRESSES, "address")}
OF_NAME = {"void": "void", "IBAction": "void", "BOOL": "truth", **dict.fromkeys(("id", "Class", "SEL", "instancetype"), "address"),
           **dict.fromkeys(STRUCTURES, "structure"), **dict.fromkeys(FLOATING, "floating")}


def of_written(types):
    """Of types as our sources write them."""
    return ["address" if "*" in one or "^" in one else OF_NAME.get(one.removeprefix("const ").split("<")[0].strip(), "number")
            for one in types]


def of_signature(signature):
    return [OF_KIND.get(one.kind, "number") for one in (signature.result, *signature.arguments)]
