// The help book: HTML pages, one per topic, shown by the user's browser. Pages in another language than the
// book's stand in folders of it named as languages are: "de", "pt_BR".
#pragma once

#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class Help
{
public:
    // Shows a page; false when there is nothing to show it with.
    using Browser = std::function<bool(const std::filesystem::path& page)>;

    // `book`: the folder of the host's own pages. `languages`: the person's, the most wanted first.
    Help(std::filesystem::path book, Browser browser, std::vector<std::string> languages);

    // Shows a topic of the host's book, or of another one when its folder is given; an empty topic is the
    // first page of the book. Answers what to tell the person: where the page opens, or without a browser its
    // path. Fails when there is no such topic.
    Result<std::wstring> show(const std::wstring& topic, const std::filesystem::path& otherBook = {});

private:
    std::filesystem::path pageIn(const std::filesystem::path& book, const std::string& name) const;

    std::filesystem::path mBook;
    Browser mBrowser;
    std::vector<std::string> mLanguages;
};
} // namespace tessel
