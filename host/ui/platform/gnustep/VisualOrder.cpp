#include "host/ui/platform/gnustep/VisualOrder.h"

#include <unicode/ubidi.h>
#include <unicode/ushape.h>
#include <unicode/utf16.h>

#include <memory>

namespace tessel::windowing
{
namespace
{
struct CloseBidi
{
    void operator()(UBiDi* bidi) const { ubidi_close(bidi); }
};

bool isRightToLeft(UChar32 character)
{
    const UCharDirection direction = u_charDirection(character);
    return direction == U_RIGHT_TO_LEFT || direction == U_RIGHT_TO_LEFT_ARABIC;
}

int32_t lengthOf(std::u16string_view text)
{
    return static_cast<int32_t>(text.size());
}

using Bidi = std::unique_ptr<UBiDi, CloseBidi>;

// What ends a line is written again by whoever puts the lines together.
int32_t endOfLine(std::u16string_view text, int32_t start, int32_t end)
{
    const auto isEnd = [&](int32_t index)
    {
        const char16_t unit = text[static_cast<std::size_t>(index)];
        return unit == u'\n' || unit == u'\r';
    };
    while (end > start && isEnd(end - 1))
        --end;
    return end;
}

bool appendLine(UBiDi* paragraph, int32_t start, int32_t end, std::u16string& visual)
{
    if (start == end)
        return true;
    const Bidi line(ubidi_open());
    UErrorCode error = U_ZERO_ERROR;
    ubidi_setLine(paragraph, start, end, line.get(), &error);
    std::u16string turned(static_cast<std::size_t>(end - start), u'\0');
    const int32_t length = ubidi_writeReordered(line.get(), turned.data(), lengthOf(turned),
                                                UBIDI_DO_MIRRORING | UBIDI_KEEP_BASE_COMBINING, &error);
    if (U_FAILURE(error))
        return false;
    visual.append(turned, 0, static_cast<std::size_t>(length));
    return true;
}
} // namespace

bool hasRightToLeft(std::u16string_view text)
{
    for (int32_t index = 0; index < lengthOf(text);)
    {
        UChar32 character = 0;
        U16_NEXT(text.data(), index, lengthOf(text), character);
        if (isRightToLeft(character))
            return true;
    }
    return false;
}

std::u16string withJoinedLetters(std::u16string_view text)
{
    std::u16string joined(text.size(), u'\0');
    UErrorCode error = U_ZERO_ERROR;
    const int32_t length = u_shapeArabic(text.data(), lengthOf(text), joined.data(), lengthOf(joined),
                                         U_SHAPE_LETTERS_SHAPE | U_SHAPE_LENGTH_FIXED_SPACES_NEAR, &error);
    if (U_FAILURE(error))
        return std::u16string(text);
    joined.resize(static_cast<std::size_t>(length));
    return joined;
}
std::u16string visualOrder(std::u16string_view text)
{
    if (!hasRightToLeft(text))
        return std::u16string(text);
    const std::u16string joined = withJoinedLetters(text);
    return visualLines(joined, {0});
}

std::u16string visualLines(std::u16string_view joined, const std::vector<std::size_t>& starts)
{
    const Bidi paragraph(ubidi_open());
    UErrorCode error = U_ZERO_ERROR;
    ubidi_setPara(paragraph.get(), joined.data(), lengthOf(joined), 0, nullptr, &error);
    std::u16string visual;
    for (std::size_t line = 0; line < starts.size(); ++line)
    {
        const std::size_t next = line + 1 < starts.size() ? starts[line + 1] : joined.size();
        const auto start = static_cast<int32_t>(starts[line]);
        if (line > 0)
            visual += u'\n';
        if (U_FAILURE(error) ||
            !appendLine(paragraph.get(), start, endOfLine(joined, start, static_cast<int32_t>(next)), visual))
            return std::u16string(joined);
    }
    return visual;
}
} // namespace tessel::windowing
