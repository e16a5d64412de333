// Values on their way between the host and Lisp. For the files that know ECL.
#pragma once

#include <string>
#include <string_view>

#include <ecl/ecl.h>
#include <tessel/tsresbuf.h>

namespace tessel
{
// These make Lisp objects, and so may leave by a jump when memory is exhausted: call them where no C++ object
// would miss its destructor.
cl_object toLisp(std::wstring_view text);
cl_object toLisp(const TsResultBuffer* values);

// Empty for what is no string.
std::wstring fromLisp(cl_object string);

// The caller frees it with `tsutRelRb`; null for the empty list. The list holds strings, integers, doubles, T
// and NIL only; an integer is short when it fits.
TsResultBuffer* resultFromLisp(cl_object values);
} // namespace tessel
