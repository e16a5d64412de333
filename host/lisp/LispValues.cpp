#include "host/lisp/LispValues.h"

#include <cstdint>
#include <limits>

namespace tessel
{
namespace
{
constexpr std::uint32_t kReplacementCharacter = 0xFFFD;
constexpr std::uint32_t kLastCharacter = 0x10FFFF;

cl_object toLispValue(const TsResultBuffer& value)
{
    switch (value.type)
    {
    case TS_SHORT:
        return ecl_make_fixnum(value.value.shortNumber);
    case TS_LONG:
        return ecl_make_fixnum(value.value.longNumber);
    case TS_REAL:
        return ecl_make_double_float(value.value.real);
    case TS_STRING:
        return toLisp(value.value.string ? std::wstring_view(value.value.string) : std::wstring_view());
    case TS_TRUE:
        return ECL_T;
    default:
        return ECL_NIL;
    }
}

TsRbValue integerValue(cl_fixnum number)
{
    if (number >= std::numeric_limits<std::int16_t>::min() &&
        number <= std::numeric_limits<std::int16_t>::max())
        return TsRbValue::Short(static_cast<std::int16_t>(number));
    return TsRbValue::Long(static_cast<std::int32_t>(number));
}

TsResultBuffer* resultBuffer(cl_object value)
{
    if (ECL_STRINGP(value))
        return tsutBuildList({TsRbValue::String(fromLisp(value).c_str())});
    if (ECL_FIXNUMP(value))
        return tsutBuildList({integerValue(ecl_fixnum(value))});
    if (ECL_DOUBLE_FLOAT_P(value))
        return tsutBuildList({TsRbValue::Real(ecl_double_float(value))});
    return tsutBuildList({value == ECL_NIL ? TsRbValue::NilValue() : TsRbValue::TrueValue()});
}
} // namespace

cl_object toLisp(std::wstring_view text)
{
    cl_object string = ecl_alloc_simple_extended_string(text.size());
    for (std::size_t index = 0; index < text.size(); ++index)
    {
        const auto character = static_cast<std::uint32_t>(text[index]);
        string->string.self[index] =
            static_cast<ecl_character>(character <= kLastCharacter ? character : kReplacementCharacter);
    }
    return string;
}

cl_object toLisp(const TsResultBuffer* values)
{
    cl_object list = ECL_NIL;
    for (; values; values = values->next)
        list = ecl_cons(toLispValue(*values), list);
    return cl_nreverse(list);
}

std::wstring fromLisp(cl_object string)
{
    std::wstring text;
    if (!ECL_STRINGP(string))
        return text;
    text.reserve(string->string.fillp);
    for (cl_index index = 0; index < string->string.fillp; ++index)
        text += static_cast<wchar_t>(ecl_char(string, index));
    return text;
}

TsResultBuffer* resultFromLisp(cl_object values)
{
    TsResultBuffer* head = nullptr;
    TsResultBuffer** tail = &head;
    for (; ECL_CONSP(values); values = cl_cdr(values))
    {
        *tail = resultBuffer(cl_car(values));
        tail = &(*tail)->next;
    }
    return head;
}
} // namespace tessel
