// GNUstep's bundles are never unloaded, and its runtime has no way to forget a class. So what brings no
// Objective-C is loaded and unloaded as the plain library it is, and what brings some stays.
#include "host/applications/platform/ObjectiveCRuntime.h"

#include <algorithm>
#include <cstdint>
#include <string>
#include <string_view>

#include <dlfcn.h>
#include <link.h>

#include "host/applications/platform/ElfLinkMap.h"
#include "host/platform/RegularFile.h"

namespace tessel
{
namespace
{
// What every compiled Objective-C file calls to make its classes and categories known.
constexpr std::string_view kRegistration = "__objc_exec_class";

// An entry of the mapped library's dynamic section; 0 when it is not there.
ElfW(Addr) dynamicEntry(const link_map& map, ElfW(Sxword) tag)
{
    for (const auto* entry = map.l_ld; entry->d_tag != DT_NULL; ++entry)
        if (entry->d_tag == tag)
            return entry->d_un.d_ptr;
    return 0;
}

// The address in such an entry. Where the section cannot be written the system has left it as the file has
// it, counted from the library's start: it then lies below every mapped library.
template <class Table>
const Table* tableAt(const link_map& map, ElfW(Sxword) tag)
{
    const ElfW(Addr) address = dynamicEntry(map, tag);
    if (address == 0)
        return nullptr;
    return reinterpret_cast<const Table*>(address < map.l_addr ? address + map.l_addr : address);
}

// The index after the last symbol that the library only refers to: these stand in front of those that it
// defines, which the hash table begins with.
std::uint32_t endOfReferences(const link_map& map)
{
    const auto* hash = tableAt<std::uint32_t>(map, DT_GNU_HASH);
    return hash ? hash[1] : 0;
}

bool isMissing(void* library, const ElfW(Sym) & symbol, const char* name)
{
    if (symbol.st_shndx != SHN_UNDEF || ELF64_ST_BIND(symbol.st_info) == STB_WEAK)
        return false;
    return !dlsym(library, name) && !dlsym(RTLD_DEFAULT, name);
}
} // namespace

// In pieces: the names that a program refers to stand near its beginning.
bool needsBundleLoading(const std::string& program)
{
    constexpr std::uint64_t kPiece = 16384;
    constexpr std::uint64_t kOverlap = kRegistration.size() - 1; // which the end of a piece may cut in two
    const RegularFile file(program);
    const std::uint64_t size = file.opened() ? file.size() : 0;
    std::string piece;
    for (std::uint64_t start = 0; start < size; start += kPiece - kOverlap)
    {
        piece.resize(std::min(kPiece, size - start));
        if (!file.read(start, piece.data(), piece.size()))
            return false;
        if (piece.find(kRegistration) != piece.npos)
            return true;
    }
    return false;
}

bool mustStayMapped(void* library)
{
    const link_map* map = linkMapOf(library);
    if (!map)
        return true;
    const auto* names = tableAt<char>(*map, DT_STRTAB);
    if (!names)
        return true;
    return std::string_view(names, dynamicEntry(*map, DT_STRSZ)).find(kRegistration) !=
           std::string_view::npos;
}

std::string firstUnresolvedFunction(void* library)
{
    const link_map* map = linkMapOf(library);
    if (!map)
        return {};
    const auto* symbols = tableAt<ElfW(Sym)>(*map, DT_SYMTAB);
    const auto* names = tableAt<char>(*map, DT_STRTAB);
    if (!symbols || !names)
        return {};
    for (std::uint32_t i = 1; i < endOfReferences(*map); ++i) // the first symbol is no symbol
        if (const char* name = names + symbols[i].st_name; isMissing(library, symbols[i], name))
            return name;
    return {};
}
} // namespace tessel
