// The file format of compiled Lisp (.qbc): byte code after a header that tells a file that is whole and
// meant for this Lisp from every other one.
//
// The byte code itself is trusted: Lisp does not survive damaged byte code, so nothing else may reach it.
#pragma once

#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// The bytes of a file that holds the byte code.
std::string packCompiledLisp(std::string_view byteCode);

// The byte code within the bytes that were given; why not is the end of a sentence.
Result<std::string_view> unpackCompiledLisp(std::string_view bytes);
} // namespace tessel
