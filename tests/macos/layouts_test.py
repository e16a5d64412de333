"""The check of layouts finds mistakes in them. What it takes for given: one of the product's own passes, but for what is
known."""
import tempfile
import unittest
from pathlib import Path

from support import tables, write_files
from macos.bindings import BINDINGS
from macos.layouts import Layout
from macos.sources import Sources

HEADER = """@interface Row : NSObject
@property (nonatomic, readonly) NSString* fileName;
@end
@interface List : NSTableView
@end
@interface Owner : NSViewController <NSTableViewDelegate>
{
    IBOutlet NSTableView* rowsView;
    BOOL canRemove;
}
@property (nonatomic, assign) BOOL canRemove;
- (IBAction)onRemove:(id)sender;
- (void)another:(id)sender;
- (void)forget;
@end
@implementation Row
- (NSString*)fileName
{
}
@end
@implementation Owner
- (void)onRemove:(id)sender
{
    [rowsView setDataSource:self];
}
- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row
{
}
- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
}
@end
@implementation List
- (void)drawRow:(NSInteger)row clipRect:(NSRect)rect
{
}
@end
"""
LAYOUT = """<document><objects>
  <customObject id="-2" customClass="Owner"><connections>
    <outlet property="view" destination="box" id="c1"/>
    <outlet property="rowsView" destination="rows" id="c2"/>
  </connections></customObject>
  <customObject id="-1" customClass="FirstResponder"/>
  <arrayController objectClassName="Row" avoidsEmptySelection="NO" id="controller">
    <declaredKeys><string>fileName</string></declaredKeys></arrayController>
  <customView id="box"><subviews>
    <tableView customClass="List" id="rows"><accessibility description="Rows"/><tableColumns><tableColumn id="column">
      <tableHeaderCell key="headerCell" title="Name" id="header"/><connections>
        <binding destination="controller" name="value" keyPath="arrangedObjects.fileName" id="c3"/>
      </connections></tableColumn></tableColumns>
      <connections>
        <outlet property="delegate" destination="-2" id="c4"/>
        <binding destination="controller" name="selectionIndexes" keyPath="selectionIndexes" id="c5"/>
      </connections></tableView>
    <button id="remove"><buttonCell key="cell" title="Remove" id="remove-cell"/><connections>
        <action selector="onRemove:" target="-2" id="c6"/>
        <binding destination="-2" name="enabled" keyPath="canRemove" id="c7"/>
      </connections></button>
    <popUpButton id="kinds"><popUpButtonCell key="cell" selectedItem="item" id="kinds-cell"><accessibility description="Kinds"/>
      <menu key="menu" id="menu"><items><menuItem id="item"/></items></menu></popUpButtonCell>
      <connections><binding destination="controller" name="selectedIndex" keyPath="selectionIndex" id="c8"/></connections></popUpButton>
    <textField id="label"><textFieldCell key="cell" title="Files:" id="label-cell"/></textField>
    <tabView id="tabs"><tabViewItems><tabViewItem label="All" id="tab"/></tabViewItems></tabView>
  </subviews></customView>
</objects></document>
"""


