// Result buffers: linked lists of typed values.
#pragma once

#include <initializer_list>

#include "tsdefs.h"

struct TsResultBuffer
{
    TsResultBuffer* next; // the next value, or null
    int type;             // TS_STRING, TS_SHORT ...; tells which member of value holds
    union
    {
        double real;
        std::int16_t shortNumber;
        std::int32_t longNumber;
        wchar_t* string; // owned by the buffer, made with new[]
    } value;
};

// A value for `tsutBuildList`: its type and its content stand together, so that they cannot disagree.
class TsRbValue
{
public:
    static TsRbValue String(const wchar_t* text)
    {
        TsRbValue value(TS_STRING);
        value.mText = text;
        return value;
    }
    static TsRbValue Short(std::int16_t number)
    {
        TsRbValue value(TS_SHORT);
        value.mNumber = number;
        return value;
    }
    static TsRbValue Long(std::int32_t number)
    {
        TsRbValue value(TS_LONG);
        value.mNumber = number;
        return value;
    }
    static TsRbValue Real(double number)
    {
        TsRbValue value(TS_REAL);
        value.mReal = number;
        return value;
    }
    static TsRbValue TrueValue() { return TsRbValue(TS_TRUE); }
    static TsRbValue NilValue() { return TsRbValue(TS_NIL); }

    int type() const { return mType; }
    const wchar_t* text() const { return mText; }
    std::int32_t number() const { return mNumber; }
    double real() const { return mReal; }

private:
    explicit TsRbValue(int type) : mType(type) {}

    int mType;
    const wchar_t* mText = nullptr;
    std::int32_t mNumber = 0;
    double mReal = 0;
};

// A new list of the values in their order, strings copied; null for none. The caller frees it with
// `tsutRelRb`.
TESSEL_API TsResultBuffer* tsutBuildList(std::initializer_list<TsRbValue> values);

// Frees the whole list, strings included. Null is allowed. Always TS_NORMAL.
TESSEL_API int tsutRelRb(TsResultBuffer* list);
