// The rows of a registry by the store's own calls alone: one prepared statement, one transaction. What the
// registry adds to that is the registry's to answer for.
#pragma once

#include <cstddef>
#include <filesystem>
#include <memory>
#include <string>

namespace bench
{
// Reads so many entries of the History in the registry's file, each by its name. False when one is not there.
bool readBare(const std::filesystem::path& registry, std::size_t count);

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

    // As `readBare`, of a registry.
    bool read(std::size_t count);

    // Of a file of `makeBare`: removes the rows that an earlier run has stored, one by one, if it is told so,
    // and stores so many. `pathOf` answers the text of each, in UTF-8.
    bool write(std::size_t count, bool removeFirst, std::string (*pathOf)(std::size_t));

private:
    class Connection;
    std::unique_ptr<Connection> mConnection;
};
} // namespace bench
