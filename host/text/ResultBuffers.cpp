#include "host/text/ResultBuffers.h"

#include <cwchar>
#include <memory>
#include <utility>

namespace
{
constexpr std::size_t kLong = 16; // buffers; a list of fewer is built as quickly as it is compared

wchar_t* copyText(std::wstring_view text)
{
    auto* copy = new wchar_t[text.size() + 1];
    std::wmemcpy(copy, text.data(), text.size());
    copy[text.size()] = L'\0';
    return copy;
}

TsResultBuffer* newBuffer(std::wstring_view text)
{
    return new TsResultBuffer{.next = nullptr, .type = TS_STRING, .value = {.string = copyText(text)}};
}

TsResultBuffer* newBuffer(const TsRbValue& value)
{
    if (value.type() == TS_STRING)
        return newBuffer(std::wstring_view(value.text() ? value.text() : L""));
    auto* buffer = new TsResultBuffer{.next = nullptr, .type = value.type(), .value = {.real = 0}};
    switch (value.type())
    {
    case TS_SHORT:
        buffer->value.shortNumber = static_cast<std::int16_t>(value.number());
        break;
    case TS_LONG:
        buffer->value.longNumber = value.number();
        break;
    case TS_REAL:
        buffer->value.real = value.real();
        break;
    default: // truth values carry nothing else
        break;
    }
    return buffer;
}

void freeBuffers(TsResultBuffer* list)
{
    while (list)
    {
        const std::unique_ptr<TsResultBuffer> buffer(list);
        list = list->next;
        if (buffer->type == TS_STRING)
            delete[] buffer->value.string;
    }
}

bool isLong(const TsResultBuffer* list)
{
    std::size_t length = 0;
    for (; list && length < kLong; list = list->next)
        ++length;
    return length == kLong;
}

// The long list that was freed last. Whoever had it may have changed everything in it.
class KeptList
{
public:
    KeptList() = default;
    ~KeptList() { freeBuffers(mFirst); }
    KeptList(const KeptList&) = delete;
    KeptList& operator=(const KeptList&) = delete;

    void keep(TsResultBuffer* list) { freeBuffers(std::exchange(mFirst, list)); }
    TsResultBuffer* take() { return std::exchange(mFirst, nullptr); }

private:
    TsResultBuffer* mFirst = nullptr;
};

thread_local KeptList theKeptList;

bool says(const TsResultBuffer& buffer, std::wstring_view text)
{
    const wchar_t* const said = buffer.type == TS_STRING ? buffer.value.string : nullptr;
    return said && std::wcsncmp(said, text.data(), text.size()) == 0 && said[text.size()] == L'\0';
}
} // namespace

TsResultBuffer* tsutBuildList(std::initializer_list<TsRbValue> values)
{
    TsResultBuffer* head = nullptr;
    TsResultBuffer** tail = &head;
    for (const TsRbValue& value : values)
    {
        *tail = newBuffer(value);
        tail = &(*tail)->next;
    }
    return head;
}

int tsutRelRb(TsResultBuffer* list)
{
    if (isLong(list))
        theKeptList.keep(list);
    else
        freeBuffers(list);
    return TS_NORMAL;
}

namespace tessel
{
TsResultBuffer* listOfTexts(std::span<const std::wstring_view> texts)
{
    TsResultBuffer* list = theKeptList.take();
    TsResultBuffer** end = &list;
    auto text = texts.begin();
    for (; text != texts.end() && *end && says(**end, *text); ++text)
        end = &(*end)->next;
    freeBuffers(std::exchange(*end, nullptr));
    for (; text != texts.end(); ++text)
    {
        *end = newBuffer(*text);
        end = &(*end)->next;
    }
    return list;
}
} // namespace tessel
