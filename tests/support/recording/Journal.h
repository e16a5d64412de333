// Every call that the recording host got, in order, one text per call: "loadModule(/a/tool.zmb, true, true)".
//
// A text is the call's name and, in parentheses, the arguments a test may care about: texts as they stand
// without quotes, numbers in decimal, truth as true or false, null as null. Handles and buffers are left out.
#pragma once

#include <concepts>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

// A text that a caller may leave out.
inline std::wstring orEmpty(const wchar_t* text)
{
    return text ? text : L"";
}

class Journal
{
public:
    // One argument as text.
    struct Argument
    {
        Argument(const wchar_t* value) : text(value ? value : L"null") {}
        Argument(const std::wstring& value) : text(value) {}
        Argument(std::same_as<bool> auto value) : text(value ? L"true" : L"false") {}
        template <class Number>
        requires std::integral<Number> &&(!std::same_as<Number, bool>)Argument(Number value)
            : text(std::to_wstring(value))
        {
        }

        std::wstring text;
    };

    void add(std::wstring_view call, std::initializer_list<Argument> arguments = {});

    const std::vector<std::wstring>& entries() const { return mEntries; }

    // The entries of one call, or of all whose name begins like this, in order.
    std::vector<std::wstring> entriesOf(std::wstring_view call) const;
    std::size_t count(std::wstring_view call) const { return entriesOf(call).size(); }

    void clear() { mEntries.clear(); }

private:
    std::vector<std::wstring> mEntries;
};
