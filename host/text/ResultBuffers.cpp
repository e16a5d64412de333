#include <tessel/tsresbuf.h>

#include <new>
#include <string_view>

namespace
{
// Where a list puts a text: after the buffer, in the same block of memory. Whoever asks for what is loaded
// gets a buffer for every module, and has a Suite of hundreds ask as often.
wchar_t* placeForText(TsResultBuffer* buffer)
{
    return reinterpret_cast<wchar_t*>(buffer + 1);
}

TsResultBuffer* blockFor(std::wstring_view text)
{
    void* const block = operator new(sizeof(TsResultBuffer) + (text.size() + 1) * sizeof(wchar_t));
    auto* const buffer = new (block) TsResultBuffer;
    buffer->value.string = placeForText(buffer);
    text.copy(buffer->value.string, text.size());
    buffer->value.string[text.size()] = L'\0';
    return buffer;
}

TsResultBuffer* newBuffer(const TsRbValue& value)
{
    TsResultBuffer* const buffer = blockFor(value.text() ? value.text() : L"");
    buffer->next = nullptr;
    buffer->type = value.type();
    switch (value.type())
    {
    case TS_STRING:
        break; // lies in its place
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
        buffer->value.real = 0;
        break;
    }
    return buffer;
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
        TsResultBuffer* const buffer = list;
        list = list->next;
        if (buffer->type == TS_STRING && buffer->value.string != placeForText(buffer))
            delete[] buffer->value.string; // that of somebody who has put another text there
        operator delete(buffer);
    }
    return TS_NORMAL;
}
