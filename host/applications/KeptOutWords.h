// What a person reads of an application that is kept out, in that person's language. Each is a text of its
// own, since few languages say it in the same words within a sentence as in front of one.
#pragma once

#include <cstddef>
#include <string>

#include "host/applications/KeptOut.h"

namespace tessel
{
// Why it is kept out, with the day: for a list, "kept out since ...".
std::wstring reasonOf(const KeptOutApplication& application);
// The end of a sentence, after a colon: "it is kept out ...".
std::wstring clauseOfReason(const KeptOutApplication& application);
// The end of a sentence that is about it: "is kept out ...".
std::wstring predicateOfReason(const KeptOutApplication& application);
// A sentence: "This application is kept out ...".
std::wstring sentenceOfReason(const KeptOutApplication& application);

// Sentences: what it has done, how often, and that it is let in all the same.
std::wstring whatItDid(const KeptOutApplication& application, std::size_t sessions);
std::wstring isTriedOnceMore(const KeptOutApplication& application);
} // namespace tessel
