// Why a file is not mapped, in the words that are the same in whatever form libraries have on a platform.
#pragma once

#include "host/text/Result.h"
#include "host/text/Translation.h"

namespace tessel::refusal
{
inline constexpr auto kNoLibrary = Sentence(L"it is not a shared library");
inline constexpr auto kIsProgram = Sentence(L"it is a program, not a shared library");
inline constexpr auto kOtherMachine = Sentence(L"it is built for another kind of processor");
inline constexpr auto kCutShort = Sentence(L"the file is cut short");
inline constexpr auto kDamaged = Sentence(L"its program headers are damaged");

inline Failure refused(Sentence<> reason)
{
    return {translated(reason)};
}
} // namespace tessel::refusal
