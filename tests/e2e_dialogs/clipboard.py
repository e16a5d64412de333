"""Another program of the desktop: prints the text that was copied, or copies the argument and stays to hand it out."""
import sys

words = sys.argv[1:]
del sys.argv[1:]  # the toolkit reads them too

import gi  # noqa: E402

gi.require_version("Gdk", "3.0")
gi.require_version("Gtk", "3.0")
from gi.repository import Gdk, Gtk  # noqa: E402

clipboard = Gtk.Clipboard.get(Gdk.SELECTION_CLIPBOARD)
if words:
    clipboard.set_text(words[0], -1)
    print("copied", flush=True)
    Gtk.main()
else:
    print(clipboard.wait_for_text(), flush=True)
