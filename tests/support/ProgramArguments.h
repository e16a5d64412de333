// Arguments and environments as the system takes them.
#pragma once

#include <string>
#include <vector>

// Pointers into the texts, with a null after the last one. They are good as long as the texts are.
inline std::vector<char*> pointersTo(std::vector<std::string>& texts)
{
    std::vector<char*> pointers;
    pointers.reserve(texts.size() + 1);
    for (auto& text : texts)
        pointers.push_back(text.data());
    pointers.push_back(nullptr);
    return pointers;
}
