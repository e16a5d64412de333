// What is typed into the name field of the file panel. Text is UTF-8.
#pragma once

#include <string>
#include <vector>

namespace tessel::filepanel
{
// The names in the text: one, or several in quotation marks ("a" "b").
std::vector<std::string> typedNames(const std::string& text);

// The same the other way round; one name stands as it is.
std::string fieldText(const std::vector<std::string>& names);

// The whole path of a typed name: a name or relative path in the folder, a whole path, or one that begins
// with the home folder, "~".
std::string typedPath(const std::string& name, const std::string& folder, const std::string& home);

// A typed name taken apart for its completion: what leads to a folder ("" or up to the last slash), and what
// the name in that folder begins with.
struct TypedStart
{
    std::string way;
    std::string beginning;
};
TypedStart typedStart(const std::string& text);

// The first name that goes on from the beginning, one in the same case before others; empty when there is
// none, when nothing is typed, and when a name stands there whole already.
std::string completed(const std::string& beginning, const std::vector<std::string>& names);
} // namespace tessel::filepanel