class Layouts(unittest.TestCase):
    def faults(self, old="", new=""):
        self.assertIn(old, LAYOUT)
        with tempfile.TemporaryDirectory() as folder:
            header, layout = write_files(folder, {"Owner.h": HEADER, "Owner.xib": LAYOUT.replace(old, new, 1) if old else LAYOUT})
            return Layout(Path(layout), Sources([header]), tables()).faults()

    def finds(self, old, new, *faults):
        """Each fault begins with its line."""
        self.assertEqual(self.faults(old, new), [f"Owner.xib:{fault}" for fault in faults])

    def test_a_sound_layout_passes(self):
        self.assertEqual(self.faults(), [])

    def test_an_identifier_that_stands_there_twice_is_found(self):
        self.finds('id="remove-cell"', 'id="kinds-cell"', "22: kinds-cell (popUpButtonCell) stands there twice")

    def test_a_connection_with_nothing_is_found(self):
        self.finds('property="view" destination="box"', 'property="view" destination="bix"',
                   "3: c1 (outlet) connects -2 with bix, which is nowhere")

    def test_an_outlet_that_the_owner_has_not_is_found(self):
        self.finds('property="rowsView"', 'property="rowView"', "2: -2 (customObject) leaves the outlet rowsView of Owner empty",
                   "4: c2 (outlet) is an outlet rowView that Owner has not",
                   "10: rows (tableView) has no dataSource, and Owner has numberOfRowsInTableView:")

    def test_an_outlet_that_the_layout_leaves_empty_is_found(self):
        self.finds('<outlet property="view" destination="box" id="c1"/>', "",
                   "2: -2 (customObject) leaves the outlet view of Owner empty")

    def test_an_outlet_that_is_connected_twice_is_found(self):
        self.finds('<outlet property="view" destination="box" id="c1"/>',
                   '<outlet property="view" destination="box" id="c1"/><outlet property="view" destination="rows" id="c0"/>',
                   "2: -2 (customObject) connects the outlet view more than once")

    def test_an_outlet_that_the_system_has_not_is_found(self):
        self.finds('property="delegate"', 'property="delegates"',
                   "10: rows (tableView) has no delegate, and Owner has tableView:shouldSelectRow:",
                   "15: c4 (outlet) is an outlet delegates that List has not")

    def test_an_outlet_of_another_class_is_found(self):
        self.finds('property="view" destination="box"', 'property="view" destination="controller"',
                   "3: c1 (outlet) puts controller into view, which is for NSView")

    def test_a_delegate_that_answers_to_nothing_is_found(self):
        self.finds('property="delegate" destination="-2"', 'property="delegate" destination="remove"',
                   "15: c4 (outlet) puts remove into delegate, which is for id <NSTableViewDelegate>")

    def test_an_owner_that_is_not_asked_is_found(self):
        self.finds('<outlet property="delegate" destination="-2" id="c4"/>', "",
                   "10: rows (tableView) has no delegate, and Owner has tableView:shouldSelectRow:")

    def test_an_action_that_is_not_there_is_found(self):
        self.finds('"onRemove:"', '"onRemoved:"', "19: c6 (action) sends onRemoved:, which is no action of Owner")

    def test_a_method_that_is_no_action_is_found(self):
        self.finds('"onRemove:"', '"another:"', "19: c6 (action) sends another:, which is no action of Owner")

    def test_an_action_for_whoever_has_it_is_somebodys(self):
        self.assertEqual(self.faults('selector="onRemove:" target="-2"', 'selector="selectAll:" target="-1"'), [])
        self.finds('selector="onRemove:" target="-2"', 'selector="selectEach:" target="-1"',
                   "19: c6 (action) sends selectEach:, which is nobody's action")

    def test_a_button_that_sends_nothing_is_found(self):
        self.finds('<action selector="onRemove:" target="-2" id="c6"/>', "",
                   "18: remove (button) does nothing: it sends no action")

    def test_a_wrong_key_path_is_found(self):
        self.finds('keyPath="canRemove"', 'keyPath="canRemoved"', "20: c7 (binding) binds remove to canRemoved, which Owner has not")
        self.finds('keyPath="selectionIndexes"', 'keyPath="selectedIndexes"',
                   "16: c5 (binding) binds rows to selectedIndexes, which NSArrayController has not")

    def test_a_key_that_gives_nothing_is_found(self):
        self.finds('keyPath="canRemove"', 'keyPath="forget"', "20: c7 (binding) binds remove to forget, which Owner has not")

    def test_a_wrong_key_of_the_rows_is_found(self):
        self.finds("arrangedObjects.fileName", "arrangedObjects.filename",
                   "12: c3 (binding) binds column to filename, which Row has not")
        self.finds("<string>fileName", "<string>filename", "8: string declares filename, which Row has not")

    def test_rows_of_a_class_that_is_nowhere_are_found(self):
        self.finds('objectClassName="Row"', 'objectClassName="Rows"',
                   "7: controller (arrayController) has rows of the class Rows, which is nowhere",
                   "12: c3 (binding) binds column to arrangedObjects.fileName, which cannot be followed")

    def test_a_binding_that_is_not_there_is_found(self):
        self.finds('name="enabled"', 'name="enable"', "20: c7 (binding) binds enable, by which no NSButton can be bound")

    def test_a_binding_of_another_class_is_found(self):
        self.finds('name="selectionIndexes"', 'name="contentValues"',
                   "16: c5 (binding) binds contentValues, by which no NSTableView can be bound")

    def test_a_transformer_that_is_not_there_is_found(self):
        for name, faults in (("NSNegateBoolean", []), ("NSNegates", ["20: string names the transformer NSNegates, which the system has not"])):
            self.finds('keyPath="canRemove" id="c7"/>', 'keyPath="canRemove" id="c7"><dictionary key="options"><string '
                       f'key="NSValueTransformerName">{name}</string></dictionary></binding>', *faults)

    def test_bindings_and_their_classes_are_the_systems(self):
        self.assertEqual([name for name in BINDINGS if name not in tables().classes], [])
        names = set().union(*BINDINGS.values())
        self.assertEqual([name for name in names if f"NS{name[:1].upper()}{name[1:]}Binding" not in tables().constants], [])

    def test_another_element_that_is_named_and_not_there_is_found(self):
        self.finds('selectedItem="item"', 'selectedItem="items"',
                   "22: kinds-cell (popUpButtonCell) names items as its selectedItem, which is nowhere")

    def test_an_element_that_the_system_has_not_is_found(self):
        self.finds('<tabView id="tabs"><tabViewItems><tabViewItem label="All" id="tab"/></tabViewItems></tabView>', '<tabsView id="tabs"/>',
                   "26: tabs (tabsView) is nothing that the system has")

    def test_a_class_that_is_nowhere_is_found(self):
        self.finds('customClass="List"', 'customClass="Lists"', "10: rows (tableView) is of the class Lists, which is nowhere")

    def test_a_class_that_fits_its_element_not_is_found(self):
        self.finds('<button id="remove">', '<button id="remove" customClass="Row">',
                   "18: remove (button) is of the class Row, which is no NSButton",
                   "20: c7 (binding) binds enabled, by which no NSButton can be bound")

    def test_a_class_of_the_system_may_be_meant_by_its_name(self):
        self.assertEqual(self.faults('<button id="remove">', '<button id="remove" customClass="NSButton">'), [])

    def test_what_a_person_works_with_has_a_name(self):
        for words, line, who in ((' title="Remove"', 18, "remove (button)"), ('<accessibility description="Rows"/>', 10, "rows (tableView)"),
                                 ('<accessibility description="Kinds"/>', 22, "kinds (popUpButton)"), (' title="Files:"', 25, "label (textField)"),
                                 (' label="All"', 26, "tab (tabViewItem)"), (' title="Name"', 10, "column (tableColumn)")):
            self.finds(words, "", f"{line}: {who} has no name for a person who cannot see it")
        self.finds('description="Kinds"', 'description=" "', "22: kinds (popUpButton) has no name for a person who cannot see it")

    def test_controls_of_any_kind_need_one(self):
        for kind in ("searchField", "imageView", "datePicker", "outlineView", "textView"):
            self.finds('<textField id="label">', f'<{kind} id="new"/><textField id="label">',
                       f"25: new ({kind}) has no name for a person who cannot see it")

    def test_rows_that_select_the_first_of_them_are_found(self):
        self.finds(' avoidsEmptySelection="NO"', "", "7: controller (arrayController) selects its first row by itself")

    def test_what_is_no_layout_is_told_with_its_line(self):
        self.finds('<customView id="box">', '<customView id="box"', "9: is no layout: not well-formed (invalid token)")


if __name__ == "__main__":
    unittest.main()
