#include "host/ui/platform/gnustep/MnemonicLetters.h"

#include <algorithm>
#include <cwctype>
#include <map>
#include <set>

namespace tessel::windowing
{
namespace
{
wchar_t folded(wchar_t letter)
{
    return static_cast<wchar_t>(std::towlower(static_cast<std::wint_t>(letter)));
}

bool isLetter(wchar_t character)
{
    return std::iswalpha(static_cast<std::wint_t>(character)) != 0;
}

bool beginsWord(const std::wstring& text, std::size_t place)
{
    return place == 0 || !isLetter(text[place - 1]);
}

// The places of the letters that may stand for the text, the best first.
std::vector<std::size_t> placesIn(const std::wstring& text)
{
    std::vector<std::size_t> places;
    for (std::size_t place = 0; place < text.size(); ++place)
        if (isLetter(text[place]))
            places.push_back(place);
    std::stable_partition(places.begin(), places.end(),
                          [&](std::size_t place) { return beginsWord(text, place); });
    return places;
}

// Texts and letters, each of which gets at most one of the other.
class Pairs
{
public:
    Pairs(const std::vector<std::wstring>& texts, const std::wstring& taken)
        : mTexts(texts), mPlaces(texts.size())
    {
        for (const wchar_t letter : taken)
            mOwners[folded(letter)] = kNobody;
    }

    // Gives the text its best letter, unless another has it.
    void giveBest(std::size_t text)
    {
        const auto places = placesIn(mTexts[text]);
        if (!places.empty() && !mOwners.contains(letter(text, places.front())))
            give(text, places.front());
    }

    // Gives the text a letter, if need be one of a text that can do with another.
    bool giveAny(std::size_t text, std::set<wchar_t>& tried)
    {
        for (const bool mayTake : {false, true})
            for (const std::size_t place : placesIn(mTexts[text]))
                if (isFree(letter(text, place)) || (mayTake && isGivenUp(letter(text, place), tried)))
                    return give(text, place), true;
        return false;
    }

    bool has(std::size_t text) const { return mPlaces[text].has_value(); }
    MnemonicPlaces places() const { return mPlaces; }

private:
    wchar_t letter(std::size_t text, std::size_t place) const { return folded(mTexts[text][place]); }
    bool isFree(wchar_t letter) const { return !mOwners.contains(letter); }
    bool isGivenUp(wchar_t letter, std::set<wchar_t>& tried)
    {
        const std::size_t owner = mOwners.at(letter);
        return owner != kNobody && tried.insert(letter).second && giveAny(owner, tried);
    }
    void give(std::size_t text, std::size_t place)
    {
        if (mPlaces[text])
            mOwners.erase(letter(text, *mPlaces[text]));
        mPlaces[text] = place;
        mOwners[letter(text, place)] = text;
    }

    static constexpr std::size_t kNobody = static_cast<std::size_t>(-1); // has letters for good

    const std::vector<std::wstring>& mTexts;
    MnemonicPlaces mPlaces;
    std::map<wchar_t, std::size_t> mOwners;
};
} // namespace

MnemonicPlaces chooseMnemonics(const std::vector<std::wstring>& texts, const std::wstring& taken)
{
    Pairs pairs(texts, taken);
    for (std::size_t text = 0; text < texts.size(); ++text)
        pairs.giveBest(text);
    for (std::size_t text = 0; text < texts.size(); ++text)
        if (std::set<wchar_t> tried; !pairs.has(text))
            pairs.giveAny(text, tried);
    return pairs.places();
}

bool isMnemonic(wchar_t letter, wchar_t typed)
{
    return folded(letter) == folded(typed);
}
} // namespace tessel::windowing
