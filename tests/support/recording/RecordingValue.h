// A result-buffer value as a test writes and compares it.
#pragma once

#include <string>
#include <vector>

#include <tessel/tsresbuf.h>

struct RecordingValue
{
    static RecordingValue String(std::wstring text) { return {TS_STRING, std::move(text), 0, 0}; }
    static RecordingValue Short(std::int16_t number) { return {TS_SHORT, {}, number, 0}; }
    static RecordingValue Long(std::int32_t number) { return {TS_LONG, {}, number, 0}; }
    static RecordingValue Real(double number) { return {TS_REAL, {}, 0, number}; }
    static RecordingValue True() { return {TS_TRUE, {}, 0, 0}; }
    static RecordingValue Nil() { return {TS_NIL, {}, 0, 0}; }

    int type = TS_NIL;
    std::wstring text;
    std::int32_t number = 0;
    double real = 0;

    bool operator==(const RecordingValue&) const = default;
};

// The values of a list (null: none).
std::vector<RecordingValue> recordedValues(const TsResultBuffer* list);

// A new list of the values, to be freed with `tsutRelRb`; null for none.
TsResultBuffer* resultBuffer(const std::vector<RecordingValue>& values);
