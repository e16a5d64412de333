// The registry's file looked at past the registry, as another program does.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <sqlite3.h>

#include "tests/support/Content.h"

// The first column of the first row, or the words of what went wrong.
inline std::string runSql(const std::filesystem::path& file, const char* sql)
{
    sqlite3* database = nullptr;
    sqlite3_open(file.c_str(), &database);
    std::string answer;
    const auto takeFirst = [](void* context, int, char** columns, char**)
    {
        auto& first = *static_cast<std::string*>(context);
        if (first.empty() && columns[0])
            first = columns[0];
        return 0;
    };
    if (sqlite3_exec(database, sql, takeFirst, &answer, nullptr) != SQLITE_OK)
        answer = sqlite3_errmsg(database);
    sqlite3_close(database);
    return answer;
}
