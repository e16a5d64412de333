"""By what objects of the system can be bound, as Apple's reference of bindings tells it: the tables know only that such a
name exists, and not whose it is. To bind another one raises when the layout is loaded."""

CHOICE = {"content", "contentObjects", "contentValues"}
SELECTED = {"selectedIndex", "selectedObject", "selectedTag", "selectedValue"}
ROWS = {"content", "selectionIndexes", "sortDescriptors"}
BINDINGS = {
    "NSView": {"hidden", "toolTip"},
    "NSControl": {"enabled", "alignment", "font", "fontBold", "fontItalic", "fontName", "fontSize"},
    "NSButton": {"value", "title", "alternateTitle", "image", "alternateImage", "target", "argument"},
    "NSPopUpButton": CHOICE | SELECTED,
    "NSTextField": {"value", "editable", "textColor", "target", "argument"},
    "NSTextView": {"value", "attributedString", "data", "editable"},
    "NSComboBox": {"content", "contentValues"},
    "NSSlider": {"value", "minValue", "maxValue"},
    "NSStepper": {"value", "minValue", "maxValue"},
    "NSSegmentedControl": {"selectedIndex", "selectedLabel", "selectedTag"},
    "NSImageView": {"value", "data", "valuePath", "valueURL"},
    "NSProgressIndicator": {"animate", "animationDelay", "isIndeterminate", "minValue", "maxValue", "value"},
    "NSTableView": ROWS | {"doubleClickTarget", "doubleClickArgument", "rowHeight"},
    "NSTableColumn": {"value", "enabled", "editable", "font", "textColor", "headerTitle", "width", "minWidth", "maxWidth"},
    "NSTabView": {"selectedIdentifier", "selectedIndex", "selectedLabel", "font"},
    "NSTabViewItem": {"label"},
    "NSBox": {"title"},
    "NSWindow": {"title", "representedFilename"},
    "NSMenuItem": {"enabled", "hidden", "title", "target", "argument", "value"},
    "NSObjectController": {"contentObject", "editable", "managedObjectContext"},
    "NSArrayController": {"contentArray", "contentArrayForMultipleSelection", "contentSet", "filterPredicate", "selectionIndexes",
                          "sortDescriptors"},
}


def bindings_of(family):
    """Of a class, given with all above it."""
    return set().union(*(BINDINGS.get(name, ()) for name in family))
