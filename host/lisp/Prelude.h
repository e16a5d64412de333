// The part of the host's Lisp that is written in Lisp, built into the library so that there is no file to
// find.
#pragma once

#include <string_view>

namespace tessel
{
std::string_view lispPrelude(); // UTF-8
}
