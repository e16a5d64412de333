// The rows of a registry by the store's own calls alone: prepared statements, one transaction. What the
// registry adds to that is the registry's to answer for.
#pragma once

#include <cstddef>
#include <filesystem>
#include <memory>

#include "bench/Entries.h"

namespace bench
{
// Makes an empty file with the same tables and indexes as the registry's.
bool makeBare(const std::filesystem::path& registry, const std::filesystem::path& file);

// A file that stays open from one measurement to the next, as the registry's does.
class BareStore
{
public:
    explicit BareStore(const std::filesystem::path& file);
    ~BareStore();
    BareStore(const BareStore&) = delete;
    BareStore& operator=(const BareStore&) = delete;

    // Of a registry's file: reads the History that holds so many entries, each by its name. False when one is
    // not there.
    bool read(std::size_t count);

    // Of a file of `makeBare`: removes the rows that an earlier run has stored, one by one, if it is told so,
    // and stores so many.
    bool write(std::size_t count, bool removeFirst, PathOf pathOf);

private:
    class Connection;
    std::unique_ptr<Connection> mConnection;
};
} // namespace bench
