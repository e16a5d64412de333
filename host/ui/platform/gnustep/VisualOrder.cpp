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

std::u16string visualOrder(std::u16string_view text)
{
    if (!hasRightToLeft(text))
        return std::u16string(text);
    const std::u16string joined = withJoinedLetters(text);
    const std::unique_ptr<UBiDi, CloseBidi> bidi(ubidi_open());
    UErrorCode error = U_ZERO_ERROR;
    ubidi_setPara(bidi.get(), joined.data(), lengthOf(joined), 0, nullptr, &error);
    std::u16string visual(joined.size(), u'\0');
    const int32_t length = ubidi_writeReordered(bidi.get(), visual.data(), lengthOf(visual),
                                                UBIDI_DO_MIRRORING | UBIDI_KEEP_BASE_COMBINING, &error);
    if (U_FAILURE(error))
        return std::u16string(text);
    visual.resize(static_cast<std::size_t>(length));
    return visual;
}
} // namespace tessel::windowing
