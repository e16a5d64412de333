#include "host/lisp/LispOutput.h"

#include <utility>

namespace tessel
{
void LispOutput::connect(Write write, Column column)
{
    mWrite = std::move(write);
    mColumn = std::move(column);
    mPiece.clear();
}

void LispOutput::add(wchar_t character)
{
    mPiece += character;
    if (character == L'\n' || mPiece.size() >= kLongestPiece)
        flush();
}

void LispOutput::add(std::wstring_view text)
{
    for (const wchar_t character : text)
        add(character);
}

void LispOutput::flush()
{
    if (mPiece.empty())
        return;
    const std::wstring piece = std::exchange(mPiece, {});
    if (mWrite)
        mWrite(piece);
}

std::size_t LispOutput::column() const
{
    return mPiece.size() + (mColumn ? mColumn() : 0);
}
} // namespace tessel
