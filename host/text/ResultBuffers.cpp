#include <tessel/tsresbuf.h>

#include <cwchar>
#include <memory>
#include <string_view>

namespace
{
wchar_t* copyText(std::wstring_view text)
{
    auto* copy = new wchar_t[text.size() + 1];
    std::wmemcpy(copy, text.data(), text.size());
    copy[text.size()] = L'\0';
    return copy;
}

TsResultBuffer* newBuffer(const TsRbValue& value)
{
    auto buffer = std::make_unique<TsResultBuffer>();
    buffer->next = nullptr;
    buffer->type = value.type();
    buffer->value.real = 0;
    switch (value.type())
    {
    case TS_STRING:
        buffer->value.string = copyText(value.text() ? value.text() : L"");
        break;
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
    return buffer.release();
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
    while (list)
    {
        const std::unique_ptr<TsResultBuffer> buffer(list);
        list = list->next;
        if (buffer->type == TS_STRING)
            delete[] buffer->value.string;
    }
    return TS_NORMAL;
}
