"""The tables say of classes what is known of them, and the declarations made from them say the same."""
import unittest

from support import BUILD, tables, tables_and_listings
from macos.listings import script_name, split_arguments
from macos.tables import Kind, Tables


class TheTables(unittest.TestCase):
    def test_a_class_answers_to_its_own_messages_and_to_its_parents(self):
        self.assertTrue(tables().answers("NSOpenPanel", "setCanChooseFiles:", False))
        self.assertTrue(tables().answers("NSOpenPanel", "makeKeyAndOrderFront:", False))
        self.assertTrue(tables().answers("NSOpenPanel", "respondsToSelector:", False))
        self.assertFalse(tables().answers("NSPanel", "setCanChooseFiles:", False))

    def test_messages_to_a_class_and_to_its_objects_are_told_apart(self):
        self.assertTrue(tables().answers("NSOpenPanel", "openPanel", True))
        self.assertFalse(tables().answers("NSOpenPanel", "openPanel", False))

    def test_a_protocol_that_is_called_like_a_class_has_its_own_name(self):
        self.assertIn("NSObject", tables().protocols)
        self.assertIn("isEqual:", tables().protocol_methods("NSTableViewDelegate"))

    def test_types_are_read(self):
        method, = [one for one in tables().classes["NSTableView"].methods if one.selector == "setDelegate:"]
        self.assertEqual(method.signature.result.kind, Kind.VOID)
        self.assertEqual(method.signature.arguments[0].protocols, ["NSTableViewDelegate"])
        self.assertEqual(tables().enums["NSTableViewDropOperation"], {"On": 0, "Above": 1})

    def test_what_is_no_table_is_refused(self):
        with self.assertRaises(ValueError):
            Tables(b"\x7fELF" + bytes(100))

    def test_declarations_name_methods_types_and_ends_of_lists(self):
        text = (BUILD / "MacOSX.sdk/System/Library/Frameworks/Foundation.framework/Headers/SystemTables.h").read_text()
        for line in ("- (void)setDelegate:(id<NSTableViewDelegate>)a0;",
                     "- (NSDragOperation)tableView:(NSTableView *)a0 validateDrop:(id<NSDraggingInfo>)a1 "
                     "proposedRow:(NSInteger)a2 proposedDropOperation:(NSTableViewDropOperation)a3;",
                     "+ (instancetype)arrayWithObjects:(id)a0, ... NS_REQUIRES_NIL_TERMINATION;",
                     "@interface NSOpenPanel : NSSavePanel"):
            self.assertIn(line, text)


class TheListings(unittest.TestCase):
    def test_scripts_call_a_method_by_all_its_words(self):
        self.assertEqual(script_name("tableView:shouldSelectRow:"), "tableViewShouldSelectRow")
        self.assertEqual(script_name("count"), "count")

    def test_a_function_among_arguments_is_one_argument(self):
        self.assertEqual(split_arguments("a: (p1: X, p2: Y) => void, b: Z<A, B>"), ["a: (p1: X, p2: Y) => void", " b: Z<A, B>"])
        self.assertEqual(split_arguments(""), [])

    def test_frameworks_have_their_names(self):
        names = tables_and_listings()[1].names
        self.assertIn("NSView", names["AppKit"]["class"])
        self.assertIn("NSString", names["Foundation"]["class"])
        self.assertNotIn("NSString", names["AppKit"]["class"])


if __name__ == "__main__":
    unittest.main()
