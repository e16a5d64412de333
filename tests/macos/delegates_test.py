"""The check of methods that are called by name finds those that nobody will ever call."""
import tempfile
import unittest

from support import tables, write_files
from macos import delegates
from macos.sources import Sources, selector_of

HEADER = """@interface Owner : NSObject <NSTableViewDelegate>
- (IBAction)onRemove:(id)sender;
- (void)forget;
@end
"""
SOURCE = """@implementation Owner
- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row
{
    [self forget];
    return [self isKept:row of:table];
}
- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    return 0;
}
- (BOOL)isKept:(NSInteger)row of:(NSTableView*)table // a comment: [self unused]
{
    return YES;
}
- (void)forget
{
}
- (BOOL)panel:(id)panel shouldShowFilename:(NSString*)name
{
    return YES;
}
- (void)onRemove:(id)sender
{
}
- (void)onNotice:(NSNotification*)notice
{
    [center addObserver:self selector:@selector(onNotice:) name:@"x" object:nil];
}
- (NSUInteger)hash
{
    return 1;
}
@end
"""
LAYOUT = '<action selector="onRemove:" target="-2" id="1"/>'


class Delegates(unittest.TestCase):
    def faults(self, old="", new="", layout=LAYOUT):
        self.assertIn(old, SOURCE)
        texts = {"Owner.h": HEADER, "Owner.mm": SOURCE.replace(old, new, 1) if old else SOURCE, "Owner.xib": layout}
        with tempfile.TemporaryDirectory() as folder:
            header, source, xib = write_files(folder, texts)
            return list(delegates.faults(Sources([header, source], layouts=[xib]), tables()))

    def test_methods_that_the_system_or_we_call_pass(self):
        self.assertEqual(self.faults(), [])

    def test_a_misspelt_delegates_method_is_found(self):
        self.assertEqual(self.faults("shouldSelectRow:", "shouldSelectTheRow:"),
                         ["Owner.mm: Owner has tableView:shouldSelectTheRow:, which nothing in the system sends"])

    def test_a_misspelt_method_of_a_data_source_is_found(self):
        self.assertEqual(self.faults("numberOfRowsInTableView:", "numberOfRowsInTable:"),
                         ["Owner.mm: Owner has numberOfRowsInTable:, which nobody calls"])

    def test_a_misspelt_override_is_found(self):
        self.assertEqual(self.faults("hash", "hashed"), ["Owner.mm: Owner has hashed, which nobody calls"])

    def test_a_method_that_only_a_comment_calls_is_found(self):
        self.assertEqual(self.faults("- (void)forget\n", "- (void)unused\n"), ["Owner.mm: Owner has unused, which nobody calls"])

    def test_an_action_that_no_layout_sends_is_found(self):
        self.assertEqual(self.faults(layout=""), ["Owner.mm: Owner has onRemove:, which nobody calls"])

    def test_selectors_are_read_from_declarations(self):
        self.assertEqual(selector_of(" (void)show"), "show")
        self.assertEqual(selector_of(" (void)do:(void (^)(int a, id b))it with:(id<Some>)other"), "do:with:")


if __name__ == "__main__":
    unittest.main()
