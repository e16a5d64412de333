// The toolkit cuts every character down to sixteen bits on its way to the font. Those that have more, emoji
// among them, arrive as letters that the font has not got, and are drawn as question marks. What was cut off
// is put back here, where the font is asked about a glyph or draws it: a glyph is a character there.
#include "host/ui/platform/gnustep/Glyphs.h"

#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSFontInfo.h>

#include <cairo.h>
#include <wincompat/winstring.h>

#include <algorithm>
#include <string>

#include "host/platform/gnustep/StandIn.h"

namespace tessel::windowing
{
namespace
{
constexpr NSGlyph kFirstCut = 0xE000; // below, letters of everyday scripts would be taken for others
constexpr NSGlyph kLastCut = 0xFFFF;
constexpr NSGlyph kSecondPlane = 0x10000;

using IsEncoded = BOOL (*)(id, SEL, NSGlyph);
using AdvancementFor = NSSize (*)(id, SEL, NSGlyph);
using DrawGlyphs = void (*)(id, SEL, const NSGlyph*, int, cairo_t*);
IsEncoded toolkitIsEncoded;
AdvancementFor toolkitAdvancementFor;
DrawGlyphs toolkitDrawGlyphs;

NSGlyph whole(GSFontInfo* font, NSGlyph glyph)
{
    if (glyph < kFirstCut || glyph > kLastCut)
        return glyph;
    NSCharacterSet* covered = [font coveredCharacterSet];
    if ([covered longCharacterIsMember:glyph] || ![covered longCharacterIsMember:kSecondPlane + glyph])
        return glyph;
    return kSecondPlane + glyph;
}

BOOL isEncoded(id font, SEL selector, NSGlyph glyph)
{
    return toolkitIsEncoded(font, selector, whole(font, glyph));
}

// As UTF-8, where the toolkit's own knows three bytes for a character at most.
std::string utf8(const std::wstring& characters)
{
    return [wcharToNSString(characters.c_str()) UTF8String];
}

cairo_scaled_font_t* scaledFontOf(id font)
{
    const Ivar variable = class_getInstanceVariable([font class], "_scaled");
    return variable ? reinterpret_cast<cairo_scaled_font_t*>(object_getIvar(font, variable)) : nullptr;
}

cairo_text_extents_t extentsOf(id font, NSGlyph character)
{
    cairo_text_extents_t extents{};
    if (cairo_scaled_font_t* scaled = scaledFontOf(font))
        cairo_scaled_font_text_extents(scaled, utf8({static_cast<wchar_t>(character)}).c_str(), &extents);
    return extents;
}

NSSize advancementFor(id font, SEL selector, NSGlyph glyph)
{
    const NSGlyph character = whole(font, glyph);
    if (character == glyph)
        return toolkitAdvancementFor(font, selector, glyph);
    return NSMakeSize(extentsOf(font, character).x_advance, 0);
}

bool isCut(id font, const NSGlyph* glyphs, int count)
{
    return std::any_of(glyphs, glyphs + count, [font](NSGlyph glyph) { return whole(font, glyph) != glyph; });
}

// With no glyph to draw, the toolkit chooses the font.
void drawGlyphs(id font, SEL selector, const NSGlyph* glyphs, int count, cairo_t* canvas)
{
    if (!isCut(font, glyphs, count))
        return toolkitDrawGlyphs(font, selector, glyphs, count, canvas);
    toolkitDrawGlyphs(font, selector, glyphs, 0, canvas);
    std::wstring text;
    for (int index = 0; index < count; ++index)
        text += static_cast<wchar_t>(whole(font, glyphs[index]));
    cairo_show_text(canvas, utf8(text).c_str());
}
} // namespace

void drawCharactersOfAnyLength()
{
    constexpr char kFont[] = "CairoFontInfo";
    toolkitIsEncoded = standInFor(kFont, @selector(glyphIsEncoded:), isEncoded);
    toolkitAdvancementFor = standInFor(kFont, @selector(advancementForGlyph:), advancementFor);
    toolkitDrawGlyphs = standInFor(kFont, @selector(drawGlyphs:length:on:), drawGlyphs);
}
} // namespace tessel::windowing
