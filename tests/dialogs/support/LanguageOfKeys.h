// A language that nobody speaks, to find texts that are not translated.
#pragma once

#import <AppKit/AppKit.h>

#include <set>
#include <string>

#include <objc/runtime.h>

// As long as this lasts, the words of the windows are their keys in brackets: "<OPEN>".
class LanguageOfKeys
{
public:
    LanguageOfKeys();
    ~LanguageOfKeys();
    LanguageOfKeys(const LanguageOfKeys&) = delete;
    LanguageOfKeys& operator=(const LanguageOfKeys&) = delete;

private:
    const Method kMethod = class_getInstanceMethod([NSBundle class], @selector(localizedStringForKey:
                                                                                               value:table:));
};

// What a person reads in the view and below it: titles, labels, headers, choices, tips. Not the rows of
// tables and the titles of folders.
std::set<std::wstring> textsIn(NSView* view);

// The texts that stand in a layout of the program's, which are translated with it.
std::set<std::wstring> textsOfLayout(NSString* name);
