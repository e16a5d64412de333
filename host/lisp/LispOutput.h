// What Lisp prints, gathered: Lisp hands over single characters.
#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

namespace tessel
{
class LispOutput
{
public:
    using Write = std::function<void(std::wstring_view)>;
    using Column = std::function<std::size_t()>;

    // `write` takes a piece: a line with its break, or what there is when `flush` is called or a piece gets
    // long. `column` tells how many characters stand on the open line already.
    void connect(Write write, Column column);

    void add(wchar_t character);
    void add(std::wstring_view text);
    void flush();

    // Characters on the open line, those that wait included.
    std::size_t column() const;

private:
    static constexpr std::size_t kLongestPiece = 4096;

    Write mWrite;
    Column mColumn;
    std::wstring mPiece; // never holds a line break
};
} // namespace tessel
