#include "host/messages/Help.h"

#include <utility>

#include <tessel/tsed.h>

#include "host/platform/OrdinaryFile.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kFirstPage[] = L"index";
constexpr char kLanguageOfBooks[] = "en"; // of the pages in no folder

// A topic is a name and no path: it must not lead out of the book.
bool isTopicName(const std::wstring& topic)
{
    return topic.find_first_of(L"/\\") == topic.npos && topic.find(L'\0') == topic.npos;
}
} // namespace

Help::Help(std::filesystem::path book, Browser browser, std::vector<std::string> languages)
    : mBook(std::move(book)), mBrowser(std::move(browser)), mLanguages(std::move(languages))
{
}

std::filesystem::path Help::pageIn(const std::filesystem::path& book, const std::string& name) const
{
    for (const std::string& language : mLanguages)
        if (const auto page = book / language / name; isOrdinaryFile(page))
            return page;
        else if (language == kLanguageOfBooks)
            break;
    return book / name;
}

Result<std::wstring> Help::show(const std::wstring& topic, const std::filesystem::path& otherBook)
{
    const std::wstring name = topic.empty() ? kFirstPage : topic;
    const auto page = pageIn(otherBook.empty() ? mBook : otherBook, toUtf8(name) + ".html");
    if (!isTopicName(name) || !isOrdinaryFile(page))
        return Failure{translated(L"There is no help on \"{}\".", name)};
    return mBrowser(page) ? translated(L"The help opens in the browser: {}", page)
                          : translated(L"Help: {}", page);
}
} // namespace tessel

bool tsedHelp(const wchar_t* file, const wchar_t* topic, int)
{
    auto* help = tessel::running<tessel::Help>();
    if (!help)
        return false;
    tessel::CommandLine& commandLine = *tessel::running<tessel::CommandLine>();
    const auto shown = help->show(topic ? topic : L"", file ? tessel::toUtf8(file) : "");
    if (shown)
        commandLine.say(*shown);
    return commandLine.tell(shown);
}
