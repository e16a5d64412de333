"""A compiler with the declarations from Apple's tables finds what a Mac's would: mistakes put in on purpose."""
import json
import unittest

from support import BUILD, clang

VIEW = """#import <AppKit/AppKit.h>
void use(NSView* view, NSWindow* window, id anything)
{{
    (void)view, (void)window, (void)anything;
    {0}
}}
"""


class Compiler(unittest.TestCase):
    def accepts(self, line):
        taken, said = clang(VIEW.format(line), "-fsyntax-only")
        self.assertTrue(taken, said)

    def refuses(self, line, reason):
        taken, said = clang(VIEW.format(line), "-fsyntax-only")
        self.assertFalse(taken, line)
        self.assertIn(reason, said)

    def test_what_a_class_and_its_parents_answer_to_is_accepted(self):
        self.accepts("[view setNeedsDisplay:YES];")
        self.accepts("[window makeKeyAndOrderFront:nil]; [window setNextResponder:view];")
        self.accepts('[window setTitle:@"x"]; [window valueForKey:@"title"];')
        self.accepts("[anything setNeedsDisplay:YES];")

    def test_a_misspelt_message_is_found(self):
        self.refuses("[view setNeedsDisplays:YES];", "'-setNeedsDisplays:' not found")
        self.refuses("[NSOpenPanel openPanels];", "class method '+openPanels' not found")

    def test_a_message_of_another_class_is_found(self):
        self.refuses("[view makeKeyAndOrderFront:nil];", "'NSView' may not respond to 'makeKeyAndOrderFront:'")

    def test_a_message_that_no_class_answers_to_is_found_whoever_gets_it(self):
        self.refuses("[anything setNeedsDisplays:YES];", "'-setNeedsDisplays:' not found")

    def test_too_few_arguments_are_found(self):
        self.refuses("[view addSubview:view positioned:NSWindowAbove];", "'-addSubview:positioned:' not found")

    def test_a_misspelt_name_of_a_message_is_found(self):
        self.refuses("[anything setAction:@selector(terminated:)];", "undeclared selector 'terminated:'")

    def test_a_constant_that_is_not_there_is_found(self):
        self.accepts("[view setAutoresizingMask:NSViewWidthSizable];")
        self.refuses("[view setAutoresizingMask:NSViewWidthSizeable];", "NSViewWidthSizeable")
        self.refuses("[anything isEqual:NSFilenamesPboardTypes];", "NSFilenamesPboardTypes")

    def test_members_of_enumerations_have_the_systems_names(self):
        for name in ("NSBackingStoreBuffered", "NSEventModifierFlagCommand", "NSTextAlignmentRight", "NSOrderedSame",
                     "NSLineBreakByWordWrapping", "NSStringDrawingUsesLineFragmentOrigin", "NSTableViewDropAbove"):
            self.accepts(f"(void){name};")

    def test_a_class_that_is_not_there_is_found(self):
        self.refuses("[NSOpenPanels openPanel];", "NSOpenPanels")

    def test_an_argument_of_another_kind_is_found(self):
        self.refuses("[view addSubview:window];", "'NSView *'")
        self.refuses("[(NSTableView*)view setDelegate:window];", "NSTableViewDelegate")

    def test_a_call_that_is_out_of_use_is_found(self):
        self.refuses("[[NSOpenPanel openPanel] setDirectory:@\"/\"];", "'setDirectory:' is deprecated")

    def test_a_list_that_does_not_end_is_found(self):
        self.accepts("[NSArray arrayWithObjects:view, nil];")
        self.refuses("[NSArray arrayWithObjects:view, window];", "missing sentinel")

    def test_what_the_oldest_system_has_not_got_is_found(self):
        taken, said = clang("#include <charconv>\nvoid use(char* text)\n{\n    std::to_chars(text, text + 9, 1.5);\n}\n",
                            "-fsyntax-only", name="source.cpp")
        self.assertFalse(taken)
        self.assertIn("to_chars", said)

    def test_what_linux_alone_has_is_not_there(self):
        taken, said = clang("#include <elf.h>\n", "-fsyntax-only", name="source.cpp")
        self.assertFalse(taken)
        self.assertIn("elf.h", said)


class TheBuild(unittest.TestCase):
    """What is shown here of the compiler holds for the sources only when it is asked in the same way."""

    def commands(self, *endings):
        told = json.loads((BUILD / "arm64/compile_commands.json").read_text(encoding="utf-8"))
        return [(entry["file"], set(entry["command"].split())) for entry in told if entry["file"].endswith(endings)]

    def test_every_source_is_compiled_with_warnings_as_errors(self):
        commands = self.commands(".cpp", ".cxx", ".mm", ".m")
        self.assertGreater(len(commands), 50)
        self.assertEqual([file for file, words in commands if not {"-Wall", "-Wextra", "-Werror"} <= words or "-w" in words], [])

    def test_no_warning_about_messages_is_switched_off(self):
        commands = self.commands(".mm")
        self.assertEqual([file for file, words in commands if "-Wundeclared-selector" not in words], [])
        without = {word for _, words in commands for word in words if word.startswith("-Wno-")}
        self.assertLessEqual(without, {"-Wno-deprecated-declarations", "-Wno-unused-command-line-argument", "-Wno-unused-parameter"})


if __name__ == "__main__":
    unittest.main()
