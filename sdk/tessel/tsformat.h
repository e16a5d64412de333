// printf-style formatting of wide text that cannot read what it was not given.
//
// Conversions: %d %i %u %x %X %o %c %s %f %e %g with flags, width and precision as in C (the length modifiers
// h, l, ll, j, z, t are accepted and change nothing: an argument brings its own size), and %% for one per
// cent sign. A conversion without an argument left, or whose argument is of another kind, and anything else
// after a per cent sign, prints as it stands; such a misfit consumes no argument. %n is never obeyed. A text
// that is itself the format may therefore hold whatever a file name may hold.
#pragma once

#include <concepts>
#include <cstddef>

#include "tsdefs.h"

// One argument with its kind.
class TsFormatArgument
{
public:
    enum class Kind
    {
        kInteger,
        kReal,
        kText
    };

    template <std::signed_integral Number>
    TsFormatArgument(Number number)
        : mKind(Kind::kInteger), mSigned(true), mInteger(number), mBytes(sizeof number)
    {
    }
    template <std::unsigned_integral Number>
    TsFormatArgument(Number number)
        : mKind(Kind::kInteger), mInteger(static_cast<long long>(number)), mBytes(sizeof number)
    {
    }
    TsFormatArgument(double number) : mKind(Kind::kReal), mReal(number) {}
    // A null text prints as "(null)".
    TsFormatArgument(const wchar_t* text) : mKind(Kind::kText), mText(text) {}

    Kind kind() const { return mKind; }
    bool isSigned() const { return mSigned; }
    // The number; an unsigned one converted modulo 2^64.
    long long integer() const { return mInteger; }
    // The size of the integer in bytes: what %x and %u of a negative number wrap at.
    std::size_t integerBytes() const { return mBytes; }
    double real() const { return mReal; }
    const wchar_t* text() const { return mText; }

private:
    Kind mKind;
    bool mSigned = false;
    long long mInteger = 0;
    std::size_t mBytes = 0;
    double mReal = 0;
    const wchar_t* mText = nullptr;
};

// Formats into the buffer, cut to `capacity` - 1 characters and always terminated when capacity is not 0.
// Answers the length of the whole text in characters, cut or not, without the terminator.
TESSEL_API std::size_t tsutFormatArguments(wchar_t* buffer, std::size_t capacity, const wchar_t* format,
                                           const TsFormatArgument* arguments, std::size_t count);

template <class... Arguments>
std::size_t tsutFormat(wchar_t* buffer, std::size_t capacity, const wchar_t* format,
                       const Arguments&... arguments)
{
    if constexpr (sizeof...(arguments) == 0)
        return tsutFormatArguments(buffer, capacity, format, nullptr, 0);
    else
    {
        const TsFormatArgument list[] = {TsFormatArgument(arguments)...};
        return tsutFormatArguments(buffer, capacity, format, list, sizeof...(arguments));
    }
}

// Prints on the host's command line; the text may be of any length. Answers the number of characters.
TESSEL_API int tsutPrintfArguments(const wchar_t* format, const TsFormatArgument* arguments,
                                   std::size_t count);

template <class... Arguments>
int tsutPrintf(const wchar_t* format, const Arguments&... arguments)
{
    if constexpr (sizeof...(arguments) == 0)
        return tsutPrintfArguments(format, nullptr, 0);
    else
    {
        const TsFormatArgument list[] = {TsFormatArgument(arguments)...};
        return tsutPrintfArguments(format, list, sizeof...(arguments));
    }
}
