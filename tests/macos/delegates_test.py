"""The check of methods that are called by name finds those that nobody will ever call."""
import tempfile
import unittest

from support import tables, write_files
from macos import delegates, ways
from macos.sources import Sources, messages, selector_of, types_in

HEADER = """@interface Owner : NSView <NSTableViewDelegate>
- (IBAction)onRemove:(id)sender;
- (void)forget;
+ (Owner*)newOwner;
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
- (void)scrollWheel:(NSEvent*)event /* of
two lines */
{
    [super scrollWheel:event];
    [self isKept:1 of:[@"a[" length] ? nil : [self view]];
}
- (NSString*)view:(NSView*)view stringForToolTip:(NSToolTipTag)tag point:(NSPoint)place userData:(void*)data
{
    return nil;
}
+ (void)initialize
{
}
+ (Owner*)newOwner
{
    return nil;
}
@end
"""
LAYOUT = '<action selector="onRemove:" target="-2" id="1"/>'


class Delegates(unittest.TestCase):
    def faults(self, old="", new="", layout=LAYOUT, header=HEADER):
        self.assertIn(old, SOURCE)
        texts = {"Owner.h": header, "Owner.mm": SOURCE.replace(old, new, 1) if old else SOURCE, "Owner.xib": layout}
        with tempfile.TemporaryDirectory() as folder:
            header, source, xib = write_files(folder, texts)
            return list(delegates.faults(Sources([header, source], layouts=[xib]), tables()))

    def test_methods_that_the_system_or_we_call_pass(self):
        self.assertEqual(self.faults(), [])

    def finds(self, old, new, line, fault):
        self.assertEqual(self.faults(old, new), [f"Owner.mm:{line}: Owner has {fault}"])

    def test_a_misspelt_delegates_method_is_found(self):
        self.finds("shouldSelectRow:", "shouldSelectTheRow:", 2,
                   "tableView:shouldSelectTheRow:, which nothing in the system sends")

    def test_a_misspelt_method_of_a_data_source_is_found(self):
        self.finds("numberOfRowsInTableView:", "numberOfRowsInTable:", 7, "numberOfRowsInTable:, which nobody calls")

    def test_a_misspelt_override_is_found(self):
        self.finds("hash", "hashed", 29, "hashed, which nobody calls")

    def test_any_word_of_a_method_may_be_the_misspelt_one(self):
        self.finds("userData:", "userDates:", 39, "view:stringForToolTip:point:userDates:, which nobody calls")
        self.finds("isKept:(NSInteger)row of:", "isKept:(NSInteger)row off:", 11, "isKept:off:, which nobody calls")

    def test_to_send_the_right_one_on_does_not_hide_the_misspelt_one(self):
        self.finds("scrollWheel:(NSEvent*)event ", "scrollWheel:(NSEvent*)event more:(BOOL)more ", 33,
                   "scrollWheel:more:, which nobody calls")

    def test_other_types_than_the_system_expects_are_found(self):
        self.finds("- (BOOL)tableView:", "- (NSInteger)tableView:", 2,
                   "tableView:shouldSelectRow: with other types than the system's")
        self.finds("shouldSelectRow:(NSInteger)row", "shouldSelectRow:(NSNumber*)row", 2,
                   "tableView:shouldSelectRow: with other types than the system's")
        self.finds("point:(NSPoint)place", "point:(NSPoint*)place", 39,
                   "view:stringForToolTip:point:userData: with other types than the system's")
        self.finds("- (NSUInteger)hash", "- (NSString*)hash", 29, "hash with other types than the system's")

    def test_a_method_of_ours_may_be_called_like_one_of_a_protocol(self):
        self.assertIn("load:", {method.selector for method in tables().protocols["CIPlugInRegistration"].methods})
        self.assertEqual(self.faults("- (void)forget\n", "- (void)load:(id)what\n{\n    [self load:what];\n}\n- (void)forget\n"), [])

    def test_types_are_read_from_declarations(self):
        self.assertEqual(types_in(" (void)do:(void (^)(int a, id b))it with:(id<Some>)other"), ["void", "void (^)(int a, id b)", "id<Some>"])
        self.assertEqual(ways.of_written(["void", "void (^)(int a)", "id<Some>", "const NSRect", "NSTableViewDropOperation", "CGFloat"]),
                         ["void", "address", "address", "structure", "number", "floating"])

    def test_a_misspelt_method_of_the_class_is_found(self):
        self.finds("+ (void)initialize", "+ (void)initialise", 43, "the class's method initialise, which nobody calls")

    def test_a_method_that_no_source_for_this_system_has_is_found(self):
        promise = "- (void)forget;\n"
        header = HEADER.replace(promise, promise + "- (BOOL)isKept:(NSInteger)row;\n+ (void)loadAll;\n") + \
            "@interface NSObject (Rows)\n- (BOOL)isKept:(NSInteger)row of:(NSTableView*)table;\n- (void)sortRows;\n@end\n"
        self.assertEqual(self.faults(header=header),
                         ["Owner.h:4: Owner promises isKept:, which no source for macOS has",
                          "Owner.h:5: Owner promises loadAll, which no source for macOS has",
                          "Owner.h:10: NSObject promises sortRows, which no source for macOS has"])

    def test_a_method_that_only_a_comment_calls_is_found(self):
        self.finds("[self forget]", "// [self forget]", 15, "forget, which nobody calls")

    def test_an_action_that_no_layout_sends_is_found(self):
        self.assertEqual(self.faults(layout=""), ["Owner.mm:22: Owner has onRemove:, which nobody calls"])

    def test_messages_are_read_however_they_stand_in_each_other(self):
        text = "[[a b] c:[d[1] e] d:NS::kOne ? x : y]; f([=] { return [g h]; }); \"[i j]\"; '['"
        self.assertEqual(sorted(messages(text)), [("()", "c:d:"), ("1", "1"), ("=", "="), ("a", "b"), ("d", "e"), ("g", "h")])

    def test_selectors_are_read_from_declarations(self):
        self.assertEqual(selector_of(" (void)show"), "show")
        self.assertEqual(selector_of(" (void)do:(void (^)(int a, id b))it with:(id<Some>)other"), "do:with:")


if __name__ == "__main__":
    unittest.main()
