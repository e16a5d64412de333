"""A small window at the left upper corner whose button drags the files of the command line."""
import pathlib
import sys

uris = [pathlib.Path(name).resolve().as_uri() for name in sys.argv[1:]]
del sys.argv[1:]  # the toolkit reads them too, and takes no names that are not text

import gi  # noqa: E402

gi.require_version("Gdk", "3.0")
gi.require_version("Gtk", "3.0")
from gi.repository import Gdk, Gtk  # noqa: E402

window = Gtk.Window(title="Files to drag")
window.set_default_size(120, 60)
window.move(20, 20)
button = Gtk.Button(label="Drag me")
button.drag_source_set(Gdk.ModifierType.BUTTON1_MASK, [], Gdk.DragAction.COPY)
button.drag_source_add_uri_targets()
button.connect("drag-end", lambda widget, context: print("the drag has ended", flush=True))
button.connect("drag-data-get", lambda widget, context, data, info, time: data.set_uris(uris))
window.add(button)
window.connect("destroy", Gtk.main_quit)
window.show_all()
Gtk.main()
