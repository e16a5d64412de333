// The toolkit looks for another font where one lacks a character, but looks it up by the wrong kind of name
// and ends with the font that it began with: question marks. It draws every text from left to right, and
// takes backslashes for separators of paths.
#include "host/ui/platform/Scripts.h"

#import <AppKit/AppKit.h>

#include <algorithm>
#include <array>
#include <map>
#include <utility>
#include <vector>

#include <unicode/utf16.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/FontCoverage.h"
#include "host/ui/platform/gnustep/Glyphs.h"
#include "host/ui/platform/gnustep/VisualOrder.h"

// Of the toolkit's library; no header declares it.
extern "C" const char* GSPathHandling(const char* mode);

namespace tessel::windowing
{
namespace
{
using FontKey = std::pair<char32_t, bool>;

bool isBold(NSFont* font)
{
    return [[NSFontManager sharedFontManager] traitsOfFont:font] & NSBoldFontMask;
}

// Asked once for each character.
NSString* nameOfFontWith(char32_t character, bool bold)
{
    static std::map<FontKey, NSString*> names;
    const auto [place, isNew] = names.try_emplace(FontKey(character, bold), nil);
    if (isNew)
        place->second = [[NSString alloc] initWithUTF8String:fontWith(character, bold).c_str()];
    return place->second;
}

// Answers the font itself when there is no other.
NSFont* fontFor(char32_t character, NSFont* font)
{
    if ([[font coveredCharacterSet] longCharacterIsMember:character])
        return font;
    NSString* name = nameOfFontWith(character, isBold(font));
    NSFont* other = [name length] ? [NSFont fontWithName:name size:[font pointSize]] : nil;
    return other ? other : font;
}

// The character that begins there, and how many units it takes.
std::pair<char32_t, NSUInteger> characterAt(NSString* text, NSUInteger index)
{
    std::array<unichar, U16_MAX_LENGTH> units{};
    const NSUInteger count = std::min<NSUInteger>(units.size(), [text length] - index);
    [text getCharacters:units.data() range:NSMakeRange(index, count)];
    UChar32 character = 0;
    NSUInteger length = 0;
    U16_NEXT(units, length, count, character);
    return {static_cast<char32_t>(character), length};
}

bool isDrawn(char32_t character)
{
    NSCharacterSet* spaces = [NSCharacterSet whitespaceAndNewlineCharacterSet];
    NSCharacterSet* controls = [NSCharacterSet controlCharacterSet];
    return ![spaces longCharacterIsMember:character] && ![controls longCharacterIsMember:character] &&
           character != NSAttachmentCharacter;
}

void fixFontOf(NSMutableAttributedString* text, NSRange range, char32_t character)
{
    NSFont* font = [text attribute:NSFontAttributeName atIndex:range.location effectiveRange:nullptr];
    if (!font || !isDrawn(character))
        return;
    NSFont* other = fontFor(character, font);
    if (other != font)
        [text addAttribute:NSFontAttributeName value:other range:range];
}

void fixFonts(NSMutableAttributedString* text, SEL, NSRange range)
{
    for (NSUInteger index = range.location; index < NSMaxRange(range);)
    {
        const auto [character, length] = characterAt([text string], index);
        if (character > 0x7F)
            fixFontOf(text, NSMakeRange(index, length), character);
        index += length;
    }
}

// A name in a list, a line of a message: text of one kind.
bool isPlain(NSAttributedString* text)
{
    NSRange range = NSMakeRange(0, 0);
    if ([text length])
        [text attributesAtIndex:0 effectiveRange:&range];
    return range.length == [text length];
}

std::u16string unitsOf(NSString* text)
{
    std::vector<unichar> units([text length] + 1);
    [text getCharacters:units.data() range:NSMakeRange(0, [text length])];
    return std::u16string(units.begin(), units.end() - 1);
}

NSString* stringOf(const std::u16string& units)
{
    const std::vector<unichar> characters(units.begin(), units.end());
    return [NSString stringWithCharacters:characters.data() length:characters.size()];
}

NSString* visual(NSString* text)
{
    const std::u16string units = unitsOf(text);
    return hasRightToLeft(units) ? stringOf(visualOrder(units)) : text;
}

NSAttributedString* visual(NSAttributedString* text)
{
    NSString* ordered = isPlain(text) ? visual([text string]) : [text string];
    if (ordered == [text string])
        return text;
    NSDictionary* attributes = [text attributesAtIndex:0 effectiveRange:nullptr];
    return [[[NSAttributedString alloc] initWithString:ordered attributes:attributes] autorelease];
}

bool wraps(NSDictionary* attributes)
{
    NSParagraphStyle* style = [attributes objectForKey:NSParagraphStyleAttributeName];
    if (!style)
        return true;
    const NSLineBreakMode mode = [style lineBreakMode];
    return mode == NSLineBreakByWordWrapping || mode == NSLineBreakByCharWrapping;
}

// Where the toolkit begins the lines of a text that it draws in a place of this width.
std::vector<std::size_t> lineStarts(NSAttributedString* text, CGFloat width)
{
    constexpr CGFloat kHeightAllowed = 100000;
    NSTextStorage* storage = [[[NSTextStorage alloc] initWithAttributedString:text] autorelease];
    NSLayoutManager* layout = [[[NSLayoutManager alloc] init] autorelease];
    NSTextContainer* container =
        [[[NSTextContainer alloc] initWithContainerSize:NSMakeSize(width, kHeightAllowed)] autorelease];
    [container setLineFragmentPadding:0];
    [layout addTextContainer:container];
    [storage addLayoutManager:layout];
    std::vector<std::size_t> starts;
    NSRange line = NSMakeRange(0, 0);
    for (NSUInteger glyph = 0; glyph < [layout numberOfGlyphs]; glyph = std::max(glyph + 1, NSMaxRange(line)))
    {
        [layout lineFragmentRectForGlyphAtIndex:glyph effectiveRange:&line];
        starts.push_back([layout characterIndexForGlyphAtIndex:glyph]);
    }
    return starts;
}

NSAttributedString* visualWithin(NSAttributedString* text, CGFloat width)
{
    const std::u16string units = unitsOf([text string]);
    if (!isPlain(text) || !hasRightToLeft(units))
        return text;
    NSDictionary* attributes = [text attributesAtIndex:0 effectiveRange:nullptr];
    if (!wraps(attributes))
        return visual(text);
    const std::u16string joined = withJoinedLetters(units);
    NSAttributedString* shaped = [[[NSAttributedString alloc] initWithString:stringOf(joined)
                                                                  attributes:attributes] autorelease];
    NSString* lines = stringOf(visualLines(joined, lineStarts(shaped, width)));
    return [[[NSAttributedString alloc] initWithString:lines attributes:attributes] autorelease];
}

using DrawInRect = void (*)(id, SEL, NSRect, id);
using DrawAtPoint = void (*)(id, SEL, NSPoint, id);
using DrawTextInRect = void (*)(id, SEL, NSRect);
using DrawTextAtPoint = void (*)(id, SEL, NSPoint);
DrawInRect toolkitDrawInRect;
DrawAtPoint toolkitDrawAtPoint;
DrawTextInRect toolkitDrawTextInRect;
DrawTextAtPoint toolkitDrawTextAtPoint;

void drawInRect(NSString* text, SEL selector, NSRect rect, id attributes)
{
    toolkitDrawInRect(visual(text), selector, rect, attributes);
}

void drawAtPoint(NSString* text, SEL selector, NSPoint point, id attributes)
{
    toolkitDrawAtPoint(visual(text), selector, point, attributes);
}

void drawTextInRect(NSAttributedString* text, SEL selector, NSRect rect)
{
    toolkitDrawTextInRect(visualWithin(text, NSWidth(rect)), selector, rect);
}

void drawTextAtPoint(NSAttributedString* text, SEL selector, NSPoint point)
{
    toolkitDrawTextAtPoint(visual(text), selector, point);
}
} // namespace

void showEveryScript()
{
    GSPathHandling("unix");
    drawCharactersOfAnyLength();
    standInFor("NSMutableAttributedString", @selector(fixFontAttributeInRange:), fixFonts);
    toolkitDrawInRect = standInFor("NSString", @selector(drawInRect:withAttributes:), drawInRect);
    toolkitDrawAtPoint = standInFor("NSString", @selector(drawAtPoint:withAttributes:), drawAtPoint);
    toolkitDrawTextInRect = standInFor("NSAttributedString", @selector(drawInRect:), drawTextInRect);
    toolkitDrawTextAtPoint = standInFor("NSAttributedString", @selector(drawAtPoint:), drawTextAtPoint);
}
} // namespace tessel::windowing
