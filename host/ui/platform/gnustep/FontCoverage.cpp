#include "host/ui/platform/gnustep/FontCoverage.h"

#include <fontconfig/fontconfig.h>

#include <memory>

namespace tessel::windowing
{
namespace
{
template <class Object, void (*Destroy)(Object*)>
struct Destroying
{
    void operator()(Object* object) const { Destroy(object); }
};
using Pattern = std::unique_ptr<FcPattern, Destroying<FcPattern, FcPatternDestroy>>;
using Characters = std::unique_ptr<FcCharSet, Destroying<FcCharSet, FcCharSetDestroy>>;

const FcChar8* chars(const char* text)
{
    return reinterpret_cast<const FcChar8*>(text);
}

Pattern wantedFont(char32_t character, bool bold)
{
    Pattern pattern(FcPatternCreate());
    const Characters characters(FcCharSetCreate());
    FcCharSetAddChar(characters.get(), character);
    FcPatternAddCharSet(pattern.get(), FC_CHARSET, characters.get());
    FcPatternAddString(pattern.get(), FC_FAMILY, chars("sans-serif"));
    FcPatternAddInteger(pattern.get(), FC_WEIGHT, bold ? FC_WEIGHT_BOLD : FC_WEIGHT_REGULAR);
    // The toolkit draws outlines in one colour; fonts of coloured pictures would stay empty.
    FcPatternAddBool(pattern.get(), FC_SCALABLE, FcTrue);
    FcPatternAddBool(pattern.get(), FC_COLOR, FcFalse);
    FcConfigSubstitute(nullptr, pattern.get(), FcMatchPattern);
    FcDefaultSubstitute(pattern.get());
    return pattern;
}

bool has(const FcPattern* font, char32_t character)
{
    FcCharSet* covered = nullptr;
    return FcPatternGetCharSet(font, FC_CHARSET, 0, &covered) == FcResultMatch &&
           FcCharSetHasChar(covered, character);
}
} // namespace

std::string fontWith(char32_t character, bool bold)
{
    FcResult result = FcResultNoMatch;
    const Pattern font(FcFontMatch(nullptr, wantedFont(character, bold).get(), &result));
    FcChar8* name = nullptr;
    if (!font || !has(font.get(), character) ||
        FcPatternGetString(font.get(), FC_POSTSCRIPT_NAME, 0, &name) != FcResultMatch)
        return {};
    return reinterpret_cast<const char*>(name);
}
} // namespace tessel::windowing
