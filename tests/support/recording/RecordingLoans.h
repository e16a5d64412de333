// What the host has handed out for its caller to give back: result buffers, resource modules, registry keys;
// and the application records that are alive. A test that ends with a loan fails (see LoanCheck.cpp). What
// its caller frees like memory of its own, the string of a variable, is the leak checker's to miss.
#pragma once

#include <string>
#include <vector>

namespace recording_loans
{
// From now on until `takeBack`. `kind` names it in the failure and is kept as a pointer.
void lend(const void* thing, const char* kind);
// Nothing happens for what was not lent.
void takeBack(const void* thing);

// The kinds of what is out, each as often as it is out.
std::vector<std::string> outstanding();
void forgetAll();
} // namespace recording_loans
