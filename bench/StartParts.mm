// What a start cannot do without, by the calls of the store and of the system alone: none of the host's code
// runs here, so that whatever the host adds to it shows. The registry's file is opened with the host's
// settings, the bundle is loaded with the libraries that it needs and its entry point called with a message
// that does nothing, and each entry of the Startup Suite is read, mapped and called; then each entry of the
// History is read. A bundle is loaded by the platform's call for bundles, without which its classes do not
// find what lies in it; its program alone is mapped by the linker.
#import <Foundation/Foundation.h>

#include <dlfcn.h>
#include <sqlite3.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <string>

#include <tessel/tsrx.h>

namespace
{
constexpr unsigned kNothing = 7; // no message that any application knows
constexpr int kPatience = 5000;  // milliseconds
// Of the module, as the store has the names that it compares.
constexpr std::array kModrig = {"software", "tessel", "r21", "profiles", "default", "dialogs", "modrig"};

[[noreturn]] void stop(const char* reason)
{
    std::fprintf(stderr, "bench_start_parts: %s\n", reason);
    std::exit(1);
}

void expect(bool done, const char* reason)
{
    if (!done)
        stop(reason);
}

class Store
{
public:
    explicit Store(const std::string& file)
    {
        constexpr int kFlags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX;
        expect(sqlite3_open_v2(file.c_str(), &mDatabase, kFlags, nullptr) == SQLITE_OK, "no registry");
        sqlite3_busy_timeout(mDatabase, kPatience);
        sqlite3_db_config(mDatabase, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
        for (const int option :
             {SQLITE_DBCONFIG_TRUSTED_SCHEMA, SQLITE_DBCONFIG_ENABLE_TRIGGER, SQLITE_DBCONFIG_ENABLE_VIEW})
            sqlite3_db_config(mDatabase, option, 0, nullptr);
        run("PRAGMA user_version; PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON; PRAGMA cell_size_check=ON;"
            " PRAGMA journal_mode=WAL; BEGIN");
        expect(prepare("SELECT id FROM key WHERE parent=?1 AND fold=?2", mKey) &&
                   prepare("SELECT data FROM value WHERE key=?1 AND fold=?2", mValue),
               "no tables");
    }
    ~Store()
    {
        sqlite3_finalize(mKey);
        sqlite3_finalize(mValue);
        sqlite3_exec(mDatabase, "COMMIT", nullptr, nullptr, nullptr);
        sqlite3_close(mDatabase);
    }
    Store(const Store&) = delete;
    Store& operator=(const Store&) = delete;

    // 0 when there is none.
    sqlite3_int64 key(sqlite3_int64 above, const std::string& fold)
    {
        const sqlite3_int64 found = find(mKey, above, fold) ? sqlite3_column_int64(mKey, 0) : 0;
        sqlite3_reset(mKey);
        return found;
    }
    // Empty when there is none.
    std::string value(sqlite3_int64 key, const std::string& fold)
    {
        std::string data;
        if (find(mValue, key, fold))
            data.assign(reinterpret_cast<const char*>(sqlite3_column_text(mValue, 0)),
                        static_cast<std::size_t>(sqlite3_column_bytes(mValue, 0)));
        sqlite3_reset(mValue);
        return data;
    }

private:
    void run(const char* sql)
    {
        expect(sqlite3_exec(mDatabase, sql, nullptr, nullptr, nullptr) == SQLITE_OK,
               "the registry cannot be read");
    }
    bool prepare(const char* sql, sqlite3_stmt*& statement)
    {
        return sqlite3_prepare_v2(mDatabase, sql, -1, &statement, nullptr) == SQLITE_OK;
    }
    static bool find(sqlite3_stmt* statement, sqlite3_int64 key, const std::string& fold)
    {
        sqlite3_bind_int64(statement, 1, key);
        sqlite3_bind_text(statement, 2, fold.data(), static_cast<int>(fold.size()), SQLITE_STATIC);
        return sqlite3_step(statement) == SQLITE_ROW;
    }

    sqlite3* mDatabase = nullptr;
    sqlite3_stmt* mKey = nullptr;
    sqlite3_stmt* mValue = nullptr;
};

// It stays mapped to the end, as in the host.
void mapAndCall(const std::string& program, int binding)
{
    void* const library = dlopen(program.c_str(), binding | RTLD_LOCAL);
    if (!library)
        stop(dlerror());
    const auto entryPoint = reinterpret_cast<TsRxEntryPoint>(dlsym(library, "tsrxEntryPoint"));
    expect(entryPoint && entryPoint(kNothing, nullptr) == TSRX_RET_OK, "the entry point does not answer");
}

// Answers the program that it has mapped.
std::string programOfLoaded(const std::string& folder)
{
    NSAutoreleasePool* const pool = [[NSAutoreleasePool alloc] init];
    NSBundle* const bundle = [NSBundle bundleWithPath:[NSString stringWithUTF8String:folder.c_str()]];
    expect([bundle load], "the bundle cannot be loaded");
    std::string program = [[bundle executablePath] fileSystemRepresentation];
    [pool release];
    return program;
}

void loadAndCall(const std::string& bundleOrProgram)
{
    const bool isBundle = bundleOrProgram.ends_with(".bundle");
    mapAndCall(isBundle ? programOfLoaded(bundleOrProgram) : bundleOrProgram, RTLD_LAZY); // as bundles are
}

template <class Use> void readList(Store& store, const std::string& fold, long count, Use use)
{
    sqlite3_int64 key = 1;
    for (const char* const part : kModrig)
        key = store.key(key, part);
    key = store.key(key, fold);
    const std::string stored = key == 0 ? "" : store.value(key, "num" + fold);
    expect(std::atol(stored.c_str()) == count, "the list has another length");
    for (long number = 1; number <= count; ++number)
    {
        const std::string entry = store.value(key, std::to_string(number) + fold);
        expect(!entry.empty(), "an entry is missing");
        use(entry);
    }
}
} // namespace

int main(int argc, char** argv)
{
    if (argc != 5)
    {
        std::fputs("usage: bench_start_parts REGISTRY BUNDLE|PROGRAM SUITE-COUNT HISTORY-COUNT\n", stderr);
        return 2;
    }
    Store store(argv[1]);
    loadAndCall(argv[2]);
    readList(store, "startup", std::atol(argv[3]),
             [](const std::string& entry) { mapAndCall(entry, RTLD_NOW); });
    readList(store, "history", std::atol(argv[4]), [](const std::string&) {});
    return 0;
}
