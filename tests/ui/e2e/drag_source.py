#!/usr/bin/python3
"""A program that files are dragged from: a small window at the top left of the screen with one button.

    drag_source.py FILE...
"""
import pathlib
import sys

import gi

gi.require_version("Gtk", "3.0")
from gi.repository import Gdk, Gtk  # noqa: E402  (the version has to be chosen before)

URIS = [pathlib.Path(name).resolve().as_uri() for name in sys.argv[1:]]


def give_uris(_button, _context, selection, _info, _time):
    selection.set_uris(URIS)


window = Gtk.Window(title="Drag source")
window.set_default_size(120, 60)
window.move(20, 20)
button = Gtk.Button(label="%d files" % len(URIS))
window.add(button)
button.drag_source_set(Gdk.ModifierType.BUTTON1_MASK, [], Gdk.DragAction.COPY)
button.drag_source_add_uri_targets()
button.connect("drag-data-get", give_uris)
button.connect("drag-end", Gtk.main_quit)
window.connect("destroy", Gtk.main_quit)
window.show_all()
Gtk.main()
