"""What VoiceOver reads: whatever a person works with has a name in words."""

# What the system itself puts beside other things.
SILENT = {"scroller"}


def texts(*values):
    return any(value and value.strip() for value in values)


def cells_of(element, key="cell"):
    return [cell for cell in element if cell.get("key") == key]


def title_of(cell):
    return cell.get("title") or "".join(text.text or "" for text in cell.findall("string") if text.get("key") == "title")


def is_named(element):
    """Of a control: it has a description, or words that stand on it."""
    cells = cells_of(element)
    if any(texts(part.get("description")) for holder in (element, *cells) for part in holder.findall("accessibility")):
        return True
    if element.tag == "textField":  # a line of text is what it says
        said = any(binding.get("name") == "value" for binding in element.findall("connections/binding"))
        return any(cell.get("editable") != "YES" and (said or texts(title_of(cell))) for cell in cells)
    if element.tag == "segmentedControl":
        segments = [segment for cell in cells for segment in cell.findall("segments/segment")]
        return bool(segments) and all(texts(segment.get("label"), segment.get("toolTip")) for segment in segments)
    return element.tag == "button" and texts(*map(title_of, cells))


def is_silent(element, classes, name):
    """Whether a person works with an element of that class and is not told what it is."""
    if element.tag == "tabViewItem":
        return not texts(element.get("label"))
    if element.tag == "tableColumn":
        return not texts(*map(title_of, cells_of(element, "headerCell")))
    works = classes.is_a(name, "NSControl") or classes.is_a(name, "NSTextView")
    return works and element.tag not in SILENT and not is_named(element)
