#include "tests/support/recording/RecordingValue.h"

namespace
{
RecordingValue recordedValue(const TsResultBuffer& entry)
{
    switch (entry.type)
    {
    case TS_STRING:
        return RecordingValue::String(entry.value.string ? entry.value.string : L"");
    case TS_SHORT:
        return RecordingValue::Short(entry.value.shortNumber);
    case TS_LONG:
        return RecordingValue::Long(entry.value.longNumber);
    case TS_REAL:
        return RecordingValue::Real(entry.value.real);
    default:
        return {entry.type, {}, 0, 0};
    }
}

TsRbValue sdkValue(const RecordingValue& value)
{
    switch (value.type)
    {
    case TS_STRING:
        return TsRbValue::String(value.text.c_str());
    case TS_SHORT:
        return TsRbValue::Short(static_cast<std::int16_t>(value.number));
    case TS_LONG:
        return TsRbValue::Long(value.number);
    case TS_REAL:
        return TsRbValue::Real(value.real);
    case TS_TRUE:
        return TsRbValue::TrueValue();
    default:
        return TsRbValue::NilValue();
    }
}
} // namespace

std::vector<RecordingValue> recordedValues(const TsResultBuffer* list)
{
    std::vector<RecordingValue> values;
    for (; list; list = list->next)
        values.push_back(recordedValue(*list));
    return values;
}

TsResultBuffer* resultBuffer(const std::vector<RecordingValue>& values)
{
    TsResultBuffer* head = nullptr;
    TsResultBuffer** end = &head;
    for (const RecordingValue& value : values)
    {
        *end = tsutBuildList({sdkValue(value)});
        end = &(*end)->next;
    }
    return head;
}
