// Pictures that are sharp on screens of one, two and three pixels a point: name.png, name@2x.png,
// name@3x.png.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// The picture of that name in the folder; nil when there is none.
NSImage* pictureIn(NSString* folder, NSString* name);

// Gives the theme's pictures of controls, which the toolkit finds by itself, their sharper versions.
void sharpenControls(NSString* themeResources);

// Lets files be shown by icons of one family, from the theme's folder.
void useFileIcons(NSString* themeResources);

// The icon of the file, by what it is called; a folder's unless its kind of application comes as one.
NSImage* iconOfFile(NSString* path, bool isFolder);
} // namespace tessel::windowing
