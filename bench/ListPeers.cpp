#include "bench/ListPeers.h"

#include <glib.h>

#include <QSettings>

#include <memory>
#include <vector>

namespace bench
{
namespace
{
constexpr const char* kGroup = "History";
constexpr const char* kCountName = "NumHistory";

class Settings : public QSettings
{
public:
    explicit Settings(const std::filesystem::path& file)
        : QSettings(QString::fromStdString(file.string()), QSettings::IniFormat)
    {
        setAtomicSyncRequired(true);
        beginGroup(QLatin1String(kGroup));
    }
};

struct FreeKeyFile
{
    void operator()(GKeyFile* file) const { g_key_file_free(file); }
};
using KeyFile = std::unique_ptr<GKeyFile, FreeKeyFile>;

struct FreeText
{
    void operator()(char* text) const { g_free(text); }
};
using Text = std::unique_ptr<char, FreeText>;
} // namespace

bool storeByQSettings(const std::filesystem::path& file, std::size_t count, PathOf pathOf)
{
    Settings settings(file);
    settings.setValue(QLatin1String(kCountName), QString::number(count));
    for (std::size_t number = 1; number <= count; ++number)
        settings.setValue(QString::fromStdString(entryName(number)),
                          QString::fromStdString(pathOf(number - 1)));
    settings.sync();
    return settings.status() == QSettings::NoError;
}

bool readByQSettings(const std::filesystem::path& file, std::size_t count)
{
    const Settings settings(file);
    std::vector<QString> list;
    for (std::size_t number = 1; number <= count; ++number)
        list.push_back(settings.value(QString::fromStdString(entryName(number))).toString());
    return settings.value(QLatin1String(kCountName)).toUInt() == count && !list.back().isEmpty();
}

bool storeByGKeyFile(const std::filesystem::path& file, std::size_t count, PathOf pathOf)
{
    const KeyFile keys(g_key_file_new());
    g_key_file_set_string(keys.get(), kGroup, kCountName, std::to_string(count).c_str());
    for (std::size_t number = 1; number <= count; ++number)
        g_key_file_set_string(keys.get(), kGroup, entryName(number).c_str(), pathOf(number - 1).c_str());
    gsize size = 0;
    const Text text(g_key_file_to_data(keys.get(), &size, nullptr));
    constexpr auto kSafe =
        static_cast<GFileSetContentsFlags>(G_FILE_SET_CONTENTS_CONSISTENT | G_FILE_SET_CONTENTS_DURABLE);
    constexpr int kReadableByAll = 0644;
    return g_file_set_contents_full(file.c_str(), text.get(), static_cast<gssize>(size), kSafe,
                                    kReadableByAll, nullptr);
}

bool readByGKeyFile(const std::filesystem::path& file, std::size_t count)
{
    const KeyFile keys(g_key_file_new());
    if (!g_key_file_load_from_file(keys.get(), file.c_str(), G_KEY_FILE_NONE, nullptr))
        return false;
    std::vector<std::string> list;
    for (std::size_t number = 1; number <= count; ++number)
        if (const Text text{g_key_file_get_string(keys.get(), kGroup, entryName(number).c_str(), nullptr)})
            list.emplace_back(text.get());
    return list.size() == count;
}
} // namespace bench
