"""The check of layouts finds mistakes in them. What it takes for given: one of the product's own passes, but for what is
known."""
import tempfile
import unittest
from pathlib import Path

from support import tables, write_files
from macos.layouts import Layout
from macos.sources import Sources

HEADER = """@interface Row : NSObject
@property (nonatomic, readonly) NSString* fileName;
@end
@interface List : NSTableView
@end
@interface Owner : NSViewController
{
    IBOutlet NSTableView* rowsView;
    BOOL canRemove;
}
@property (nonatomic, assign) BOOL canRemove;
- (IBAction)onRemove:(id)sender;
- (void)another:(id)sender;
@end
@implementation Owner
- (void)onRemove:(id)sender
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
  <arrayController objectClassName="Row" avoidsEmptySelection="NO" id="controller"/>
  <customView id="box"><subviews>
    <tableView customClass="List" id="rows"><accessibility description="Rows"/><tableColumns><tableColumn id="column"><connections>
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
    <popUpButton id="kinds"><popUpButtonCell key="cell" id="kinds-cell"><accessibility description="Kinds"/></popUpButtonCell></popUpButton>
  </subviews></customView>
</objects></document>
"""


class Layouts(unittest.TestCase):
    def faults(self, old="", new=""):
        self.assertIn(old, LAYOUT)
        with tempfile.TemporaryDirectory() as folder:
            header, layout = write_files(folder, {"Owner.h": HEADER, "Owner.xib": LAYOUT.replace(old, new, 1) if old else LAYOUT})
            return Layout(Path(layout), Sources([header]), tables()).faults()

    def finds(self, old, new, fault):
        self.assertEqual(self.faults(old, new), [f"Owner.xib: {fault}"])

    def test_a_sound_layout_passes(self):
        self.assertEqual(self.faults(), [])

    def test_an_identifier_that_stands_there_twice_is_found(self):
        self.finds('id="remove-cell"', 'id="kinds-cell"', "kinds-cell (popUpButtonCell) stands there twice")

    def test_a_connection_with_nothing_is_found(self):
        self.finds('property="view" destination="box"', 'property="view" destination="bix"',
                   "-2 (customObject) is connected with bix, which is nowhere")

    def test_an_outlet_that_the_owner_has_not_is_found(self):
        self.finds('property="rowsView"', 'property="rowView"', "-2 (customObject) has no outlet rowView")

    def test_an_outlet_that_the_system_has_not_is_found(self):
        self.finds('property="delegate"', 'property="delegates"', "rows (tableView) has no outlet delegates")

    def test_an_outlet_of_another_class_is_found(self):
        self.finds('property="rowsView" destination="rows"', 'property="rowsView" destination="remove"',
                   "-2 (customObject) has the outlet rowsView for NSTableView, and remove is none")

    def test_an_action_that_is_not_there_is_found(self):
        self.finds('"onRemove:"', '"onRemoved:"', "remove (button) sends onRemoved:, which is no action of Owner")

    def test_a_method_that_is_no_action_is_found(self):
        self.finds('"onRemove:"', '"another:"', "remove (button) sends another:, which is no action of Owner")

    def test_a_wrong_key_path_is_found(self):
        self.finds('keyPath="canRemove"', 'keyPath="canRemoved"', "remove (button) is bound to canRemoved, which Owner has not")
        self.finds('keyPath="selectionIndexes"', 'keyPath="selectedIndexes"',
                   "rows (tableView) is bound to selectedIndexes, which NSArrayController has not")

    def test_a_wrong_key_of_the_rows_is_found(self):
        self.finds("arrangedObjects.fileName", "arrangedObjects.filename",
                   "column (tableColumn) is bound to filename, which Row has not")

    def test_a_binding_that_is_not_there_is_found(self):
        self.finds('name="enabled"', 'name="enable"', "remove (button) binds enable, which nothing can be bound by")

    def test_a_class_that_is_nowhere_is_found(self):
        self.finds('customClass="List"', 'customClass="Lists"', "rows (tableView) is of the class Lists, which is nowhere")

    def test_a_class_that_fits_its_element_not_is_found(self):
        self.finds('<button id="remove">', '<button id="remove" customClass="List">',
                   "remove (button) is of the class List, which is no NSButton")

    def test_a_control_without_a_name_is_found(self):
        self.finds(' title="Remove"', "", "remove (button) has no name for a person who cannot see it")
        self.finds('<accessibility description="Rows"/>', "", "rows (tableView) has no name for a person who cannot see it")

    def test_rows_that_select_the_first_of_them_are_found(self):
        self.finds(' avoidsEmptySelection="NO"', "", "controller (arrayController) selects its first row by itself")


if __name__ == "__main__":
    unittest.main()
