// Following the nesting of Lisp source, with any text: it comes to the same whether the text arrives at once
// or character by character, and what is found too deep lies in the text.
#include <cstdint>
#include <cstdlib>

#include "host/lisp/LispSource.h"
#include "host/text/LispScanner.h"
#include "host/text/Unicode.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size == 0)
        return 0;
    const std::size_t limit = data[0];
    const std::wstring text = tessel::toWide(std::string(data + 1, data + size));
    tessel::LispScanner whole;
    whole.take(text);
    tessel::LispScanner single;
    std::size_t deepest = 0;
    for (const wchar_t character : text)
    {
        single.take(character);
        deepest = std::max(deepest, single.levels());
    }
    require(whole.isOpen() == single.isOpen() && whole.levels() == single.levels() &&
            whole.startOfForm() == single.startOfForm());
    require(whole.startOfForm() <= text.size() && deepest <= text.size());
    const auto tooDeep = tessel::findTooDeepForm(text, limit);
    require(tooDeep.has_value() == (deepest > limit));
    require(!tooDeep || *tooDeep < text.size());
    require(tessel::countLineBreaks(text) <= text.size());
    return 0;
}
