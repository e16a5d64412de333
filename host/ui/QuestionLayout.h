// Where the parts of the window that asks stand. Measures are points, from the lower edge.
#pragma once

namespace tessel::asking
{
inline constexpr double kMargin = 22;
inline constexpr double kButtonHeight = 28;
inline constexpr double kFieldHeight = 24;

struct Band
{
    double bottom = 0;
    double height = 0;
};

// What the texts need at the width of the window; there may be no explanation.
struct Wanted
{
    double text = 0;
    double explanation = 0;
    bool hasField = false;
};

struct QuestionLayout
{
    double height = 0;
    Band text;
    Band field;
    Band explanation; // why an answer did not fit
    Band buttons;
};

// No higher than `highest`, as long as a few lines of the text can be seen: a text that has got less than it
// needs is to be scrolled.
QuestionLayout layoutOf(const Wanted& wanted, double highest);
} // namespace tessel::asking
