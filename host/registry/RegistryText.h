// Registry files in the well-known text form, version 5.00: what one host writes, another reads, and what a
// person or a program has written by hand.
//
//     Windows Registry Editor Version 5.00
//
//     [HKEY_CURRENT_USER\Software\Tessel]     a key, which is made
//     "name"="a \"text\" with \\ in it"       a value of it; @ stands for the unnamed value
//     "name"=hex(1):61,00,00,00               a text by its UTF-16 units, low byte first
//     "name"=-                                the value goes
//     [-HKEY_CURRENT_USER\Software\Other]     the key goes, with everything below it
//     ; a note
//
// Texts and names may go over several lines. The registry holds texts alone: numbers and bytes are refused.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
// One thing that such a file asks for. The key is the path below HKEY_CURRENT_USER, empty for that itself; no
// name is the unnamed value's.
struct RegistryChange
{
    enum class Kind
    {
        kMakeKey,
        kRemoveKey,
        kSetValue,
        kRemoveValue
    };
    Kind kind = Kind::kMakeKey;
    std::wstring key;
    std::wstring name;
    std::wstring data;
    std::size_t line = 0; // where it stands, from 1

    bool operator==(const RegistryChange&) const = default;
};

// From UTF-8, or from UTF-16 of either byte order, which begins with its mark. What is not understood fails
// as a whole, with the line: a part of a clause, "in line 7 ...".
Result<std::vector<RegistryChange>> readRegistryText(std::string_view bytes);

enum class RegistryTextForm
{
    kUtf16, // low byte first, with its mark, as is usual for such files
    kUtf8
};

// The bytes of a file that asks for the changes. Fails, with the end of a sentence, when the name of a key
// has a line break, for which the form has no way.
Result<std::string> writeRegistryText(const std::vector<RegistryChange>& changes, RegistryTextForm form);
} // namespace tessel
