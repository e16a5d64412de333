"""The check of names in texts finds those that nothing has."""
import tempfile
import unittest

from support import tables, write_files
from macos import names
from macos.sources import Sources

SOURCE = """@implementation Row
- (NSString*)fileName
{
    return [self valueForKey:@"title"]; // [self valueForKey:@"none"]
}
- (NSString*)windowNibName
{
    return @"Window";
}
- (id)init
{
    [self willChangeValueForKey:@"fileName"];
    [item setAction:NSSelectorFromString(@"undo:")];
    [view valueForKeyPath:@"window.title"];
    return [super initWithNibName:@"Window" bundle:nil];
}
@end
"""


class Names(unittest.TestCase):
    def faults(self, old="", new=""):
        self.assertIn(old, SOURCE)
        with tempfile.TemporaryDirectory() as folder:
            file, = write_files(folder, {"Row.mm": SOURCE.replace(old, new, 1) if old else SOURCE})
            return list(names.faults([file], Sources([file]), tables(), ["Window"]))

    def finds(self, old, new, fault):
        self.assertEqual(self.faults(old, new), [f"Row.mm:{fault}"])

    def test_what_something_has_passes(self):
        self.assertEqual(self.faults(), [])

    def test_a_misspelt_key_is_found(self):
        self.finds('Key:@"title"', 'Key:@"titles"', "4: reads the key titles, which nothing has")
        self.finds('Key:@"fileName"', 'Key:@"fileNome"', "12: reads the key fileNome, which nothing has")
        self.finds("window.title", "windows.titel", "14: reads the key titel, which nothing has")

    def test_a_misspelt_selector_is_found(self):
        self.finds('@"undo:"', '@"undoes:"', "13: names undoes:, to which nothing answers")

    def test_a_layout_that_is_nowhere_is_found(self):
        self.finds('return @"Window"', 'return @"Windows"', "8: loads the layout Windows, which is nowhere")
        self.finds('NibName:@"Window"', 'NibName:@"Windows"', "15: loads the layout Windows, which is nowhere")


if __name__ == "__main__":
    unittest.main()
