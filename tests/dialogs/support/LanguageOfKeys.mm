#include "tests/dialogs/support/LanguageOfKeys.h"

#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#include <regex>

namespace
{
using ReadTexts = std::set<std::wstring>;
using LocalizedString = NSString* (*)(id, SEL, NSString*, NSString*, NSString*);
LocalizedString gLocalizedString;

// The toolkit's own words are none of ours.
NSString* keyInBrackets(id bundle, SEL selector, NSString* key, NSString* value, NSString* table)
{
    const bool isOurs = bundle == [NSBundle mainBundle] && (!table || [table isEqual:@"Windows"]);
    return isOurs ? [NSString stringWithFormat:@"<%@>", key]
                  : gLocalizedString(bundle, selector, key, value, table);
}

void add(ReadTexts& texts, NSString* text)
{
    if ([text length])
        texts.insert(NSStringToWstring(text));
}

void addMenu(ReadTexts& texts, NSPopUpButton* menu)
{
    for (NSMenuItem* item : tsuiEach<NSMenuItem*>([menu itemArray]))
        if (![[item title] hasPrefix:@"/"]) // a folder
            add(texts, [item title]);
}

void addTabs(ReadTexts& texts, NSTabView* tabs)
{
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>([tabs tabViewItems]))
        add(texts, [item label]);
}

void addHeaders(ReadTexts& texts, NSTableView* table)
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        add(texts, [[column headerCell] stringValue]);
}

void addTextsOf(ReadTexts& texts, NSView* view)
{
    if ([view isKindOfClass:[NSPopUpButton class]])
        addMenu(texts, (NSPopUpButton*)view);
    else if ([view isKindOfClass:[NSButton class]])
        add(texts, [(NSButton*)view title]);
    else if ([view isKindOfClass:[NSTextField class]])
        add(texts, [(NSTextField*)view stringValue]);
    else if ([view isKindOfClass:[NSBox class]])
        add(texts, [(NSBox*)view title]);
    else if ([view isKindOfClass:[NSTabView class]])
        addTabs(texts, (NSTabView*)view);
    else if ([view isKindOfClass:[NSTableView class]])
        addHeaders(texts, (NSTableView*)view);
    add(texts, [view toolTip]);
}

void collectTexts(ReadTexts& texts, NSView* view)
{
    if ([view isKindOfClass:NSClassFromString(@"TsPathBar")])
        return;
    addTextsOf(texts, view);
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        collectTexts(texts, part);
}
} // namespace

LanguageOfKeys::LanguageOfKeys()
{
    gLocalizedString = LocalizedString(method_setImplementation(kMethod, IMP(keyInBrackets)));
}

LanguageOfKeys::~LanguageOfKeys()
{
    method_setImplementation(kMethod, IMP(gLocalizedString));
}

std::set<std::wstring> textsIn(NSView* view)
{
    ReadTexts texts;
    collectTexts(texts, view);
    return texts;
}

std::set<std::wstring> textsOfLayout(NSString* name)
{
    NSString* file = [[NSBundle mainBundle] pathForResource:name ofType:@"xib"];
    NSString* content = [NSString stringWithContentsOfFile:file encoding:NSUTF8StringEncoding error:nullptr];
    const std::wstring layout = content ? NSStringToWstring(content) : std::wstring();
    const std::wregex attribute(L" (title|label|toolTip)=\"([^\"]*)\"");
    ReadTexts texts;
    for (std::wsregex_iterator match(layout.begin(), layout.end(), attribute), end; match != end; ++match)
        texts.insert((*match)[2]);
    return texts;
}
